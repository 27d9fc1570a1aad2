#include <algorithm>

#include "tools/share/SharedRecords.h"

namespace kelvo::shared {

namespace {

using enum Identity;

// clang-format off
constexpr SharedField kRanking[] = { { 13, u8 }, { 14, u8 } };  // UMTS cells, GSM cells
constexpr SharedField kRankedUmtsCell[] = {
    { 0, u16 },                                     // channel
    { 2, u16,             ScramblingCode, "Scrambling Code" },
    { 4, u8 }, { 5, u16 }, { 7, u8 }, { 8, u16 },
};
constexpr SharedField kRankedGsmCell[] = {
    { 0, u16 },                                     // channel
    { 2, u16,             Bsic,           "BSIC" },
    { 4, u8 }, { 5, u16 },
};
constexpr SharedField kPower[] = { { 14, u8 } };
constexpr SharedField kPowerEntry[] = { { 4, u16 } };
constexpr SharedField kBlockErrors[] = { { 13, u8 }, { 14, u16 } };
constexpr SharedField kBlockErrorsEntry[] = { { 0, u8 }, { 1, u32 }, { 5, u32 } };
constexpr SharedField kFirstByte[] = { { 13, u8 } };  // RRC state, ciphering, dedicated channel, PBCCH
constexpr SharedField kCellIdentity[] = {
    { 13, u32 }, { 17, u32 },                       // channels, up and down
    { 21, u32,            UtranCell,      "Cell ID" },
    { 25, u16,            SubArea,        "URA ID" },
};
constexpr SharedField kCellSets[] = { { 13, u16 }, { 15, u8 } };
constexpr SharedField kSetCell[] = {
    { 7, u16.bits(0, 12), ScramblingCode, "Scrambling Code" },
    { 7, u16.bits(13, 15) },                        // which set
};
constexpr SharedField kSetMeasurement[] = { { 32, u32 }, { 36, u32 }, { 40, u32 } };
constexpr SharedField kHsdpa[] = { { 13, u8 }, { 14, u16.bits(0, 11) }, { 16, u8 }, { 17, u8 } };
constexpr SharedField kHsdpaProcess[] = { { 0, u8 }, { 1, u32 }, { 5, u16 }, { 7, u16 } };
constexpr SharedField kDtx[] = { { 19, u8 } };
constexpr SharedField kRrState[] = { { 13, u8 }, { 14, u8 }, { 15, u8 }, { 16, u8 } };
constexpr SharedField kGsmCell[] = {
    { 13, u16 },                                    // channel
    { 15, u16,            Bsic,           "BSIC" },
    { 17, u16,            Cell,           "Cell ID" },
};
constexpr SharedField kGsmCells[] = {
    { 15, u8 }, { 16, u32 }, { 20, u32 },           // level, C1, C2
    { 26, u8 }, { 28, u8 },                         // hysteresis, neighbors
};
constexpr SharedField kGsmNeighbor[] = { { 0, u16 }, { 2, u8 }, { 3, u32 } };
constexpr SharedField kSi13[] = { { 14, u8 } };
constexpr SharedField kThreeBytes[] = { { 13, u8 }, { 14, u8 }, { 15, u8 } };  // GPRS options, GMM and MM states
constexpr SharedField kGprsTimers[] = { { 15, u8 }, { 16, u8 }, { 17, u8 } };
constexpr SharedField kMobileAllocation[] = { { 13, u8 }, { 14, u8 } };
constexpr SharedField kChannel[] = { { 0, u16 } };
constexpr SharedField kPacketOrders[] = { { 13, u8 }, { 14, u8 }, { 15, u8 }, { 16, u8 }, { 33, u8 } };
constexpr SharedField kBsics[] = { { 14, u8 } };
constexpr SharedField kBsicOfChannel[] = {
    { 0, u16 },
    { 2, u8,              Bsic,           "BSIC" },
};
constexpr SharedField kRegistration[] = { { 13, u8 }, { 14, u8 } };
constexpr SharedField kServingNetwork[] = {
    { 13, u8 }, { 14, u8 },                         // operating mode, service
    { 18, u16.bigEndian(), Area,          "Location Area Code" },
    { 20, u8,             SubArea,        "Routing Area Code" },
};
constexpr SharedField kNetworks[] = { { 16, u8 } };
// clang-format on

// Both lists are read from the same place on. A record with UMTS cells has no GSM cells there.
void takeRanking(RecordCopy& copy) {
    const std::size_t umts = copy.count(13, u8);
    copy.takeEntries(15, 10, umts, kRankedUmtsCell);
    if (umts == 0) copy.takeEntries(15, 7, copy.count(14, u8), kRankedGsmCell);
}

void takePower(RecordCopy& copy) { copy.takeEntries(16, 14, copy.count(14, u8), kPowerEntry); }
void takeBlockErrors(RecordCopy& copy) { copy.takeEntries(16, 9, copy.count(13, u8), kBlockErrorsEntry); }

void takeCellSets(RecordCopy& copy) {
    const std::size_t cells = copy.count(15, u8);
    copy.takeEntries(16, 15, cells, kSetCell);
    copy.takeEntries(16 + 15 * cells, 44, cells, kSetMeasurement);
}

void takeHsdpa(RecordCopy& copy) {
    const std::size_t primary = copy.count(16, u8);
    copy.takeEntries(18, 9, primary, kHsdpaProcess);
    copy.takeEntries(18 + 162 * primary, 9, copy.count(17, u8), kHsdpaProcess);
}

void takeGsmNeighbors(RecordCopy& copy) { copy.takeEntries(29, 14, copy.count(28, u8), kGsmNeighbor); }
void takeChannels(RecordCopy& copy) { copy.takeEntries(15, 2, copy.count(14, u8), kChannel); }
void takeBsics(RecordCopy& copy) { copy.takeEntries(15, 4, copy.count(14, u8), kBsicOfChannel); }

/// Three bytes of packed BCD.
void takeServingNetwork(RecordCopy& copy) {
    Bytes plmn;
    for (std::size_t at = 15; at < 18; ++at) plmn.push_back(static_cast<std::uint8_t>(copy.read(at, u8)));
    if (const auto other = copy.replacer().bytes(Plmn, "Mobile Country and Network Code", plmn)) plmn = *other;
    for (std::size_t i = 0; i < plmn.size(); ++i) copy.put(15 + i, u8, plmn[i]);
}

// A digit a byte, those of the country and of the network in turn. Entries are three bytes apart and six bytes long:
// only the first can have the network's pseudonym; what the others add is replaced as a whole.
void takeNetworks(RecordCopy& copy) {
    constexpr std::size_t kStart = 17;
    const std::size_t count = copy.count(16, u8);
    if (count == 0) return;
    const std::size_t end = std::min(kStart + 3 * count + 3, copy.size());
    if (!copy.replacer().hides(Country)) {
        for (std::size_t at = kStart; at < end; ++at) copy.take(at, u8);
        return;
    }
    const auto value = [&](std::size_t first) {
        const auto digit = [&](std::size_t at) { return copy.read(kStart + at, u8); };
        return static_cast<std::uint32_t>(digit(first) * 100 + digit(first + 2) * 10 + digit(first + 4));
    };
    const std::uint32_t country = copy.replacer().number(Country, "Mobile Country Code", value(0));
    const std::uint32_t network = copy.replacer().number(Network, "Mobile Network Code", value(1));
    for (std::size_t i = 0; i < 3; ++i) {
        const std::uint32_t unit = i == 0 ? 100 : i == 1 ? 10 : 1;
        copy.put(kStart + 2 * i, u8, country / unit % 10);
        copy.put(kStart + 2 * i + 1, u8, network / unit % 10);
    }
    Bytes list;
    for (std::size_t at = kStart; at < end; ++at) list.push_back(static_cast<std::uint8_t>(copy.read(at, u8)));
    const std::string digits = copy.replacer().furtherDigits(list);
    for (std::size_t at = kStart + 6; at < end; ++at) copy.put(at, u8, digits[at - kStart] - '0');
}

constexpr SharedRecord kRecords[] = {
    {0x4005, kRanking, takeRanking},
    {0x4031, kPower, takePower},
    {0x4116, kBlockErrors, takeBlockErrors},
    {0x4125, kFirstByte},
    {0x4127, kCellIdentity},
    {0x4157, kFirstByte},
    {0x417A, kCellSets, takeCellSets},
    {0x4221, kHsdpa, takeHsdpa},
    {0x5072, kDtx},
    {0x5076, kFirstByte},
    {0x512C, kRrState},
    {0x5134, kGsmCell},
    {0x5137, kGsmCells, takeGsmNeighbors},
    {0x51F4, kSi13},
    {0x51F5, kThreeBytes},
    {0x51F6, kGprsTimers},
    {0x51F8, kMobileAllocation, takeChannels},
    {0x51FB, kFirstByte},
    {0x51FD, kPacketOrders},
    {0x51FF, kBsics, takeBsics},
    {0x7130, kThreeBytes},
    {0x7131, kThreeBytes},
    {0x7132, kRegistration},
    {0x7135, kServingNetwork, takeServingNetwork},
    {0x7150, kNetworks, takeNetworks},
};

}  // namespace

std::span<const SharedRecord> gsmUmts() { return kRecords; }

}  // namespace kelvo::shared
