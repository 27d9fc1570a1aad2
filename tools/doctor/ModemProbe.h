#pragma once

#include <chrono>
#include <optional>
#include <string>

#include "platform/system/SteadyTime.h"
#include "platform/values/Bytes.h"
#include "telephony/wire/RecordConfiguration.h"

namespace kelvo {

/// An open port that is asked a few harmless things.
class ProbedPort {
public:
    virtual ~ProbedPort() = default;
    virtual void write(ByteView bytes) = 0;
    /// What has come, after waiting for it for so long at most; empty when nothing has.
    virtual Bytes read(std::chrono::nanoseconds limit) = 0;
    /// False once the other end has gone.
    virtual bool isOpen() const = 0;
};

/// What a modem says of itself.
struct ModemProbe {
    std::string failure{};  ///< why there is nothing more; empty: it answers as a diagnostic port does
    std::string target{};   ///< what it calls itself; may be empty
    std::string buildId{};  ///< may be empty
    std::optional<wire::Ranges> ranges{};
    std::string rangesFailure{};  ///< why there are no ranges
    bool isStreaming = false;     ///< records come: a reader has asked for them, or has left them running
};

/// Asks for version, build and ranges, and for nothing that changes what the modem does. Takes two seconds at most
/// where nobody answers, and half a minute where it answers badly.
ModemProbe probeModem(ProbedPort& port, const SteadyTime& now);

}  // namespace kelvo
