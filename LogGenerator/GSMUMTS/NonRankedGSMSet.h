#pragma once

#include "LogGenerator/GSMUMTS/SilentSection.h"

namespace kelvo {

/// GSM neighbors outside the reselection ranking; no modem reports them.
class NonRankedGSMSet final : public SilentSection<NonRankedGSMSet> {
public:
    static constexpr std::string_view kSectionName = "Non-Ranked GSM Set";
    static constexpr std::string_view kTraceWord = "NonRankedGSMSet";

    using SilentSection::SilentSection;
};

}  // namespace kelvo
