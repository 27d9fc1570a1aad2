#pragma once

#include "LogGenerator/GSMUMTS/EmptySet.h"

namespace kelvo {

/// The active set that the phone keeps for another frequency.
class VirtualActiveSet final : public EmptySet<VirtualActiveSet> {
public:
    static constexpr std::string_view kSectionName = "Virtual Active Set";
    static constexpr std::string_view kTraceWord = "VirtualActiveSet";

    using EmptySet::EmptySet;
};

}  // namespace kelvo
