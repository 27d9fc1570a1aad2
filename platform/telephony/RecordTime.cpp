#include "platform/telephony/RecordTime.h"

#include <algorithm>

namespace kelvo {

namespace {

using std::chrono::nanoseconds;
using namespace std::chrono_literals;

constexpr SystemTime kBeginning = std::chrono::sys_days(1980y / 1 / 6);
constexpr SystemTime kEarliest = std::chrono::sys_days(2010y / 1 / 1);
constexpr SystemTime kEnd = std::chrono::sys_days(2051y / 1 / 1);
constexpr nanoseconds kTick = 1'250us;
// 32 x 1,228,800 chips a second: 15,625 nanoseconds are 614.4 of them.
constexpr std::uint64_t kNanosecondsOfChips = 156'250;
constexpr std::uint64_t kChips = 6'144;
constexpr std::uint64_t kLastChip = 49'151;

}  // namespace

std::optional<SystemTime> timeOf(std::uint64_t timestamp) {
    const std::uint64_t ticks = timestamp >> 16;
    if (ticks >= static_cast<std::uint64_t>((kEnd - kBeginning) / kTick)) return std::nullopt;
    const std::uint64_t chips = timestamp & 0xFFFF;
    const SystemTime time = kBeginning + static_cast<std::int64_t>(ticks) * kTick +
                            nanoseconds(static_cast<std::int64_t>(chips * kNanosecondsOfChips / kChips));
    return time < kEarliest ? std::nullopt : std::optional(time);
}

std::uint64_t timestampOf(SystemTime time) {
    const nanoseconds since = time - kBeginning;
    const auto rest = static_cast<std::uint64_t>((since % kTick).count());
    // Rounded up, so that the way there and back gives the same tick and chip.
    const std::uint64_t chips = std::min((rest * kChips + kNanosecondsOfChips - 1) / kNanosecondsOfChips, kLastChip);
    return static_cast<std::uint64_t>(since / kTick) << 16 | chips;
}

}  // namespace kelvo
