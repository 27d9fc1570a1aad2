#pragma once

#include <array>

#include "LogGenerator/Base.h"
#include "platform/system/Environment.h"

namespace kelvo {

/// A section that no record fills: the modem has no log code for it, and its part of the display stays as the template
/// has it. `Derived` says with `kTraceWord` what a call writes to the log.
template <class Derived>
class SilentSection : public Section<Derived> {
public:
    static constexpr std::array<LogCode, 0> kLogCodes = {};

    using Section<Derived>::Section;
    void updateWithData(ByteView, LogCode) final { logLine(Level::Warning, Derived::kTraceWord); }
};

}  // namespace kelvo
