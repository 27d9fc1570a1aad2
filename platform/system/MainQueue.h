#pragma once

#include <chrono>
#include <functional>
#include <memory>

namespace kelvo {

/// A repeating timer that runs on the main queue; destroying it stops it.
class RepeatingTimer {
public:
    virtual ~RepeatingTimer() = default;
};

/// The one queue on which all of the program's work runs, in order. Main thread only.
class MainQueue {
public:
    using Task = std::function<void()>;

    virtual ~MainQueue() = default;

    /// Runs `task` once after the current one has returned.
    virtual void post(Task task) = 0;
    /// Runs `task` once, `delay` from now.
    virtual void postAfter(std::chrono::nanoseconds delay, Task task) = 0;
    /// Runs `task` every `interval`, first one interval from now, until the timer is destroyed. The task may destroy
    /// it.
    virtual std::unique_ptr<RepeatingTimer> repeat(std::chrono::nanoseconds interval, Task task) = 0;

    /// The time by which the queue waits: it only goes forward, from any beginning.
    virtual std::chrono::nanoseconds now() const = 0;
};

}  // namespace kelvo
