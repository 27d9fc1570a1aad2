#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

#include "model/LevelGrades.h"
#include "tools/report/Drive.h"

/// How a report words its figures.
namespace kelvo::report {

/// `text` made safe to stand in HTML, between tags and in quoted attributes. Control characters and what is not UTF-8
/// become U+FFFD.
std::string html(std::string_view text);
/// The same of a text of several lines, which stay lines.
std::string htmlLines(std::string_view text);

/// What a recording is called beside others: "A" for the first.
std::string letterOf(std::size_t drive);

/// "12,431".
std::string grouped(std::uint64_t number);
/// "1 handover", "2 handovers".
std::string counted(std::uint64_t number, std::string_view noun);
/// "-91.25": at most two digits after the point.
std::string numberText(double number);
/// "-91.25 dBm".
std::string withUnit(double number, std::string_view unit);
/// "8.4 s", "12 min 3 s", "2 h 05 min"; a recording without times has "120 records".
std::string lengthText(Elapsed length, bool isByRecords);
/// "62 %"; "under 1 %" for what is not nothing.
std::string shareText(double share);
/// "2026-08-29 20:51:00".
std::string timeText(overview::Time time);
/// When something was: "20:51:00.250", or "record 12".
std::string whenText(const Drive& drive, Elapsed at);
/// Which time that place in the recording is.
overview::Time timeAt(const Drive& drive, Elapsed at);

/// The grades of a level or quality by what people call it; none for every other.
std::span<const LevelGrade> gradesByName(std::string_view name);

}  // namespace kelvo::report
