#pragma once

#include <chrono>
#include <optional>
#include <string>

#include "telephony/wire/PortCounts.h"

namespace kelvo::wire {

/// Tells when a port begins to lose something, and when that has ended: five seconds without a loss. Time is handed in.
class LossMeter {
public:
    using nanoseconds = std::chrono::nanoseconds;

    /// Looks at the counts after something was read: the line to log, none mostly.
    std::optional<std::string> update(const PortCounts& counts, nanoseconds now);
    /// The port is closed: the line that ends a loss, none when nothing was lost of late.
    std::optional<std::string> finish(const PortCounts& counts);
    /// When to look again though nothing was read; none while nothing is lost.
    std::optional<nanoseconds> deadline() const;
    bool isLosing() const { return _losing; }

private:
    static std::uint64_t lossOf(const PortCounts& counts) { return counts.damaged() + counts.textsDropped; }

    bool _losing = false;
    PortCounts _before;  // the loss began
    std::uint64_t _last = 0;
    nanoseconds _lastLoss{0};
};

}  // namespace kelvo::wire
