#include "tools/share/SharedRecords.h"

namespace kelvo::shared {

namespace {

using enum Identity;

// clang-format off
constexpr SharedField kFingers[] = { { 22, u8 } };
constexpr SharedField kFinger[] = {
    { 0, u16,              Pilot,     "Fingers" },
    { 6, u16 },
};
constexpr SharedField kEvdoStatus[] = {
    { 13, u16 }, { 15, u8 }, { 16, u8 }, { 17, u8 },  // channel and band class, levels
    { 18, u16,             Pilot,     "Serving PN Offset" },
    { 36, u8 }, { 37, u8 },                         // device and session state
    { 38, u32.bits(0, 23), Temporary, "UATI24" },
    { 41, u8,              System,    "Color Code" },
};
constexpr SharedField kSubpackets[] = { { 14, u8 } };
constexpr SharedField kSubpacket[] = { { 0, u8 }, { 2, u16 } };  // id, size
constexpr SharedField kState[] = { { 4, u8 } };
constexpr SharedField kRadio[] = { { 4, u8 }, { 5, u8 }, { 6, u16 }, { 8, u16 }, { 10, u8 }, { 11, u8 }, { 12, u16 } };
constexpr SharedField kActiveSet[] = {
    { 4, u16 }, { 6, u8 }, { 7, u8 }, { 8, u8 }, { 9, u8 },
    { 10, u16,             Pilot,     "Active Set" },
};
constexpr SharedField kPilot[] = {
    { 0, u16,              Pilot,     "Active Set" },
};
constexpr SharedField kDemodulation[] = { { 24, u8 } };
constexpr SharedField kPilots[] = { { 15, u8 } };
constexpr SharedField kPilotEnergy[] = {
    { 0, u16,              Pilot,     "Active Set" },
    { 2, u16 },
};
constexpr SharedField kForward[] = { { 13, u32 } };
constexpr SharedField kReverse[] = { { 14, u32 } };
constexpr SharedField kCounter[] = { { 0, u32 } };
constexpr SharedField kReverseRate[] = { { 0, u32 }, { 4, u32 }, { 8, u32 }, { 12, u32 } };
constexpr SharedField kSystem[] = {
    { 13, u8 },
    { 42, u32 }, { 46, u32 },                       // roaming indicator, kind of system
    { 131, u8,             System,    "Packet Zone ID" },
    { 133, u8 },                                    // protocol revision
    { 184, u16,            Cell,      "Base Station ID" },
};
constexpr SharedField kCdmaSystem[] = {
    { 50, u16,             System,    "System ID" },
    { 52, u16,             System,    "Network ID" },
};
// clang-format on

/// Goes through the sub-packets; their heads are taken over before what is in them.
template <class Each>
void eachSubpacket(RecordCopy& copy, Each each) {
    for (const bool heads : {true, false}) {
        std::size_t at = 17;
        for (std::size_t left = copy.count(14, u8); left > 0 && at < copy.size(); --left) {
            if (heads) copy.take(kSubpacket, at);
            if (!heads) each(copy.read(at, u8), at);
            at += copy.count(at + 2, u16);
        }
    }
}

void take1xStatus(RecordCopy& copy) {
    eachSubpacket(copy, [&](std::int64_t id, std::size_t at) {
        if (id == 1) copy.take(kState, at);
        if (id == 2) copy.take(kRadio, at);
        if (id != 3) return;
        copy.take(kActiveSet, at);
        const std::size_t extras = copy.count(at + 9, u8);
        const SharedField energy[] = {{static_cast<std::uint16_t>(12 + 4 * extras), u16}};
        const std::size_t stride = (6 * extras + 15) / 4 * 4;
        // Without extra entries a pilot's energy is read where the next one's offset is: that goes first.
        copy.takeEntries(at + 12, stride, copy.count(at + 8, u8), kPilot);
        copy.takeEntries(at + 12, stride, copy.count(at + 8, u8), energy);
    });
}

void takeTraffic(RecordCopy& copy) {
    eachSubpacket(copy, [&](std::int64_t id, std::size_t at) {
        if (id == 11) copy.take(kDemodulation, at);
    });
}

void takeFingers(RecordCopy& copy) { copy.takeEntries(23, 14, copy.count(22, u8), kFinger); }
void takePilots(RecordCopy& copy) { copy.takeEntries(25, 12, copy.count(15, u8), kPilotEnergy); }
void takeForward(RecordCopy& copy) { copy.takeEntries(17, 4, 56, kCounter); }

void takeReverse(RecordCopy& copy) {
    for (std::size_t block = 0; block < 6; ++block) copy.takeEntries(18 + 288 * block, 24, 12, kReverseRate);
}

void takeSystem(RecordCopy& copy) {
    if (copy.read(46, u32) == 2) copy.take(kCdmaSystem);
}

constexpr SharedRecord kRecords[] = {
    {0x108A, kFingers, takeFingers},    {0x1183, kEvdoStatus},
    {0x1192, kForward, takeForward},    {0x119C, kSubpackets, take1xStatus},
    {0x119D, kSubpackets, takeTraffic}, {0x127E, kReverse, takeReverse},
    {0x12B6, kPilots, takePilots},      {0x134F, kSystem, takeSystem},
};

}  // namespace

std::span<const SharedRecord> cdma() { return kRecords; }

}  // namespace kelvo::shared
