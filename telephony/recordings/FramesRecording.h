#pragma once

#include <array>
#include <memory>

#include "telephony/recordings/RecordingFile.h"
#include "telephony/recordings/RecordingReader.h"
#include "telephony/wire/FrameReader.h"

namespace kelvo {

/// A stream of frames as a diagnostic port sends them: garbage and part of a frame may come first.
class FramesRecording final : public RecordingReader {
public:
    explicit FramesRecording(RecordingFile file);

    Result<std::optional<RecordedMessage>> next() override;
    RecordingDamage damage() const override;

private:
    std::optional<RecordedMessage> recordOf(wire::MutableBytes body);

    static constexpr std::size_t kPiece = 256 * 1024;
    RecordingFile _file;
    std::unique_ptr<std::array<std::uint8_t, kPiece>> _piece = std::make_unique<std::array<std::uint8_t, kPiece>>();
    wire::MutableBytes _input;  // of the piece: what has not been read yet
    wire::FrameReader _frames;
    std::uint64_t _lyingLengths = 0;
    std::uint64_t _encrypted = 0;
};

/// A frame's body as a record, unwrapped; none when it is anything else. `body` is overwritten in part.
struct FramedRecord {
    ByteView packet;
    std::uint64_t timestamp = 0;
    std::optional<std::int32_t> subscription;
};
std::optional<FramedRecord> framedRecord(wire::MutableBytes body);

}  // namespace kelvo
