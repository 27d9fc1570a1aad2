#pragma once

#include <filesystem>
#include <memory>

#include "telephony/RecordStream.h"

namespace kelvo {

/// The packets of a capture with the time between them as it was, but for pauses of more than five seconds, which last
/// five: captures are merged from logs that lie days apart. A packet older than the one before it follows at once.
/// In a loop the capture begins again one typical interval after its last packet (the mean of its intervals, 10 ms to
/// 1 s).
class CaptureStream final : public RecordStream {
public:
    /// Opens the capture; the reason of a failure names the file. What goes wrong later ends the pass, with one line on
    /// the log.
    static Result<std::unique_ptr<CaptureStream>> open(const std::filesystem::path& path, bool loop);

    Technology technology() const override { return _technology; }
    std::string description() const override { return "the capture " + _path.string(); }
    std::string state() const override;
    std::optional<CapturePacket> next() override;

private:
    using nanoseconds = std::chrono::nanoseconds;

    CaptureStream(std::filesystem::path path, CaptureReader reader, Technology technology, bool loop)
        : _path(std::move(path)), _reader(std::move(reader)), _technology(technology), _loop(loop) {}
    std::optional<CapturePacket> readPacket();
    bool beginNextPass();
    void tell(const Failure& failure);
    CaptureTime place(CaptureTime captured);
    nanoseconds typicalInterval() const;

    const std::filesystem::path _path;
    CaptureReader _reader;
    const Technology _technology;
    const bool _loop;
    CaptureTime _now;        // the time given to the last packet
    CaptureTime _last;       // the latest that the capture says, of this pass
    nanoseconds _played{0};  // of this pass
    std::size_t _packets = 0;
    bool _firstPass = true;
    bool _ended = false;   // the last packet has been given
    std::string _failure;  // why no more could be read of it; empty: nothing went wrong
};

}  // namespace kelvo
