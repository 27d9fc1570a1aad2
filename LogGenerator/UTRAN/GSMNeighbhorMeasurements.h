#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/UTRAN/UTRANCodes.h"

namespace kelvo {

/// The GSM neighbors. Every record empties the list and none fills it: the cells it reports are not shown.
class GSMNeighbhorMeasurements final : public Section<GSMNeighbhorMeasurements> {
public:
    static constexpr std::string_view kSectionName = "GSM Neighbor Cell List";
    static constexpr LogCode kLogCodes[] = {code::kUTRANGSMNeighborCells};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

    /// One row for each cell that a record of at least 17 bytes reports.
    static ArrayRef neighbors(ByteView data);
};

}  // namespace kelvo
