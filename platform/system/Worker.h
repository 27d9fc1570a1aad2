#pragma once

#include <functional>

namespace kelvo {

/// Takes long work off the main queue.
class Worker {
public:
    using Task = std::function<void()>;

    virtual ~Worker() = default;

    /// Runs `work` beside the main queue and then `done` on it. Call on the main queue; one piece of work runs at a
    /// time, in order. What `work` throws comes to the main queue in place of `done`.
    virtual void run(Task work, Task done) = 0;
};

}  // namespace kelvo
