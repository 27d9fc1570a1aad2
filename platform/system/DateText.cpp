#include "platform/system/DateText.h"

#include <array>
#include <ctime>

#include "platform/system/Environment.h"

namespace kelvo {

std::string dateDescription(Clock::TimePoint time) {
    const std::tm broken = clock().local(time);
    std::array<char, 64> text{};
    const std::size_t length = std::strftime(text.data(), text.size(), "%Y-%m-%d %H:%M:%S %z", &broken);
    return {text.data(), length};
}

}  // namespace kelvo
