#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace kelvo {

inline constexpr std::size_t kDLFVersionReportSize = 161;

/// A moment as the version report stores it.
struct DLFTimeRecord {
    std::uint32_t seconds = 0;     ///< since 1970-01-01 00:00 UTC
    std::int16_t zoneMinutes = 0;  ///< local time zone, minutes east of UTC
    std::uint8_t daylight = 0;     ///< 1 while daylight-saving time is in effect
};

enum DLFStatus : int { kDLFSuccess = 0, kDLFBufferTooSmall = 3 };

/// Writes the version-report record that begins a DLF file (161 bytes, log code 0x1ffd, little-endian) to `buffer` of
/// `size` bytes and its length to `written`. Texts are cut to their fields and always end in a NUL. With a buffer that
/// is too small nothing is written and `written` is 0.
DLFStatus DLFAddVersionReport(std::uint8_t* buffer, std::size_t size, std::size_t& written, std::uint16_t firstVersion,
                              std::uint16_t secondVersion, std::string_view versionText,
                              std::string_view executableName, std::string_view buildDate, const DLFTimeRecord& time);

}  // namespace kelvo
