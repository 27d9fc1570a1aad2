#pragma once

#include <array>

#include "LogGenerator/GSMUMTS/ProcessSection.h"

namespace kelvo {

/// Mobility management in short: the circuit-switched state and the registration state.
class ProcessCO final : public ProcessSection<ProcessCO> {
public:
    static constexpr std::string_view kSectionName = "Process CO";
    static constexpr std::string_view kTraceWord = "ProcessCS";  // ProcessCS's word, on purpose
    static constexpr std::array<LogCode, 2> kLogCodes = {0x7131, 0x7132};

    using ProcessSection::ProcessSection;

private:
    void showState(ByteView data) const override;
};

}  // namespace kelvo
