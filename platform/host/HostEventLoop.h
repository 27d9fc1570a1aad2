#pragma once

#include <functional>

namespace kelvo {

/// The event loop behind the main queue. Qt cannot carry an exception through a loop (it warns, and leaves its own
/// state behind), so callbacks run through `call`: one that throws ends the loop, later ones no longer run, and `run`
/// throws what it threw. Main thread only.
class HostEventLoop {
public:
    /// Runs the loop with `exec` (an application class's) until the program quits; its exit status. Throws what a
    /// callback threw, also one that was called before the loop began.
    static int run(int (*exec)());
    /// Runs `callback`; does nothing once one has thrown.
    static void call(const std::function<void()>& callback);
};

}  // namespace kelvo
