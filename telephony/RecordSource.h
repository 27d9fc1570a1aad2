#pragma once

#include <string>

#include "platform/telephony/Technology.h"
#include "platform/values/Bytes.h"

namespace kelvo {

/// Where a source leaves its records.
class RecordSink {
public:
    virtual ~RecordSink() = default;

    /// Takes one record, exactly as clients get it; false when no client wants it. `record` is
    /// borrowed for the call. Never blocks.
    virtual bool take(ByteView record) = 0;
    /// True while some client has read all it was given: a source without a clock of its own goes on only then.
    virtual bool isHungry() const = 0;
};

/// Where the modem's records come from. Main queue only.
class RecordSource {
public:
    virtual ~RecordSource() = default;

    virtual Technology technology() const = 0;
    /// What it is, for people: "the capture drive.pcap".
    virtual std::string description() const = 0;
    /// What there is to say of it at the moment, for people: "the capture has ended"; empty when there is nothing.
    virtual std::string state() const { return {}; }
    /// Gives records to `sink`, which outlives the source's work, from now on. Called once, when the first client
    /// streams.
    virtual void start(RecordSink& sink) = 0;
    /// Some client is hungry again, after none was.
    virtual void feed() {}
};

}  // namespace kelvo
