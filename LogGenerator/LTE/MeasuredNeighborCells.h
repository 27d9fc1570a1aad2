#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/LTE/LTECodes.h"

namespace kelvo {

/// The neighbors whose power and quality were measured in connected mode, one row a cell.
class MeasuredNeighborCells final : public Section<MeasuredNeighborCells> {
public:
    static constexpr std::string_view kSectionName = "Measured Neighbor Cells";
    static constexpr LogCode kLogCodes[] = {code::kLTEIntraFrequency};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
