#pragma once

#include "telephony/simulation/CDMA/Reports.h"
#include "telephony/simulation/Random.h"
#include "telephony/simulation/Time.h"

namespace kelvo::simulation::cdma {

/// The packets of an EV-DO connection, counted for as long as the modem runs.
class PacketLink {
public:
    explicit PacketLink(Random random) : _random(std::move(random)) {}

    /// Receives for `duration` with this carrier-to-interference ratio in dB; `share` is the part of the sector's time
    /// that the phone has, 0 to 1.
    void receive(double carrierToInterference, double share, Time duration);
    /// Sends for `duration` with `headroom` dB of power left above the pilot's; `share` as above.
    void send(double headroom, double share, Time duration);

    const PacketCounters& counters() const { return _counters; }

private:
    void receivePacket(std::size_t format);
    void sendPacket(std::size_t size);

    Random _random;
    PacketCounters _counters;
    double _forwardRest = 0;  // of a packet that is under way
    double _reverseRest = 0;
    int _interlace = 0;
};

}  // namespace kelvo::simulation::cdma
