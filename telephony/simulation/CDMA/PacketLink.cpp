#include "telephony/simulation/CDMA/PacketLink.h"

#include <algorithm>
#include <cmath>

#include "telephony/simulation/Propagation.h"

namespace kelvo::simulation::cdma {
namespace {

constexpr double kSlotsPerSecond = 600;
constexpr double kChipRate = 1.2288e6;
constexpr double kForwardLost = 0.01;     // of all packets
constexpr double kSmallPackets = 0.15;    // of all packets: for several users, or the end of something
constexpr double kPacketsPerSecond = 60;  // reverse: 150 sub-packets, of which a packet takes 2.5
constexpr double kReverseLost = 0.02;
constexpr double kRateStep = 2.5;       // dB of power from one packet size to the next
constexpr std::size_t kLowLatency = 4;  // the sizes below are sent in a hurry

/// The fastest format that a carrier-to-interference ratio allows; the null rate when it allows none.
std::size_t formatFor(double carrierToInterference) {
    const double capacity = linkCapacity(kChipRate, carrierToInterference);
    const auto rate = [](const ForwardFormat& format) { return format.bits.back() * kSlotsPerSecond / format.slots; };
    std::size_t best = 0;
    for (std::size_t i = 1; i < kForwardFormats.size(); ++i) {
        const double candidate = rate(kForwardFormats[i]);
        if (candidate <= capacity && (best == 0 || candidate > rate(kForwardFormats[best]))) best = i;
    }
    return best;
}

/// Takes the whole packets out of what has come together.
int takeWhole(double& packets) {
    const double whole = std::floor(packets);
    packets -= whole;
    return static_cast<int>(whole);
}

}  // namespace

void PacketLink::receive(double carrierToInterference, double share, Time duration) {
    const std::size_t format = formatFor(carrierToInterference);
    _forwardRest += share * seconds(duration) * kSlotsPerSecond / kForwardFormats[format].slots;
    for (int left = takeWhole(_forwardRest); left > 0; --left) receivePacket(format);
}

void PacketLink::receivePacket(std::size_t format) {
    auto& counters = _counters.forward[format];
    if (_random.chance(kForwardLost)) {
        ++counters.lost;
        return;
    }
    const auto& sizes = kForwardFormats[format].bits;
    auto size = static_cast<std::size_t>(_random.chance(kSmallPackets) ? _random.between(0, 3) : 3);
    while (sizes[size] == 0) ++size;
    ++counters.received[size];
    _counters.forwardBits += static_cast<std::uint64_t>(sizes[size]);
}

void PacketLink::send(double headroom, double share, Time duration) {
    const int largest = static_cast<int>(kReverseBits.size()) - 1;
    const int allowed = std::clamp(static_cast<int>(headroom / kRateStep), 0, largest);
    _reverseRest += share * seconds(duration) * kPacketsPerSecond;
    for (int left = takeWhole(_reverseRest); left > 0; --left) {
        sendPacket(static_cast<std::size_t>(_random.between(std::max(0, allowed - 4), allowed)));
    }
}

void PacketLink::sendPacket(std::size_t size) {
    _interlace = (_interlace + 1) % PacketCounters::kInterlaces;
    const bool hurried = size < kLowLatency;
    auto& counters = (hurried ? _counters.lowLatency : _counters.highCapacity)[static_cast<std::size_t>(_interlace)];
    if (_random.chance(kReverseLost)) {
        ++counters[size].lost;
        return;
    }
    ++counters[size].acknowledged[static_cast<std::size_t>(hurried ? _random.between(0, 1) : _random.between(0, 3))];
    _counters.reverseBits += static_cast<std::uint64_t>(kReverseBits[size]);
}

}  // namespace kelvo::simulation::cdma
