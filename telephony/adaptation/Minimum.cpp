#include "telephony/adaptation/Minimum.h"

#include <algorithm>
#include <array>

#include "LogGenerator/RecordView.h"

namespace kelvo::adaptation {

namespace {

/// Packet lengths, the 13 bytes of header included: the least, and how it grows with a count in the record.
struct Length {
    LogCode code;
    std::uint16_t least;
    std::uint16_t countAt = 0;  // a u8
    std::uint16_t stride = 0;
    bool exact = false;
};

// clang-format off
constexpr std::array kLengths = std::to_array<Length>({
    { 0x108A,   23, 22, 14, true },  // finger C/I
    { 0x1183,   50,  0,  0, true },  // EV-DO status
    { 0x1192,  241 },                // forward-link data rate
    { 0x119C,   17 },                // 1x status
    { 0x119D,   17 },                // traffic frame errors
    { 0x127E, 1750 },                // reverse-link data rate
    { 0x12B6,   25, 15, 12 },        // EV-DO active set pilots
    { 0x134F,  171 },                // system identification
    { 0x4031,   16 },                // transmit power
    { 0x4116,   16 },                // transport channel block errors
    { 0x4125,   14 },                // RRC state
    { 0x4157,   19 },                // ciphering
    { 0x417A,   16 },                // cell sets of the searcher
    { 0x4221,   18 },                // HSDPA
    { 0x5072,   20 },                // DTX
    { 0x5076,   17 },                // dedicated channel
    { 0x512C,   17 },                // RR state
    { 0x5134,   26 },                // serving cell
    { 0x5137,   29 },                // serving cell and neighbors
    { 0x51F4,   15 },                // SI13
    { 0x51F5,   18 },                // GPRS cell options
    { 0x51F6,   24 },                // GPRS timers
    { 0x51F8,   15 },                // mobile allocation
    { 0x51FB,   34 },                // PBCCH
    { 0x51FD,   35 },                // packet measurement orders
    { 0x51FF,   15 },                // BSIC of channels
    { 0x7130,   16 },                // GMM state
    { 0x7131,   16 },                // MM state
    { 0x7132,   16 },                // registration
    { 0x7135,   32 },                // serving network
    { 0xB186,   21 },                // reselection candidates
    { 0xD00A,   21 },                // UTRAN neighbors
    { 0xD00C,   17 },                // transport channels
    { 0xD00E,   17 },                // GSM neighbors
    { 0xD0E0,   15 },                // RRC state
    { 0xD0E2,   26 },                // UTRAN serving cell
});
// clang-format on

constexpr std::size_t kSubpacketCountAt = 14;
constexpr std::size_t kSubpacketsAt = 17;

/// What is read of a sub-packet, its header of four bytes included.
std::size_t leastSubpacket(RecordView record, std::size_t at, std::int64_t id) {
    switch (id) {
        case 1: return 5;   // system state
        case 2: return 14;  // RF
        case 3: {           // active set: 12 bytes and the pilots
            const std::int64_t pilots = record.read(at + 8, u8);
            const std::int64_t pilotSize = (6 * record.read(at + 9, u8) + 15) / 4 * 4;
            return static_cast<std::size_t>(12 + pilots * pilotSize);
        }
        case 11: return 25;  // traffic demodulation
        default: return 4;
    }
}

bool subpacketsFit(ByteView packet) {
    const RecordView record(packet);
    std::size_t at = kSubpacketsAt;
    for (std::int64_t left = record.read(kSubpacketCountAt, u8); left > 0; --left) {
        const auto size = static_cast<std::size_t>(record.read(at + 2, u16));
        if (at + 4 > packet.size() || size > packet.size() - at) return false;
        if (size < leastSubpacket(record, at, record.read(at, u8))) return false;
        at += size;
    }
    return true;
}

}  // namespace

std::optional<Refusal> lengthRefusal(LogCode code, ByteView packet) {
    const auto found = std::ranges::lower_bound(kLengths, code, {}, &Length::code);
    if (found == kLengths.end() || found->code != code) return Refusal::NotOurs;
    const auto count = found->stride == 0 ? 0 : RecordView(packet).read(found->countAt, u8);
    const std::size_t least = found->least + static_cast<std::size_t>(count) * found->stride;
    if (packet.size() < least) return Refusal::TooShort;
    if (found->exact && packet.size() != least) return Refusal::NotKnown;
    if ((code == 0x119C || code == 0x119D) && !subpacketsFit(packet)) return Refusal::LyingSubpackets;
    return std::nullopt;
}

}  // namespace kelvo::adaptation
