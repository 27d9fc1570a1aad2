#pragma once

#include "telephony/simulation/CDMA/EvdoModem.h"
#include "telephony/simulation/CDMA/OneXModem.h"
#include "telephony/simulation/PhoneUser.h"

namespace kelvo::simulation::cdma {

/// A hybrid CDMA2000 modem: 1x, on whose calls EV-DO leaves it the receiver, and EV-DO.
class Modem {
public:
    /// `network` must outlive it.
    Modem(const Network& network, Random random) : _oneX(network, random.split()), _evdo(network, random.split()) {}

    /// Reads the air; `demand` is the part of the link that the user asks for until `duration` from now, 0 to 1.
    void measure(const Drive& drive, Time duration, double demand) {
        _oneX.measure(drive);
        _evdo.measure(drive, duration, demand);
    }
    /// Moves on to then, one step after the last time.
    void step(Time now, PhoneUser::Activity activity) {
        _oneX.step(now, activity == PhoneUser::Activity::Talking);
        _evdo.step(now, _oneX.isIdle(), activity == PhoneUser::Activity::Browsing);
    }
    /// The next 1x traffic frame of 20 ms comes.
    void receiveFrame() { _oneX.receiveFrame(); }

    const OneXModem& oneX() const { return _oneX; }
    const EvdoModem& evdo() const { return _evdo; }

private:
    OneXModem _oneX;
    EvdoModem _evdo;
};

}  // namespace kelvo::simulation::cdma
