#pragma once

#include "LogGenerator/GSMUMTS/MMStateRecord.h"
#include "LogGenerator/GSMUMTS/RegistrationRecord.h"
#include "LogGenerator/LayoutSection.h"

namespace kelvo {

/// Circuit-switched mobility management (3GPP TS 24.008).
class ProcessCS final : public LayoutSection<ProcessCS, MMStateRecord::kWhole, RegistrationRecord::kState> {
public:
    static constexpr std::string_view kSectionName = "Process CS";
    static constexpr std::string_view kTraceWord = "ProcessCS";

    using LayoutSection::LayoutSection;
};

}  // namespace kelvo
