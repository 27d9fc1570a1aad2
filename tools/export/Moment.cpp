#include "tools/export/Moment.h"

#include <fmt/format.h>

namespace kelvo {

std::string_view MomentText::of(CaptureTime time) {
    using namespace std::chrono;
    constexpr std::size_t kFraction = 7;  // "123456Z"
    const auto second = floor<seconds>(time);
    if (second != _second) {  // records come many a second
        _second = second;
        const auto day = floor<days>(second);
        const year_month_day date(day);
        const hh_mm_ss clock(second - day);
        _text = fmt::format("{:04}-{:02}-{:02}T{:02}:{:02}:{:02}.000000Z", static_cast<int>(date.year()),
                            static_cast<unsigned>(date.month()), static_cast<unsigned>(date.day()),
                            clock.hours().count(), clock.minutes().count(), clock.seconds().count());
    }
    auto fraction = floor<microseconds>(time - second).count();
    for (std::size_t digit = 2; digit <= kFraction; ++digit) {
        _text[_text.size() - digit] = static_cast<char>('0' + fraction % 10);
        fraction /= 10;
    }
    return _text;
}

}  // namespace kelvo
