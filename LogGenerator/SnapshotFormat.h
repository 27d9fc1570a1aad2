#pragma once

#include <string_view>

/// What a snapshot file holds, for its writers and readers: one XML property list,
///     { "Timestamp": when its screen was opened, in UTC, "Data": [ entry, … ], "Description": the user's words }
/// An entry is one snapshot of the history, oldest first,
///     { "DisplayState": the raw records, or a cell monitor's tree, "Display": what the screens showed,
///       "ExtraInfo": dictionary, "Date": when, in local time, "Description": "Snapshot (<date>)" }
/// and, at the end and from families with raw records alone,
///     { "Description": "DLF binary (n bytes)", "DLF": data }
/// File and snapshot end at the first part that is absent; a part's name in a snapshot is its name in the generators'
/// state. Dates are written as platform/system/DateText.h says.
namespace kelvo::snapshot {

inline constexpr std::string_view kTimestamp = "Timestamp";
inline constexpr std::string_view kData = "Data";
inline constexpr std::string_view kDescription = "Description";
inline constexpr std::string_view kDisplayState = "DisplayState";
inline constexpr std::string_view kDisplay = "Display";
inline constexpr std::string_view kExtraInfo = "ExtraInfo";
inline constexpr std::string_view kDate = "Date";
inline constexpr std::string_view kDLF = "DLF";

}  // namespace kelvo::snapshot
