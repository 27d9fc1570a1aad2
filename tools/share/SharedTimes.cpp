#include "tools/share/SharedTimes.h"

#include <algorithm>

#include "platform/telephony/RecordTime.h"

namespace kelvo {

namespace {

constexpr SharedTimes::Time kStart = std::chrono::sys_days(std::chrono::year(2020) / 1 / 1);
constexpr std::uint64_t kTenYears = std::uint64_t{800} * 86'400 * 3'653;  // in the modem's ticks

}  // namespace

SharedTimes::Time SharedTimes::host(Time time) {
    if (!_shift) return time;
    if (!_firstHost) _firstHost = time;
    return std::max(kStart + (time - *_firstHost), Time());
}

std::uint64_t SharedTimes::modem(std::uint64_t timestamp) {
    if (!_shift) return timestamp;
    if (!timeOf(timestamp)) return timestamp >> 16 < kTenYears ? timestamp : 0;
    if (!_firstModem) _firstModem = timestamp;
    const std::uint64_t shifted = timestampOf(kStart) + (timestamp >> 16 << 16) - (*_firstModem >> 16 << 16);
    return shifted | (timestamp & 0xFFFF);
}

}  // namespace kelvo
