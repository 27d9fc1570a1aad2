#include "telephony/simulation/PhoneUser.h"

namespace kelvo::simulation {

PhoneUser::Activity PhoneUser::at(Time now) {
    if (now >= _until) change(now);
    if (_activity != Activity::Browsing) {
        _demand = 0;
    } else if (now >= _askedUntil) {
        ask(now);
    }
    return _activity;
}

void PhoneUser::change(Time now) {
    if (_activity != Activity::Resting) {
        _activity = Activity::Resting;
        _until = now + fromSeconds(_random.between(5.0, 12.0));
        return;
    }
    const bool talks = _activities++ % 3 == 1;  // pages, a call, pages, and again
    _activity = talks ? Activity::Talking : Activity::Browsing;
    _until = now + fromSeconds(talks ? _random.between(15.0, 35.0) : _random.between(12.0, 25.0));
    _askedUntil = now;
}

void PhoneUser::ask(Time now) {
    const bool reads = _demand > 0 && _random.chance(0.4);
    _demand = reads ? 0 : _random.between(0.2, 0.9);
    _askedUntil = now + fromSeconds(_random.between(0.5, 3.0));
}

}  // namespace kelvo::simulation
