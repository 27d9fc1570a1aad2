#pragma once

#include "LogGenerator/GSMUMTS/SilentSection.h"

namespace kelvo {

/// What the UMTS measurement reports hold; no modem reports it.
class UMTSRRMeasurement final : public SilentSection<UMTSRRMeasurement> {
public:
    static constexpr std::string_view kSectionName = "UMTS RR Measurement";
    static constexpr std::string_view kTraceWord = "UMTSRRMeasurement";

    using SilentSection::SilentSection;
};

}  // namespace kelvo
