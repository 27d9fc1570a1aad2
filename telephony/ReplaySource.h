#pragma once

#include <chrono>
#include <filesystem>
#include <functional>
#include <memory>
#include <optional>

#include "platform/MainQueue.h"
#include "platform/host/Capture.h"
#include "telephony/RecordSource.h"

namespace kelvo {

/// Replays a capture with the time between its packets as it was: pauses included, however long (one of a minute and
/// more is announced in the log). A packet older than the one before it follows at once.
/// After the last packet the source is silent; in a loop the capture starts again one typical interval later (the mean
/// of its intervals, 10 ms to 1 s).
class ReplaySource final : public RecordSource {
public:
    struct Options {
        bool loop = false;
        /// How many times faster than it was; none: as fast as the quickest client reads.
        std::optional<double> speed = 1.0;
    };
    /// Time that only goes forward, from any beginning.
    using Now = std::function<std::chrono::nanoseconds()>;

    /// Opens the capture; the reason of a failure names the file. `queue` outlives the source.
    static Result<std::unique_ptr<ReplaySource>> open(const std::filesystem::path& path, Options options,
                                                      MainQueue& queue, Now now);
    ~ReplaySource() override { *_alive = false; }

    Technology technology() const override { return _technology; }
    void start(RecordSink& sink) override;
    void feed() override;

private:
    using nanoseconds = std::chrono::nanoseconds;

    ReplaySource(std::filesystem::path path, CaptureReader reader, Technology technology, Options options,
                 MainQueue& queue, Now now);
    void pumpAfter(nanoseconds delay);
    void pump();
    bool readNext();
    bool beginNextPass();
    nanoseconds timeUntilNext();
    nanoseconds scaled(nanoseconds captured) const;
    nanoseconds typicalInterval() const;
    void setDueTime();

    const std::filesystem::path _path;
    CaptureReader _reader;
    const Technology _technology;
    const Options _options;
    MainQueue& _queue;
    const Now _now;
    RecordSink* _sink = nullptr;
    std::optional<CapturePacket> _next;  // read and not yet given
    nanoseconds _passStart{0};           // when the first packet of this pass was due
    nanoseconds _due{0};                 // of _next, and before that of the packet before
    CaptureTime _first;                  // of this pass
    CaptureTime _last;
    std::size_t _packets = 0;  // of this pass
    bool _taken = false;       // a client wanted one of this pass
    bool _waiting = false;     // pump() is on the queue
    bool _toldFailure = false;
    std::shared_ptr<bool> _alive = std::make_shared<bool>(true);  // tasks on the queue outlive the source
};

}  // namespace kelvo
