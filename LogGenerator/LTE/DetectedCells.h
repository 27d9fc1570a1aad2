#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/LTE/LTECodes.h"

namespace kelvo {

/// The neighbors that were seen in connected mode but not measured, one row a cell.
class DetectedCells final : public Section<DetectedCells> {
public:
    static constexpr std::string_view kSectionName = "Detected Cells";
    static constexpr LogCode kLogCodes[] = {code::kLTEIntraFrequency};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
