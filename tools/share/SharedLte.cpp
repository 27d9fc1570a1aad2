#include "tools/share/SharedRecords.h"

namespace kelvo::shared {

namespace {

using enum Identity;

// clang-format off
constexpr SharedField kMasterInformation[] = {
    { 13, u8 },                                     // version
    { 14, u16,             PhysicalCell, "Physical Cell ID" },
    { 16, u16 },                                    // channel
    { 18, u16 },                                    // frame
    { 20, u8 }, { 21, u8 },                         // antennas, bandwidth
};
constexpr SharedField kServingCell[] = {
    { 13, u8 },
    { 14, u16,             PhysicalCell, "Physical Cell ID" },
    { 16, u16 }, { 18, u16 }, { 20, u8 }, { 21, u8 },  // channels and bandwidths, down and up
    { 22, u32,             EutranCell,   "Cell Identity" },
    { 26, u16,             Area,         "Tracking Area Code" },
    { 28, u32 },                                    // band
    { 32, u16,             Country,      "Mobile Country Code" },
    { 34, u8 },                                     // digits of the MNC
    { 35, u16,             Network,      "Mobile Network Code" },
    { 37, u8 },                                     // allowed access
};
constexpr SharedField kConnected[] = {
    { 13, u8 },
    { 17, u16 },                                    // channel
    { 19, u16,             PhysicalCell, "Serving Physical Cell ID" },
    { 21, u16 }, { 23, u16 }, { 25, u16 },          // sub-frame, RSRP, RSRQ
    { 27, u8 }, { 28, u8 },                         // measured and detected cells
};
constexpr SharedField kMeasured[] = {
    {  0, u16,             PhysicalCell, "Physical Cell ID" },
    {  2, u16 }, { 4, u16 },
};
constexpr SharedField kDetected[] = {
    {  0, u16,             PhysicalCell, "Physical Cell ID" },
};
constexpr SharedField kIdle[] = {
    { 13, u8 }, { 14, u8 },
    { 17, u16 },                                    // channel
    { 19, u16.bits(0, 8),  PhysicalCell, "Physical Cell ID" },
    { 19, u16.bits(9, 12) },                        // priority
    { 21, u32 }, { 25, u32.bits(0, 27) }, { 29, u32.bits(0, 29) },
};
constexpr SharedField kNeighbors[] = {
    { 13, u8 }, { 14, u8 },
    { 17, u16 },                                    // channel
    { 19, u16.bits(0, 10) },                        // Qrxlevmin, cells
};
constexpr SharedField kNeighbor[] = {
    {  0, u32.bits(0, 8),  PhysicalCell, "Physical Cell ID" },
    {  0, u32.bits(9, 25) }, { 4, u32.bits(0, 29) }, { 8, u16 }, { 12, u32.bits(0, 29) },
};
constexpr SharedField kReselection[] = {
    { 13, u8 },
    { 15, u16 },                                    // channel
    { 17, u16,             PhysicalCell, "Serving Cell ID" },
    { 19, u8 },                                     // candidates
};
constexpr SharedField kCandidate[] = { {  0, u16 }, { 2, u16 } };  // priority, technology
constexpr SharedField kLteCandidate[] = {
    {  4, u16 },
    {  6, u16.bits(7, 15), PhysicalCell,   "Cell ID" },
};
constexpr SharedField kUmtsCandidate[] = {
    {  4, u16 },
    {  6, u16,             ScramblingCode, "PSC" },
};
constexpr SharedField kGsmCandidate[] = {
    {  4, u16 }, { 6, u8 },                         // channel, band
    {  7, u8,              Bsic,           "BSIC ID" },
};
constexpr SharedField kCdmaCandidate[] = {
    {  4, u8 }, { 8, u16 },                         // band, channel
    { 10, u16,             Pilot,          "Pilot" },
};
// clang-format on

void takeConnected(RecordCopy& copy) {
    const std::size_t measured = copy.count(27, u8);
    copy.takeEntries(29, 6, measured, kMeasured);
    copy.takeEntries(29 + 6 * measured, 2, copy.count(28, u8), kDetected);
}

void takeNeighbors(RecordCopy& copy) { copy.takeEntries(21, 20, copy.count(19, u16.bits(6, 10)) + 1, kNeighbor); }

std::span<const SharedField> candidateOf(std::int64_t technology) {
    switch (technology) {
        case 0: return kLteCandidate;
        case 1: return kUmtsCandidate;
        case 2: return kGsmCandidate;
        case 3:
        case 4: return kCdmaCandidate;
        default: return {};
    }
}

// Candidates are read 4 bytes apart and are longer, so that an identity may lie where the next one's technology is
// read: one of 0 to 4 is a technology and stays, and nothing else becomes one (Identity.cpp).
void takeCandidates(RecordCopy& copy) {
    constexpr std::size_t kStart = 21;
    constexpr std::size_t kStride = 4;
    const std::size_t count = copy.count(19, u8);
    for (std::size_t i = 0; i < count; ++i) {
        const std::size_t at = kStart + kStride * i;
        if (copy.read(at + 2, u16) <= 4) copy.take(at + 2, u16);
    }
    for (std::size_t i = 0; i < count && kStart + kStride * i < copy.size(); ++i) {
        const std::size_t at = kStart + kStride * i;
        copy.take(candidateOf(copy.read(at + 2, u16)), at);
    }
    copy.takeEntries(kStart, kStride, count, kCandidate);
}

constexpr SharedRecord kRecords[] = {
    {0xB0C1, kMasterInformation},        {0xB0C2, kServingCell},
    {0xB179, kConnected, takeConnected}, {0xB17F, kIdle},
    {0xB180, kNeighbors, takeNeighbors}, {0xB186, kReselection, takeCandidates},
};

}  // namespace

std::span<const SharedRecord> lte() { return kRecords; }

}  // namespace kelvo::shared
