#include "telephony/CaptureStream.h"

#include <algorithm>
#include <utility>

#include "platform/system/Environment.h"
#include "telephony/recordings/RecordingKind.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;

constexpr std::chrono::nanoseconds kLongestPause = 5s;

}  // namespace

Result<std::unique_ptr<CaptureStream>> CaptureStream::open(const std::filesystem::path& path, bool loop) {
    auto reader = CaptureReader::open(path);
    if (!reader) return Failure{whyNoCapture(path.string(), reader.error().reason)};
    const auto technology = reader->technology();
    if (!technology) return Failure{path.string() + ": its link type is none of a modem's log (147 to 151)"};
    return std::unique_ptr<CaptureStream>(new CaptureStream(path, std::move(reader).value(), *technology, loop));
}

std::optional<CapturePacket> CaptureStream::next() {
    auto packet = readPacket();
    if (!packet && _loop && _packets > 0 && beginNextPass()) packet = readPacket();
    _ended = !packet;
    if (packet) packet->time = place(packet->time);
    return packet;
}

std::optional<CapturePacket> CaptureStream::readPacket() {
    auto read = _reader.next();
    if (read) return *read;
    tell(read.error());
    return std::nullopt;
}

bool CaptureStream::beginNextPass() {
    auto reader = CaptureReader::open(_path);
    if (!reader) {
        tell(reader.error());
        return false;
    }
    _reader = std::move(reader).value();
    _now += typicalInterval();
    _packets = 0;
    _played = 0ns;
    _firstPass = false;
    return true;
}

// Once, however often the capture is played.
void CaptureStream::tell(const Failure& failure) {
    if (failure.reason == _failure) return;
    _failure = failure.reason;
    logLine(Level::Error, _failure);
}

std::string CaptureStream::state() const {
    if (!_ended) return _failure;  // of the pass before
    return _failure.empty() ? "the capture has ended" : "the capture has ended: " + _failure;
}

CaptureTime CaptureStream::place(CaptureTime captured) {
    if (_packets++ == 0) {
        _last = captured;
        if (_firstPass) _now = captured;
        return _now;
    }
    const nanoseconds gap = std::clamp<nanoseconds>(captured - _last, 0ns, kLongestPause);
    _last = std::max(_last, captured);
    _played += gap;
    return _now += gap;
}

std::chrono::nanoseconds CaptureStream::typicalInterval() const {
    if (_packets < 2) return 1s;
    const nanoseconds mean = _played / static_cast<std::int64_t>(_packets - 1);
    return std::clamp<nanoseconds>(mean, 10ms, 1s);
}

}  // namespace kelvo
