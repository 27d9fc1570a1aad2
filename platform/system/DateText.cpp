#include "platform/system/DateText.h"

#include <array>
#include <ctime>

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

constexpr const char* kFormat = "%Y-%m-%d %H:%M:%S %z";

std::string described(const std::tm& broken) {
    std::array<char, 64> text{};
    const std::size_t length = std::strftime(text.data(), text.size(), kFormat, &broken);
    return {text.data(), length};
}

}  // namespace

std::string dateDescription(Clock::TimePoint time) { return described(clock().local(time)); }

std::string utcDateDescription(Clock::TimePoint time) {
    const std::time_t seconds = std::chrono::system_clock::to_time_t(time);
    std::tm broken{};
    gmtime_r(&seconds, &broken);
    return described(broken);
}

std::optional<std::chrono::sys_seconds> dateFromDescription(const std::string& text) {
    std::tm broken{};
    if (strptime(text.c_str(), kFormat, &broken) == nullptr) return std::nullopt;
    const long eastOfUtc = broken.tm_gmtoff;  // which timegm clears
    return std::chrono::sys_seconds(std::chrono::seconds(timegm(&broken) - eastOfUtc));
}

}  // namespace kelvo
