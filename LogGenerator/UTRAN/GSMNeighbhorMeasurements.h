#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The GSM neighbors. Every record empties the list and none fills it: the cells it reports are not shown.
class GSMNeighbhorMeasurements final : public Section<GSMNeighbhorMeasurements> {
public:
    static constexpr std::string_view kSectionName = "GSM Neighbor Cell List";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xD00E};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

    /// One row for each cell that a record of at least 17 bytes reports.
    static ArrayRef neighbors(ByteView data);
};

}  // namespace kelvo
