#pragma once

#include <chrono>
#include <memory>
#include <optional>

#include "platform/system/Lifetime.h"
#include "platform/system/MainQueue.h"
#include "platform/system/SteadyTime.h"
#include "telephony/RecordSource.h"
#include "telephony/RecordStream.h"

namespace kelvo {

/// Gives the records of a stream when they are due: with the time between them that the stream says, or faster. After
/// the last record the source is silent.
class PacedSource final : public RecordSource {
public:
    /// How many times faster than the stream; none: as fast as the quickest client reads.
    using Speed = std::optional<double>;

    /// `queue` outlives the source.
    PacedSource(std::unique_ptr<RecordStream> stream, Speed speed, MainQueue& queue, SteadyTime now);

    std::optional<Technology> technology() const override { return _stream->technology(); }
    std::string description() const override { return _stream->description(); }
    std::string state() const override { return _stream->state(); }
    void start(RecordSink& sink) override;
    void feed() override;

private:
    using nanoseconds = std::chrono::nanoseconds;

    void pumpAfter(nanoseconds delay);
    void pump();
    bool readNext();
    void give();
    nanoseconds scaled(nanoseconds interval) const;

    const std::unique_ptr<RecordStream> _stream;
    const Speed _speed;
    MainQueue& _queue;
    const SteadyTime _now;
    RecordSink* _sink = nullptr;
    std::optional<CapturePacket> _next;  // read and not yet given
    std::optional<CaptureTime> _last;    // the time of the packet read last
    nanoseconds _due{0};                 // of _next, and before that of the packet before
    int _refused = 0;                    // in a row
    bool _waiting = false;               // pump() is on the queue
    const Lifetime _lifetime;            // tasks on the queue outlive the source
};

}  // namespace kelvo
