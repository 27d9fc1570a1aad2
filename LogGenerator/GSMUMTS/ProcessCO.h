#pragma once

#include "LogGenerator/GSMUMTS/MMStateRecord.h"
#include "LogGenerator/GSMUMTS/RegistrationRecord.h"
#include "LogGenerator/LayoutSection.h"

namespace kelvo {

/// Mobility management in short: the circuit-switched state and the registration state.
class ProcessCO final : public LayoutSection<ProcessCO, MMStateRecord::kState, RegistrationRecord::kState> {
public:
    static constexpr std::string_view kSectionName = "Process CO";
    static constexpr std::string_view kTraceWord = "ProcessCS";  // ProcessCS's word, on purpose

    using LayoutSection::LayoutSection;
};

}  // namespace kelvo
