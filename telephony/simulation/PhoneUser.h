#pragma once

#include "telephony/simulation/Random.h"
#include "telephony/simulation/Time.h"

namespace kelvo::simulation {

/// What the one who carries the phone does with it: rests, reads pages, talks.
class PhoneUser {
public:
    enum class Activity { Resting, Browsing, Talking };

    explicit PhoneUser(Random random) : _random(std::move(random)) {}

    /// What they do at that time; never earlier than the time before.
    Activity at(Time now);
    /// The part of the link that what they do asks for, 0 to 1: reading needs none, a page much.
    double demand() const { return _demand; }

private:
    void change(Time now);
    void ask(Time now);

    Random _random;
    Activity _activity = Activity::Resting;
    Time _until = std::chrono::seconds(4);
    Time _askedUntil{0};
    int _activities = 0;
    double _demand = 0;
};

}  // namespace kelvo::simulation
