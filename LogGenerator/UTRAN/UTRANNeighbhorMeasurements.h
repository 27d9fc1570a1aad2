#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/UTRAN/UTRANCodes.h"

namespace kelvo {

/// The measured UTRAN neighbors, one row a cell.
class UTRANNeighbhorMeasurements final : public Section<UTRANNeighbhorMeasurements> {
public:
    static constexpr std::string_view kSectionName = "Neighbor Cell List";
    static constexpr LogCode kLogCodes[] = {code::kUTRANNeighborCells};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
