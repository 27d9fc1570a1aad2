#pragma once

#include <optional>
#include <string>

#include "platform/host/Capture.h"

namespace kelvo {

/// Records in their order, each with its time: a capture, or a modem that is simulated.
class RecordStream {
public:
    virtual ~RecordStream() = default;

    virtual Technology technology() const = 0;
    /// What it is, for people: "the capture drive.pcap".
    virtual std::string description() const = 0;
    /// What there is to say of it at the moment, for people: "the capture has ended"; empty when there is nothing.
    virtual std::string state() const { return {}; }
    /// The next record, none after the last. Its time is never before that of the record before; its bytes are borrowed
    /// until the next call.
    virtual std::optional<CapturePacket> next() = 0;
};

}  // namespace kelvo
