#pragma once

#include "LogGenerator/GSMUMTS/EmptySet.h"

namespace kelvo {

/// UMTS cells of the neighbor list that are not in the active set.
class MonitoredSet final : public EmptySet<MonitoredSet> {
public:
    static constexpr std::string_view kSectionName = "Monitored Set";
    static constexpr std::string_view kTraceWord = "MonitoredSet";

    using EmptySet::EmptySet;
};

}  // namespace kelvo
