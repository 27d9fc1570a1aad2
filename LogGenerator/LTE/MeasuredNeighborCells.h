#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The neighbors whose power and quality were measured in connected mode, one row a cell.
class MeasuredNeighborCells final : public Section<MeasuredNeighborCells> {
public:
    static constexpr std::string_view kSectionName = "Measured Neighbor Cells";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xB179};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
