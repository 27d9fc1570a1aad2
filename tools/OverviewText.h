#pragma once

#include <string>
#include <vector>

#include "overview/LiveOverview.h"
#include "overview/Tracker.h"

namespace kelvo {

/// The overview at `now` for a person: the serving cell, the cells around it, registration and contexts, the last
/// events. What the modem does not tell is left out. A line an item, with its line end.
std::string overviewText(const overview::Tracker& tracker, overview::Time now);

/// The same of a model that runs, line by line without line ends, laid out so that little moves from one to the next.
class LiveOverviewText {
public:
    /// `hasBlocks`: the terminal can show the two-minute lines.
    LiveOverviewText(const overview::LiveOverview& live, bool hasBlocks) : _live(live), _hasBlocks(hasBlocks) {}

    std::vector<std::string> lines();

private:
    const overview::LiveOverview& _live;
    const bool _hasBlocks;
    std::size_t _cellRows = 0;  // so many have been shown at a time: what stands below stays there
};

/// "2026-11-22T09:15:04.250Z  handover  EARFCN 1300, PCI 84 -> EARFCN 1300, PCI 12 (-101.50 dBm -> -92.00 dBm)",
/// without a line end.
std::string eventText(const overview::Event& event);

/// ISO 8601, UTC, with milliseconds.
std::string isoText(overview::Time time);

}  // namespace kelvo
