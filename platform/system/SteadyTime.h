#pragma once

#include <chrono>
#include <functional>

namespace kelvo {

/// Time that only goes forward, from any beginning. Handed to whoever measures, so that tests move it by hand.
using SteadyTime = std::function<std::chrono::nanoseconds()>;

/// The machine's.
inline std::chrono::nanoseconds steadyNow() { return std::chrono::steady_clock::now().time_since_epoch(); }

}  // namespace kelvo
