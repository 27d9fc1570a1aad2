#include "platform/system/Clock.h"

namespace kelvo {

std::tm SystemClock::local(TimePoint time) const {
    const std::time_t seconds = std::chrono::system_clock::to_time_t(time);
    std::tm broken{};
    localtime_r(&seconds, &broken);
    return broken;
}

}  // namespace kelvo
