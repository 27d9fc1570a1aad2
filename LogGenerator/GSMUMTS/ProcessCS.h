#pragma once

#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"
#include "LogGenerator/GSMUMTS/MMStateRecord.h"
#include "LogGenerator/GSMUMTS/ProcessSection.h"

namespace kelvo {

/// Circuit-switched mobility management (3GPP TS 24.008).
class ProcessCS final : public ProcessSection<ProcessCS> {
public:
    static constexpr std::string_view kSectionName = "Process CS";
    static constexpr std::string_view kTraceWord = "ProcessCS";
    static constexpr LogCode kLogCodes[] = {code::kMMState, code::kRegistration};
    static constexpr const auto& kState = MMStateRecord::kWhole;

    using ProcessSection::ProcessSection;
};

}  // namespace kelvo
