#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The neighbors that were seen in connected mode but not measured, one row a cell.
class DetectedCells final : public Section<DetectedCells> {
public:
    static constexpr std::string_view kSectionName = "Detected Cells";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xB179};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
