#pragma once

#include "LogGenerator/GSMUMTS/SilentSection.h"

namespace kelvo {

/// How often the phone changed its cell; no modem reports it.
class CellChangeCounters final : public SilentSection<CellChangeCounters> {
public:
    static constexpr std::string_view kSectionName = "Cell Change Counters";
    static constexpr std::string_view kTraceWord = "CellChangeCounters";

    using SilentSection::SilentSection;
};

}  // namespace kelvo
