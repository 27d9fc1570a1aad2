#pragma once

#include "telephony/simulation/Random.h"
#include "telephony/simulation/Time.h"

namespace kelvo::simulation {

/// The person who carries the phone, and uses it in turns: rests, reads pages, talks.
class PhoneUser {
public:
    enum class Activity { Resting, Browsing, Talking };

    /// One who rests until `first`, and then browses.
    PhoneUser(Random random, Time first) : _random(std::move(random)), _until(first) {}

    /// Moves on to then; never back.
    void moveTo(Time now);

    Activity activity() const { return _activity; }
    bool isResting() const { return _activity == Activity::Resting; }
    bool isBrowsing() const { return _activity == Activity::Browsing; }
    bool isTalking() const { return _activity == Activity::Talking; }
    /// In a call: the other one speaks.
    bool isListening() const { return isTalking() && _isPausing; }
    /// The share of the link that they need at the moment, 0 to 1: for loading a page much, for reading it and for a
    /// call none.
    double demand() const { return _demand; }
    /// How often browsing has begun.
    int sessions() const { return _sessions; }

private:
    void change(Time now);
    void takeTurn(Time now);

    Random _random;
    Activity _activity = Activity::Resting;
    Time _until;
    Time _turnUntil{0};
    int _activities = 0;
    int _sessions = 0;
    bool _isPausing = true;  // reads, or listens
    double _demand = 0;
};

}  // namespace kelvo::simulation
