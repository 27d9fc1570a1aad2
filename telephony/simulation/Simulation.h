#pragma once

#include <deque>
#include <utility>

#include "platform/telephony/Technology.h"
#include "platform/values/Bytes.h"
#include "telephony/simulation/Time.h"

namespace kelvo::simulation {

/// A simulated modem: its phone drives through a town without end, and it writes the log that a modem would.
/// The same seed gives the same messages at the same times, byte for byte.
class Simulation {
public:
    struct Message {
        Time time;  ///< since the drive began; never before the message before
        Bytes bytes;
    };

    virtual ~Simulation() = default;
    Simulation(const Simulation&) = delete;
    Simulation& operator=(const Simulation&) = delete;

    virtual Technology technology() const = 0;

    /// The next message. After it the world stands as the message tells it: a family's state is read between two calls.
    Message next();

protected:
    /// How often the world moves on.
    static constexpr Time kStep = std::chrono::milliseconds(20);

    Simulation() = default;

    Time now() const { return _now; }
    /// True once in each `period`, a whole number of steps, at `phase` into it.
    bool every(Time period, Time phase = Time(0)) const { return _now % period == phase; }
    void emit(Bytes message) { _waiting.push_back({_now, std::move(message)}); }

    /// Moves the world on to now() and emits what the modem reports of it.
    virtual void step() = 0;

private:
    Time _now{-kStep.count()};
    std::deque<Message> _waiting;
};

}  // namespace kelvo::simulation
