#include "platform/encodings/IsoDate.h"

#include <fmt/format.h>

#include <chrono>

namespace kelvo {

namespace {

constexpr std::string_view kForm = "0000-00-00T00:00:00Z";

bool isDigit(char c) { return c >= '0' && c <= '9'; }

bool followsForm(std::string_view text) {
    if (text.size() != kForm.size()) return false;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (isDigit(kForm[i]) ? !isDigit(text[i]) : text[i] != kForm[i]) return false;
    }
    return true;
}

int number(std::string_view digits) {
    int value = 0;
    for (char c : digits) value = value * 10 + (c - '0');
    return value;
}

}  // namespace

bool hasIsoForm(Date date) {
    using namespace std::chrono;
    return date >= sys_days(year(0) / 1 / 1) && date < sys_days(year(10000) / 1 / 1);
}

std::string isoDate(Date date) {
    using namespace std::chrono;
    const auto seconds = floor<std::chrono::seconds>(date);
    const auto day = floor<days>(seconds);
    const year_month_day calendar(day);
    const hh_mm_ss time(seconds - day);
    return fmt::format("{:04}-{:02}-{:02}T{:02}:{:02}:{:02}Z", static_cast<int>(calendar.year()),
                       static_cast<unsigned>(calendar.month()), static_cast<unsigned>(calendar.day()),
                       time.hours().count(), time.minutes().count(), time.seconds().count());
}

std::optional<Date> dateFromIso(std::string_view text) {
    using namespace std::chrono;
    if (!followsForm(text)) return std::nullopt;
    const auto field = [&](std::size_t at, std::size_t length) { return number(text.substr(at, length)); };
    const year_month_day calendar(year(field(0, 4)), month(static_cast<unsigned>(field(5, 2))),
                                  day(static_cast<unsigned>(field(8, 2))));
    const int hour = field(11, 2);
    const int minute = field(14, 2);
    const int second = field(17, 2);
    if (!calendar.ok() || hour > 23 || minute > 59 || second > 59) return std::nullopt;
    return Date(sys_days(calendar) + hours(hour) + minutes(minute) + seconds(second));
}

}  // namespace kelvo
