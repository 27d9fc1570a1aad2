#pragma once

#include "LogGenerator/GSMUMTS/EmptySet.h"

namespace kelvo {

/// UMTS cells found outside the neighbor list.
class DetectedSet final : public EmptySet<DetectedSet> {
public:
    static constexpr std::string_view kSectionName = "Detected Set";
    static constexpr std::string_view kTraceWord = "DetectedSet";

    using EmptySet::EmptySet;
};

}  // namespace kelvo
