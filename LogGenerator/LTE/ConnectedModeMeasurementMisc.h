#pragma once

#include "LogGenerator/LTE/IntraFrequencyRecord.h"
#include "LogGenerator/LayoutSection.h"

namespace kelvo {

/// The serving cell's filtered power and quality in connected mode.
class ConnectedModeMeasurementMisc final
    : public LayoutSection<ConnectedModeMeasurementMisc, IntraFrequencyRecord::kServingCell> {
public:
    static constexpr std::string_view kSectionName = "Connected mode LTE Intra-frequency Measurement";
    static constexpr std::string_view kTraceWord = kSectionName;

    using LayoutSection::LayoutSection;
};

}  // namespace kelvo
