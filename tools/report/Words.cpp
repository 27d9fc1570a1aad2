#include "tools/report/Words.h"

#include <fmt/format.h>

#include <algorithm>
#include <cmath>

#include "platform/encodings/Utf8.h"

namespace kelvo::report {

std::string html(std::string_view text) {
    std::string safe;
    for (const char c : printable(text)) {
        switch (c) {
            case '&': safe += "&amp;"; break;
            case '<': safe += "&lt;"; break;
            case '>': safe += "&gt;"; break;
            case '"': safe += "&quot;"; break;
            case '\'': safe += "&#39;"; break;
            default: safe += c;
        }
    }
    return safe;
}

std::string htmlLines(std::string_view text) {
    std::string safe;
    while (!text.empty()) {
        const std::size_t end = std::min(text.find('\n'), text.size());
        safe += html(text.substr(0, end)) + "\n";
        text.remove_prefix(std::min(end + 1, text.size()));
    }
    return safe;
}

std::string letterOf(std::size_t drive) { return std::string(1, static_cast<char>('A' + drive)); }

std::string grouped(std::uint64_t number) {
    return number < 1000 ? std::to_string(number) : fmt::format("{},{:03}", grouped(number / 1000), number % 1000);
}

std::string counted(std::uint64_t number, std::string_view noun) {
    return fmt::format("{} {}{}", grouped(number), noun, number == 1 ? "" : "s");
}

std::string numberText(double number) {
    std::string text = std::abs(number) < 1e15 ? fmt::format("{:.2f}", number) : fmt::format("{:.3g}", number);
    if (text.find('.') != text.npos && text.find('e') == text.npos) {
        text.erase(text.find_last_not_of('0') + 1);
        if (text.back() == '.') text.pop_back();
    }
    return text == "-0" ? "0" : text;
}

std::string withUnit(double number, std::string_view unit) {
    return unit.empty() ? numberText(number) : fmt::format("{} {}", numberText(number), unit);
}

std::string lengthText(Elapsed length, bool isByRecords) {
    if (isByRecords) return counted(static_cast<std::uint64_t>(length / std::chrono::seconds(1)), "record");
    const double seconds = std::chrono::duration<double>(length).count();
    if (seconds < 9.95) return fmt::format("{:.1f} s", seconds);
    const auto whole = static_cast<std::int64_t>(std::llround(seconds));
    if (whole < 60) return fmt::format("{} s", whole);
    if (whole < 3600) return fmt::format("{} min {} s", whole / 60, whole % 60);
    if (whole < 86400) return fmt::format("{} h {:02} min", whole / 3600, whole % 3600 / 60);
    return fmt::format("{} d {} h", whole / 86400, whole % 86400 / 3600);
}

std::string shareText(double share) {
    if (share > 0 && share < 0.01) return "under 1 %";
    if (share > 0.99 && share < 1) return "over 99 %";
    return fmt::format("{:.0f} %", 100 * share);
}

namespace {

struct Clock {
    std::chrono::year_month_day date;
    std::chrono::hh_mm_ss<std::chrono::milliseconds> time;
};

Clock clockOf(overview::Time time) {
    const auto milliseconds = std::chrono::floor<std::chrono::milliseconds>(time);
    const auto day = std::chrono::floor<std::chrono::days>(milliseconds);
    return {std::chrono::year_month_day(day), std::chrono::hh_mm_ss(milliseconds - day)};
}

}  // namespace

std::string timeText(overview::Time time) {
    const Clock clock = clockOf(time);
    return fmt::format("{:04}-{:02}-{:02} {:02}:{:02}:{:02}", static_cast<int>(clock.date.year()),
                       static_cast<unsigned>(clock.date.month()), static_cast<unsigned>(clock.date.day()),
                       clock.time.hours().count(), clock.time.minutes().count(), clock.time.seconds().count());
}

overview::Time timeAt(const Drive& drive, Elapsed at) {
    const auto& stretches = drive.time.stretches();
    if (stretches.empty()) return {};
    const auto after = std::ranges::upper_bound(stretches, at, {}, &Stretch::at);
    const Stretch& stretch = after == stretches.begin() ? *after : *std::prev(after);
    return stretch.time + (at - stretch.at);
}

std::string whenText(const Drive& drive, Elapsed at) {
    if (drive.isByRecords) return "record " + grouped(static_cast<std::uint64_t>(at / std::chrono::seconds(1)) + 1);
    const overview::Time time = timeAt(drive, at);
    const Clock clock = clockOf(time);
    const std::string text = timeText(time);
    const auto day = [](overview::Time t) { return std::chrono::floor<std::chrono::days>(t); };
    const bool isOneDay = day(drive.time.earliest()) == day(drive.time.latest());
    return fmt::format("{}.{:03}", isOneDay ? text.substr(text.find(' ') + 1) : text, clock.time.subseconds().count());
}

std::span<const LevelGrade> gradesByName(std::string_view name) {
    if (name == "RSRP") return gradesOf(Graded::Rsrp);
    if (name == "RSRQ") return gradesOf(Graded::Rsrq);
    if (name == "Ec/Io" || name == "Ec/N0") return gradesOf(Graded::EcIo);
    if (name == "RxLev" || name == "RSSI") return gradesOf(Graded::RxLev);
    return {};
}

}  // namespace kelvo::report
