#pragma once

#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"
#include "LogGenerator/GSMUMTS/MMStateRecord.h"
#include "LogGenerator/GSMUMTS/ProcessSection.h"

namespace kelvo {

/// Mobility management in short: the circuit-switched state and the registration state.
class ProcessCO final : public ProcessSection<ProcessCO> {
public:
    static constexpr std::string_view kSectionName = "Process CO";
    static constexpr std::string_view kTraceWord = "ProcessCS";  // ProcessCS's word, on purpose
    static constexpr LogCode kLogCodes[] = {code::kMMState, code::kRegistration};
    static constexpr const auto& kState = MMStateRecord::kState;

    using ProcessSection::ProcessSection;
};

}  // namespace kelvo
