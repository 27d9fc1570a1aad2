#pragma once

#include "LogGenerator/LTE/IdleNeighborsRecord.h"
#include "LogGenerator/LayoutSection.h"

namespace kelvo {

/// What the idle-mode neighbor measurements have in common; the cells are NeighborCellsList's.
class NeighborMeasurementMisc final : public LayoutSection<NeighborMeasurementMisc, IdleNeighborsRecord::kFrequency> {
public:
    static constexpr std::string_view kSectionName = "Neighbor Measurements";
    static constexpr std::string_view kTraceWord = kSectionName;

    using LayoutSection::LayoutSection;
};

}  // namespace kelvo
