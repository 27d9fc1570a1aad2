#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/LTE/LTECodes.h"

namespace kelvo {

/// What the idle-mode neighbor measurements have in common; the cells are NeighborCellsList's.
class NeighborMeasurementMisc final : public Section<NeighborMeasurementMisc> {
public:
    static constexpr std::string_view kSectionName = "Neighbor Measurements";
    static constexpr LogCode kLogCodes[] = {code::kLTENeighborCellsIdle};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
