#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/LTE/LTECodes.h"

namespace kelvo {

/// The neighbors measured in idle mode, one row a cell; a record states 1 to 32 of them.
class NeighborCellsList final : public Section<NeighborCellsList> {
public:
    static constexpr std::string_view kSectionName = "Neighbor Cells List";
    static constexpr LogCode kLogCodes[] = {code::kLTENeighborCellsIdle};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
