#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// What the idle-mode neighbor measurements have in common; the cells are NeighborCellsList's.
class NeighborMeasurementMisc final : public Section<NeighborMeasurementMisc> {
public:
    static constexpr std::string_view kSectionName = "Neighbor Measurements";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xB180};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
