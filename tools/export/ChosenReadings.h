#pragma once

#include <chrono>
#include <optional>
#include <vector>

#include "tools/export/ReadingRows.h"

namespace kelvo {

/// Which readings the user wants.
struct Choice {
    std::optional<CaptureTime> from{};                ///< nothing earlier
    std::optional<CaptureTime> to{};                  ///< nothing as late or later
    bool changes = false;                             ///< only those that differ from the one before
    std::optional<std::chrono::nanoseconds> every{};  ///< of each value the last of each interval of this length
    bool isOneMoment = false;                         ///< what an interval gives goes into one line, at its last time
};

/// Hands on the readings of the user's choice. Intervals begin at whole multiples of their length since 1970; one is
/// over with the first record of another.
class ChosenReadings {
public:
    /// `rows` outlives it.
    ChosenReadings(const Choice& choice, ReadingRows& rows) : _choice(choice), _rows(rows) {}

    /// Whether readings of that time may be asked for.
    bool wants(CaptureTime time) const {
        return (!_choice.from || time >= *_choice.from) && (!_choice.to || time < *_choice.to);
    }
    void take(const Moment& moment, std::span<const Written> readings);
    /// Hands on what waits for the end of its interval; no series is held any more.
    void endInterval();

private:
    struct Held {
        Moment moment;
        Series* series;
        Value value;
    };

    std::span<const Written> changed(std::span<const Written> readings);
    void hold(const Moment& moment, std::span<const Written> readings);

    const Choice _choice;
    ReadingRows& _rows;
    std::vector<Written> _chosen;
    std::vector<Held> _held;
    std::int64_t _interval = 0;  // the number of the one that is held
};

}  // namespace kelvo
