#pragma once

#include <array>

#include "LogGenerator/GSMUMTS/ProcessSection.h"

namespace kelvo {

/// Packet-switched mobility management, GMM (3GPP TS 24.008). Its states stand under the circuit-switched keys.
class ProcessPS final : public ProcessSection<ProcessPS> {
public:
    static constexpr std::string_view kSectionName = "Process PS";
    static constexpr std::string_view kTraceWord = "ProcessPS";
    static constexpr std::array<LogCode, 2> kLogCodes = {0x7130, 0x7132};

    using ProcessSection::ProcessSection;

private:
    void showState(ByteView data) const override;
};

}  // namespace kelvo
