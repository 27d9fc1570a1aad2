#pragma once

#include "telephony/simulation/CDMA/PacketLink.h"
#include "telephony/simulation/CDMA/PilotSet.h"

namespace kelvo::simulation::cdma {

/// The EV-DO half of the modem: works while 1x leaves it the receiver.
class EvdoModem {
public:
    /// `air` is what it hears; both must outlive it.
    EvdoModem(const Network& network, const Reception& air, Random random);

    /// Acts on what was measured, and receives and sends the packets of `duration` when connected; `demand` is the part
    /// of the link that the user asks for, 0 to 1.
    void measure(Time duration, double demand);
    /// Moves on; `available` while 1x is idle, `browse` while the user wants data.
    void step(Time now, bool available, bool browse);

    const EvdoStatus& status() const { return _status; }
    const PacketCounters& counters() const { return _link.counters(); }

private:
    void advance(Time now, bool browse);
    void begin(Time now, EvdoState state, Time duration);
    void idle(Time now, bool browse);
    void setUpAddress();
    void readPilots();
    void placeFingers();

    const Network& _network;
    const Reception& _air;
    Random _random;
    PilotSet _pilots{kEvdoRules};
    std::vector<std::size_t> _followed;  // the pilots that the fingers were placed for
    PacketLink _link;
    EvdoStatus _status;
    Time _until{0};
    int _sessionZone = -1;
};

}  // namespace kelvo::simulation::cdma
