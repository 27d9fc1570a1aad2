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
    static constexpr auto kHeardFor = std::chrono::seconds(30);     ///< a cell stays that long after it was heard
    static constexpr auto kLostFor = std::chrono::seconds(10);      ///< and that much longer, marked
    static constexpr auto kSettling = std::chrono::seconds(2);      ///< within which several records tell of one change
    static constexpr auto kTurn = std::chrono::milliseconds(500);   ///< of carriers, where every record is seen
    static constexpr auto kMoment = std::chrono::milliseconds(10);  ///< within which all belong to one step of a modem
    static constexpr double kSteady = 2.0;                          ///< dB by which a cell overtakes the one above

    struct Limits {
        std::size_t events = 2000;
        Time::duration span = std::chrono::hours(24);  ///< of them
        /// Of several carriers that are told in turn, the serving one is told again within it. Who sees one record of
        /// many must wait for longer.
        Time::duration turn = kTurn;
    };

    Tracker() = default;
    /// Keeps other numbers of events; a list on paper wants them all.
    explicit Tracker(Limits limits) : _limits(limits) {}

    /// What the screens show at `now`.
    void note(Observation seen, Time now) { note(std::move(seen), now, now); }
    /// The same where `now` is no time of day; events are told with that of `clock`, which may be set.
    void note(Observation seen, Time now, Time clock);
    /// Nothing is new at `now`: cells around get lost and go.
    void letPass(Time now);
    /// The connection to the telephony service has gone, or come back after so long.
    void noteConnectionLost(Time clock);
    void noteConnectionBack(Time clock, Time::duration lost);
    /// Another modem's values follow: only what happened stays.
    void restart();

    const Observation& latest() const { return _seen; }
    /// When a record wrote the serving cell's level, or quality, last.
    std::optional<Time> levelTime() const { return _level.time; }
    std::optional<Time> qualityTime() const { return _quality.time; }
    /// Strongest first, in an order that small differences do not change; cells without a level last.
    const std::vector<TrackedCell>& cells() const { return _cells; }
    /// Oldest first.
    const std::deque<Event>& events() const { return _events; }
    /// How many there have been, those that are no longer kept among them.
    std::uint64_t eventCount() const { return _eventCount; }

private:
    /// The serving cell's level or quality.
    struct Followed {
        std::optional<Time> time = {};  // when a record wrote it last
        std::uint64_t record = 0;       // which
        std::string text = {};          // as it was last while this cell served
        bool isAwaited = false;         // the last change of cell has none after it yet
    };

    void noteCells();
    void keepServing();
    void noteServing();
    void noteWhetherHandover();
    Event* unfinished(bool isCell, const std::string& before, const std::string& now);
    static void complete(Event& event, std::string_view name, const std::string& now);
    void noteStates();
    void noteArea();
    void noteContexts();
    void noteService();
    void noteFigure(Followed& followed, const std::optional<Measure>& now, bool isLevel);
    void fillIn(const Measure& figure, bool isLevel);
    void noteChange(Event::Kind kind, const std::string& from, const std::string& to);
    bool isFresh(const Followed& figure) const { return figure.time && _now - *figure.time <= kHeardFor; }
    std::vector<EventValue> valuesAround() const;
    void addFigure(std::vector<EventValue>& values, const Followed& followed, const std::optional<Measure>& before,
                   const std::optional<Measure>& after) const;
    void happened(Event event);
    void append(Event event);

    Limits _limits;
    Observation _before;
    Observation _seen;
    Time _now{};
    Time _clock{};
    std::vector<TrackedCell> _cells;
    std::deque<Event> _events;
    std::uint64_t _eventCount = 0;
    Followed _level;
    Followed _quality;
    std::string _area;                      // the last that was known
    Time _servingTold{};                    // when a record named the serving cell last
    std::uint64_t _carrierRecord = 0;       // the last that named it or another carrier's
    std::optional<Time> _connectedSince;    // as the last state said that was known
    std::optional<Time> _leftConnected;     // a cell, and the state in the new one is not known yet
    std::optional<bool> _isWithoutService;  // none while the screens have not told
    Time _lostSince{};                      // service
};

}  // namespace kelvo::overview
