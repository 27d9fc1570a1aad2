#pragma once

#include <array>

#include "LogGenerator/GSMUMTS/ProcessSection.h"

namespace kelvo {

/// Circuit-switched mobility management (3GPP TS 24.008).
class ProcessCS final : public ProcessSection<ProcessCS> {
public:
    static constexpr std::string_view kSectionName = "Process CS";
    static constexpr std::string_view kTraceWord = "ProcessCS";
    static constexpr std::array<LogCode, 2> kLogCodes = {0x7131, 0x7132};

    using ProcessSection::ProcessSection;

private:
    void showState(ByteView data) const override;
};

}  // namespace kelvo
