#pragma once

#include "telephony/simulation/CDMA/EvdoModem.h"
#include "telephony/simulation/CDMA/OneXModem.h"
#include "telephony/simulation/PhoneUser.h"

namespace kelvo::simulation::cdma {

/// A hybrid CDMA2000 modem: 1x, on whose calls EV-DO leaves it the receiver, and EV-DO.
class Modem {
public:
    static constexpr Time kMeasurement = std::chrono::milliseconds(100);

    /// Both must outlive it.
    Modem(const Network& network, const Air& air, Random random)
        : _oneX(network, air.oneX(), random.split()), _evdo(network, air.evdo(), random.split()) {}

    /// Moves on to then, one step after the last time; `hasMeasured`, as after each kMeasurement: the air was read
    /// anew.
    void step(Time now, const PhoneUser& user, bool hasMeasured) {
        if (hasMeasured) {
            _oneX.measure();
            _evdo.measure(kMeasurement, user.demand());
        }
        _oneX.step(now, user.isTalking());
        _evdo.step(now, _oneX.isIdle(), user.isBrowsing());
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
