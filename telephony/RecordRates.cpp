#include "telephony/RecordRates.h"

#include <algorithm>
#include <numeric>

namespace kelvo {
namespace {

constexpr std::int64_t kNoCode = -1;

}  // namespace

void RecordRates::count(std::optional<LogCode> code) {
    std::int64_t key = code ? std::int64_t{*code} : kNoCode;
    if (_counts.size() >= kMostCodes && !_counts.contains(key)) key = kNoCode;
    Counts& counts = _counts[key];
    const std::int64_t second = secondNow();
    forget(counts, second);
    ++counts.all;
    ++counts.bySecond[static_cast<std::size_t>(second % kWindow)];
}

std::vector<RecordRates::Rate> RecordRates::rates() const {
    const double seconds = std::chrono::duration<double>(_now() - _start).count();
    // The second that is still running counts by the part of it that has passed.
    const double window = std::clamp(seconds, 1.0, kWindow - 1 + (seconds - static_cast<double>(secondNow())));
    std::vector<Rate> rates;
    for (auto [key, counts] : _counts) {
        forget(counts, secondNow());
        const double recent = std::accumulate(counts.bySecond.begin(), counts.bySecond.end(), 0.0);
        const auto code = key == kNoCode ? std::nullopt : std::optional(static_cast<LogCode>(key));
        rates.push_back({code, counts.all, recent / window});
    }
    std::ranges::sort(rates, {}, &Rate::code);
    return rates;
}

std::int64_t RecordRates::secondNow() const {
    return std::chrono::duration_cast<std::chrono::seconds>(_now() - _start).count();
}

// Clears what was counted in seconds that the window has left behind.
void RecordRates::forget(Counts& counts, std::int64_t second) {
    for (std::int64_t s = std::max(counts.second + 1, second - kWindow + 1); s <= second; ++s)
        counts.bySecond[static_cast<std::size_t>(s % kWindow)] = 0;
    counts.second = second;
}

}  // namespace kelvo
