#pragma once

#include "LogGenerator/GSMUMTS/SilentSection.h"

namespace kelvo {

/// The GPRS coding scheme in use; no modem reports it.
class CodingScheme final : public SilentSection<CodingScheme> {
public:
    static constexpr std::string_view kSectionName = "Coding Scheme";
    static constexpr std::string_view kTraceWord = "CellChangeCounters";  // the counters' word, on purpose

    using SilentSection::SilentSection;
};

}  // namespace kelvo
