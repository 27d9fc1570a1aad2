#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The measured UTRAN neighbors, one row a cell.
class UTRANNeighbhorMeasurements final : public Section<UTRANNeighbhorMeasurements> {
public:
    static constexpr std::string_view kSectionName = "Neighbor Cell List";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xD00A};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
