#pragma once

#include "telephony/simulation/CDMA/PilotSet.h"

namespace kelvo::simulation::cdma {

/// The 1x half of the modem: finds the system, sleeps between its paging slots, hands off, registers, talks.
class OneXModem {
public:
    /// `air` is what it hears; both must outlive it.
    OneXModem(const Network& network, const Reception& air, Random random);

    /// Acts on what was measured; all of the status but its state is as read last.
    void measure();
    /// Moves on; `talk` while the user wants a call.
    void step(Time now, bool talk);
    /// The next traffic frame of 20 ms comes.
    void receiveFrame();

    const OneXStatus& status() const { return _status; }
    /// Of the last sector whose overhead messages have been read.
    const System& system() const { return _system; }
    int registrations() const { return _registrations; }
    /// The receiver is free for EV-DO.
    bool isIdle() const;

private:
    /// What keeps an idle phone from sleeping.
    enum class Task { None, Overhead, Registration, Access };

    void begin(Time now, OneXState state, Time duration);
    void begin(Time now, Task task, Time duration);
    void powerUp(Time now);
    void finishTask();
    void idle(Time now, bool talk);
    void readPilots();

    const Network& _network;
    const Reception& _air;
    Random _random;
    PilotSet _pilots{kOneXRules};
    OneXStatus _status;
    System _system;
    Task _task = Task::None;
    Time _until = std::chrono::milliseconds(100);
    int _registeredZone = -1;
    int _registrations = 0;
};

}  // namespace kelvo::simulation::cdma
