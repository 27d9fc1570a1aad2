#include "telephony/simulation/PhoneUser.h"

namespace kelvo::simulation {

void PhoneUser::moveTo(Time now) {
    if (now >= _until) change(now);
    if (!isResting() && now >= _turnUntil) takeTurn(now);
}

void PhoneUser::change(Time now) {
    _isPausing = true;
    _demand = 0;
    if (!isResting()) {
        _activity = Activity::Resting;
        _until = now + fromSeconds(_random.between(5.0, 16.0));
        return;
    }
    const bool talks = _activities++ % 3 == 1;  // pages, a call, pages, and again
    _activity = talks ? Activity::Talking : Activity::Browsing;
    _until = now + fromSeconds(talks ? _random.between(15.0, 35.0) : _random.between(12.0, 25.0));
    _sessions += isBrowsing();
    _turnUntil = now;
}

void PhoneUser::takeTurn(Time now) {
    _isPausing = !_isPausing && _random.chance(0.4);
    _demand = isBrowsing() && !_isPausing ? _random.between(0.2, 0.9) : 0;
    _turnUntil = now + fromSeconds(_random.between(0.5, 3.0));
}

}  // namespace kelvo::simulation
