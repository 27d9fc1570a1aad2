#include "tools/import/TimeOption.h"

#include <algorithm>

#include "platform/encodings/IsoDate.h"

namespace kelvo {

namespace {

using namespace std::chrono_literals;
using std::chrono::nanoseconds;

/// What stands between the seconds and the Z: ".750", at most nine digits, or nothing; none when it is anything else.
std::optional<nanoseconds> fractionOf(std::string_view text) {
    if (text.empty()) return nanoseconds(0);
    const auto isDigit = [](char c) { return c >= '0' && c <= '9'; };
    if (text.front() != '.' || text.size() < 2 || text.size() > 10) return std::nullopt;
    if (!std::ranges::all_of(text.substr(1), isDigit)) return std::nullopt;
    std::string digits(text.substr(1));
    digits.resize(9, '0');
    return nanoseconds(std::stol(digits));
}

std::optional<CaptureTime> timeOf(const std::string& text) {
    constexpr std::size_t kToSeconds = 19;  // "2014-08-29T20:51:07"
    if (text.size() == 10) return timeOf(text + "T00:00:00Z");
    if (text.size() <= kToSeconds || text.back() != 'Z') return std::nullopt;
    const auto fraction = fractionOf(std::string_view(text).substr(kToSeconds, text.size() - kToSeconds - 1));
    const auto date = dateFromIso(text.substr(0, kToSeconds) + "Z");
    if (!date || !fraction) return std::nullopt;
    // Nanoseconds reach from 1677 to 2262; no record is older or newer.
    const auto most = std::chrono::floor<std::chrono::seconds>(nanoseconds::max()) - 1s;
    return CaptureTime(std::clamp<std::chrono::milliseconds>(date->time_since_epoch(), -most, most) + *fraction);
}

}  // namespace

CLI::Option* addTimeOption(CLI::App& command, const std::string& name, std::optional<CaptureTime>& time,
                           const std::string& help) {
    return command
        .add_option_function<std::string>(
            name,
            [name, &time](const std::string& text) {
                time = timeOf(text);
                if (!time) throw CLI::ValidationError(name, text + " is not a time such as 2014-08-29T20:51:07Z");
            },
            help)
        ->type_name("T");
}

}  // namespace kelvo
