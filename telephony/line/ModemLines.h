#pragma once

#include <functional>
#include <memory>
#include <string>

#include "platform/values/Result.h"
#include "telephony/line/ModemLine.h"

namespace kelvo {

/// Makes the lines to one modem: a new one whenever the last has gone, along several nodes where the port is to be
/// found first. Main queue only.
class ModemLines {
public:
    virtual ~ModemLines() = default;

    /// What it leads to, for people: "the modem at /dev/ttyUSB2".
    virtual std::string description() const = 0;
    /// The line to try next, for `listener`, which outlives it; the reason when there is nothing to try now. `again`:
    /// to where the last one led, if that is still there.
    virtual Result<std::unique_ptr<ModemLine>> next(ModemLine::Listener& listener, bool again) = 0;
    /// Calls `changed` whenever a port may have come, until the next call; none: no more.
    virtual void watch(std::function<void()> changed) = 0;
};

}  // namespace kelvo
