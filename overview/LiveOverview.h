#pragma once

#include <cstdint>
#include <deque>
#include <optional>
#include <string>

#include "model/KelvoModel.h"
#include "model/Trend.h"
#include "overview/Tracker.h"

namespace kelvo::overview {

/// The overview of a model that runs: told of each refresh, it follows the values whether anybody looks at it or not.
///
/// Two clocks, as elsewhere in the program: ages and the time after which a cell is lost go by the stream's time, so
/// that a replay at ten times the speed ages ten times as fast; the two-minute lines go by the main queue's, as all
/// trends do. Events bear the time of day at which they were seen. Main queue only.
class LiveOverview {
public:
    static constexpr Trend::Time kSpan = std::chrono::minutes(2);  ///< of the lines
    static constexpr std::size_t kMostPoints = 128;                ///< of each; refreshes come every two seconds

    /// Of several carriers the serving one is told again within it: a refresh shows the last of many records. Still
    /// shorter than a level is fresh, so that a change after it is the handover that it was.
    static constexpr auto kTurn = std::chrono::seconds(27);

    struct Point {
        Trend::Time at{0};
        double number = 0;  ///< in the line's unit
    };
    /// How the serving cell's level or quality has gone: one reading for each refresh at which a record had written it.
    /// From one to the next longer than `Trend::kGap` none had, and the line breaks.
    struct Line {
        std::string name = {};          ///< "RSRP"; empty while there is none
        std::string unit = {};          ///< empty for a plain number
        std::deque<Point> points = {};  ///< oldest first, of the last two minutes
        std::uint64_t lastRecord = 0;   ///< which wrote the last of them
    };

    /// The model outlives it.
    explicit LiveOverview(const KelvoModel& model) : _model(model) {}

    /// The model's refresh: takes up what the screens show now.
    void refreshed();
    /// The model's connection has come or gone, or something else is to be said of it.
    void connectionChanged();
    /// Time goes by while nothing comes, which the owner tells every two seconds or so: cells get lost, lines wander.
    void letPass();

    /// What is seen now, the cells around, and what happened.
    const Tracker& tracker() const { return _tracker; }
    /// The time to which ages are counted: `now() - *tracker().levelTime()`, `now() - cell.lastHeard`.
    Time now() const;
    /// None while no record has written the figure.
    std::optional<Time::duration> levelAge() const { return ageOf(_tracker.levelTime()); }
    std::optional<Time::duration> qualityAge() const { return ageOf(_tracker.qualityTime()); }

    const Line& level() const { return _level; }
    const Line& quality() const { return _quality; }
    /// When another cell began to serve within the last two minutes, and which; oldest first, at most `kMostPoints`.
    const std::deque<TrendChange>& servingCells() const { return _servingCells; }
    /// The right end of the lines.
    Trend::Time lineTime() const { return _model.trendTime(); }

private:
    std::optional<Time::duration> ageOf(std::optional<Time> then) const;
    void noteConnection();
    bool isOfThisModem();
    void extend(Line& line, const std::optional<Measure>& measure);
    void noteServingCell(const std::string& before);
    void forgetOld();

    const KelvoModel& _model;
    Tracker _tracker{Tracker::Limits{.turn = kTurn}};
    Time _latest{};  // the stream's time never goes back here
    Line _level;
    Line _quality;
    std::deque<TrendChange> _servingCells;
    std::optional<Technology> _technology;  // which the values are of
    std::uint64_t _exchangedAt = 0;         // the records up to this one are another modem's
    std::uint64_t _connections = 0;         // how many had come at the last look
    std::optional<Trend::Time> _lostSince;  // the connection
};

}  // namespace kelvo::overview
