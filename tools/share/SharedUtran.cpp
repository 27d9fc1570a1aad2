#include "tools/share/SharedRecords.h"

namespace kelvo::shared {

namespace {

using enum Identity;

// clang-format off
constexpr SharedField kNeighbors[] = { { 16, u8.bits(1, 7) } };
constexpr SharedField kNeighbor[] = {
    { 0, u32.bits(0, 13) },                         // channel
    { 0, u32.bits(14, 20), CellParameter, "Cell ID" },
    { 0, u32.bits(21, 31) },
};
constexpr SharedField kTransport[] = { { 14, u16.bits(6, 15) } };
constexpr SharedField kTransportChannel[] = { { 0, u8 }, { 1, u8 } };
constexpr SharedField kInterference[] = { { 0, u32 }, { 4, u32 } };
constexpr SharedField kGsmNeighbors[] = { { 16, u8 } };
constexpr SharedField kGsmNeighbor[] = {
    { 0, u16.bits(0, 13),  CellParameter, "Cell ID" },
    { 0, u16.bits(14, 15) },                        // band indicator, BSIC valid
    { 2, u8,               Colour,        "NCC" },
    { 3, u8,               Colour,        "BCC" },
    { 4, u16 }, { 6, u16 },
};
constexpr SharedField kRrcState[] = { { 13, u8 }, { 14, u8 } };
constexpr SharedField kServingCell[] = {
    { 14, u8 },                                     // access restrictions
    { 15, u8,              SubArea,       "URA ID" },
    { 17, u16 }, { 19, u16 },                       // channels, up and down
    { 21, u32,             UtranCell,     "Cell ID" },
    { 25, u8.bit(0) },                              // allowed access
};
// clang-format on

void takeNeighbors(RecordCopy& copy) { copy.takeEntries(168, 16, copy.count(16, u8.bits(1, 7)), kNeighbor); }

void takeTransport(RecordCopy& copy) {
    const std::size_t channels = copy.count(14, u16.bits(6, 11));
    copy.takeEntries(17, 2, channels, kTransportChannel);
    copy.takeEntries(289 + 34 * channels, 8, copy.count(14, u16.bits(12, 15)), kInterference);
}

void takeGsmNeighbors(RecordCopy& copy) { copy.takeEntries(17, 8, copy.count(16, u8), kGsmNeighbor); }

constexpr SharedRecord kRecords[] = {
    {0xD00A, kNeighbors, takeNeighbors},
    {0xD00C, kTransport, takeTransport},
    {0xD00E, kGsmNeighbors, takeGsmNeighbors},
    {0xD0E0, kRrcState},
    {0xD0E2, kServingCell},
};

}  // namespace

std::span<const SharedRecord> utran() { return kRecords; }

}  // namespace kelvo::shared
