#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <vector>

#include "telephony/simulation/RadioNumbers.h"

/// What a CDMA2000 modem reports, in physical units: the records are made of it.
namespace kelvo::simulation::cdma {

/// One pilot as the searcher reads it.
struct PilotReading {
    PnOffset pn;
    double strength = 0;  ///< Ec/Io in dB
};

/// The states of 1x call processing that the phone comes through, with the modem's numbers.
enum class OneXState {
    Initial = 2,
    Acquisition = 3,
    Sync = 4,
    Slew = 5,
    Paging = 6,
    Sleep = 7,
    Traffic = 8,
    Powerup = 11
};

struct OneXStatus {
    OneXState state = OneXState::Powerup;
    double rx0 = 0;  ///< dBm, all that is received within the carrier
    double rx1 = 0;  ///< dBm; the second antenna, in use in traffic alone
    double tx = 0;   ///< dBm; in traffic alone
    std::vector<PilotReading> active;
    PnOffset referencePn;      ///< of one of the active ones
    bool frameErased = false;  ///< the last traffic frame did not decode
};

/// What a base station says of itself and its system, and what the phone's roaming list makes of it.
struct System {
    static constexpr int kNone = 0;  ///< no service
    static constexpr int kCdma = 2;

    int type = kNone;
    int sid = 0;
    int nid = 0;
    int packetZone = 0;
    int baseId = 0;
    int protocolRevision = 0;
    int roamingIndicator = 0;
    bool operator==(const System&) const = default;
};

enum class EvdoState { Inactive = 0, Acquisition = 1, Sync = 2, Idle = 3, Access = 4, Connected = 5 };
enum class SessionState { Closed = 0, AddressSetup = 1, PhoneNegotiates = 2, NetworkNegotiates = 3, Open = 4 };

/// One correlator of the rake receiver.
struct Finger {
    std::optional<PnOffset> pn = {};   ///< none: it follows no path
    double carrierToInterference = 0;  ///< dB
};

struct EvdoStatus {
    EvdoState state = EvdoState::Inactive;
    SessionState session = SessionState::Closed;
    double rx0 = 0;  ///< dBm
    double rx1 = 0;  ///< dBm; meant in Access and Connected alone, as is `tx`
    double tx = 0;   ///< dBm
    std::optional<PnOffset> servingPn;
    std::uint32_t uati = 0;  ///< the lower 24 bits of the session's address
    int colorCode = 0;       ///< of the subnet that gave the address
    std::vector<PilotReading> active;
    std::vector<Finger> fingers;
};

/// One format of the forward traffic channel of 3GPP2 C.S0024-A: what the phone may ask for (DRC).
struct ForwardFormat {
    int slots;                ///< of 1/600 s each, that a packet of the largest size takes
    std::array<int, 4> bits;  ///< of the packets sent in it, the largest last; 0 where it has fewer sizes
};
// clang-format off
inline constexpr std::array<ForwardFormat, 15> kForwardFormats{{  // by DRC index
    { 16, {128, 256,  512, 1024} },  // 0, the null rate
    { 16, {128, 256,  512, 1024} },  // 38.4 kbit/s
    {  8, {128, 256,  512, 1024} },  // 76.8
    {  4, {128, 256,  512, 1024} },  // 153.6
    {  2, {128, 256,  512, 1024} },  // 307.2
    {  4, {  0, 512, 1024, 2048} },  // 307.2
    {  1, {128, 256,  512, 1024} },  // 614.4
    {  2, {  0, 512, 1024, 2048} },  // 614.4
    {  2, {  0,   0, 1024, 3072} },  // 921.6
    {  1, {  0, 512, 1024, 2048} },  // 1228.8
    {  2, {  0,   0,    0, 4096} },  // 1228.8
    {  1, {  0,   0, 1024, 3072} },  // 1843.2
    {  1, {  0,   0,    0, 4096} },  // 2457.6
    {  2, {  0,   0,    0, 5120} },  // 1536.0
    {  1, {  0,   0,    0, 5120} },  // 3072.0
}};
/// Packet sizes of the reverse traffic channel of 3GPP2 C.S0024-A, in bits.
inline constexpr std::array kReverseBits{128, 256, 512, 768, 1024, 1536, 2048, 3072, 4096, 6144, 8192, 12288};
// clang-format on

/// Packets since the modem began; no session and no call ever resets them.
struct PacketCounters {
    struct Forward {
        std::array<std::uint32_t, 4> received{};  ///< by the format's sizes
        std::uint32_t lost = 0;
    };
    struct Reverse {
        std::array<std::uint32_t, 4> acknowledged{};  ///< by the sub-packets it took, 1 to 4
        std::uint32_t lost = 0;                       ///< not even after the fourth
    };
    static constexpr int kInterlaces = 3;
    using Sizes = std::array<Reverse, kReverseBits.size()>;

    std::array<Forward, kForwardFormats.size()> forward{};
    std::array<Sizes, kInterlaces> highCapacity{};
    std::array<Sizes, kInterlaces> lowLatency{};
    std::uint64_t forwardBits = 0;  ///< in packets received
    std::uint64_t reverseBits = 0;  ///< in packets acknowledged
};

}  // namespace kelvo::simulation::cdma
