#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"
#include "platform/system/Environment.h"

namespace kelvo {

/// A cell set of the UMTS searcher that stays empty, as intended: the searcher's record empties it and none of
/// its cells is taken in. `Derived` says with `kTraceWord` what each record writes to the log.
template <class Derived>
class EmptySet : public Section<Derived> {
public:
    static constexpr LogCode kLogCodes[] = {code::kUMTSCellSets};

    using Section<Derived>::Section;

    void updateWithData(ByteView data, LogCode logCode) final {
        logLine(Level::Warning, Derived::kTraceWord);
        if (logCode != code::kUMTSCellSets) return this->reportUnknown(logCode);
        if (data.size() >= 16) this->clearElementsInArray(this->list());
    }
};

}  // namespace kelvo
