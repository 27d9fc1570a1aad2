#pragma once

#include "LogGenerator/GSMUMTS/SilentSection.h"

namespace kelvo {

/// UMTS neighbors outside the reselection ranking; no modem reports them.
class NonRankedUMTSSet final : public SilentSection<NonRankedUMTSSet> {
public:
    static constexpr std::string_view kSectionName = "Non-Ranked UMTS Set";
    static constexpr std::string_view kTraceWord = "NonRankedUMTSSet";

    using SilentSection::SilentSection;
};

}  // namespace kelvo
