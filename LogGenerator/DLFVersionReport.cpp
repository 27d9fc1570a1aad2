#include "LogGenerator/DLFVersionReport.h"

#include <algorithm>
#include <cstring>

namespace kelvo {

namespace {

void writeLittleEndian(std::uint8_t* to, std::uint32_t value, std::size_t width) {
    for (std::size_t i = 0; i < width; ++i) to[i] = static_cast<std::uint8_t>(value >> (8 * i));
}

void writeText(std::uint8_t* to, std::string_view text, std::size_t most) {
    std::ranges::copy(text.substr(0, most), to);
}

}  // namespace

DLFStatus DLFAddVersionReport(std::uint8_t* buffer, std::size_t size, std::size_t& written, std::uint16_t firstVersion,
                              std::uint16_t secondVersion, std::string_view versionText,
                              std::string_view executableName, std::string_view buildDate, const DLFTimeRecord& time) {
    written = 0;
    if (size < kDLFVersionReportSize) return kDLFBufferTooSmall;

    std::memset(buffer, 0, kDLFVersionReportSize);  // timestamp, text ends and the reserved tail stay zero
    writeLittleEndian(buffer + 0, kDLFVersionReportSize, 2);
    writeLittleEndian(buffer + 2, 0x1ffd, 2);
    writeLittleEndian(buffer + 12, firstVersion, 2);
    writeLittleEndian(buffer + 14, secondVersion, 2);
    writeText(buffer + 16, versionText, 6);
    writeText(buffer + 23, executableName, 15);
    writeText(buffer + 63, buildDate, 17);
    writeLittleEndian(buffer + 81, time.seconds, 4);
    writeLittleEndian(buffer + 85, static_cast<std::uint16_t>(time.zoneMinutes), 2);
    writeLittleEndian(buffer + 87, time.daylight, 1);
    written = kDLFVersionReportSize;
    return kDLFSuccess;
}

}  // namespace kelvo
