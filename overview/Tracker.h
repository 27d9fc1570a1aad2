#pragma once

#include <deque>
#include <optional>
#include <string>
#include <vector>

#include "overview/Event.h"
#include "overview/Observation.h"

namespace kelvo::overview {

/// A cell around the serving one, whatever list and position its records gave it.
struct TrackedCell {
    HeardCell heard;  ///< as it was heard last
    Time lastHeard;
    bool isLost = false;  ///< not heard for 30 s
};

/// Follows the screens from moment to moment: which cells are around, and what happened. Main queue only; time is the
/// caller's and does not go back.
class Tracker {
public:
    static constexpr auto kHeardFor = std::chrono::seconds(30);  ///< a cell stays that long after it was heard
    static constexpr auto kLostFor = std::chrono::seconds(10);   ///< and that much longer, marked
    static constexpr double kSteady = 2.0;                       ///< dB by which a cell overtakes the one above

    struct Limits {
        std::size_t events = 2000;
        Time::duration span = std::chrono::hours(24);  ///< of them
    };

    Tracker() = default;
    /// Keeps other numbers of events; a list on paper wants them all.
    explicit Tracker(Limits limits) : _limits(limits) {}

    /// What the screens show at `now`.
    void note(Observation seen, Time now);

    const Observation& latest() const { return _seen; }
    /// When a record wrote the serving cell's level last.
    std::optional<Time> levelTime() const { return _levelTime; }
    /// Strongest first, in an order that small differences do not change; cells without a level last.
    const std::vector<TrackedCell>& cells() const { return _cells; }
    /// Oldest first.
    const std::deque<Event>& events() const { return _events; }

private:
    void noteCells(Time now);
    void noteServing(const Observation& before, Time now);
    void noteStates(const Observation& before, Time now);
    void noteContexts(const Observation& before, Time now);
    void noteService(const Observation& before, Time now);
    void noteLevel(Time now);
    void noteChange(Event::Kind kind, const std::string& from, const std::string& to, Time now);
    void happened(Event event);

    Limits _limits;
    Observation _seen;
    std::vector<TrackedCell> _cells;
    std::deque<Event> _events;
    std::optional<Time> _levelTime;
    std::uint64_t _levelRecord = 0;
    std::string _level;              // of the serving cell, as it was last
    bool _awaitsLevel = false;       // the last change of cell has no level after it yet
    bool _isBegun = false;           // something has been noted
    std::optional<Time> _lostSince;  // service
};

}  // namespace kelvo::overview
