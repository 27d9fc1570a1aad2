#pragma once

#include <optional>

#include "telephony/recordings/RecordingFile.h"
#include "telephony/recordings/RecordingReader.h"

namespace kelvo {

/// A DLF file: records back to back, each from its length on (u16 length, u16 code, u64 timestamp, payload). In the
/// extract of a snapshot most records have their log type byte in front, some the two bytes of a message's prefix too.
class DlfRecording final : public RecordingReader {
public:
    explicit DlfRecording(RecordingFile file) : _file(std::move(file)) {}

    Result<std::optional<RecordedMessage>> next() override;
    RecordingDamage damage() const override { return {.skippedBytes = _skipped, .isCut = _cut || _file.isCut()}; }

private:
    Result<void> fill(std::size_t bytes);
    RecordedMessage message(ByteView bytes, std::size_t before);
    ByteView rest() const { return ByteView(_bytes).subspan(_at); }

    RecordingFile _file;
    Bytes _bytes;         // what has been read of the file and not been given
    std::size_t _at = 0;  // of it: the next byte
    bool _ended = false;  // the file has no more
    bool _lost = false;   // where the next record begins is not known
    Bytes _packet;        // the message given last
    std::uint64_t _skipped = 0;
    bool _cut = false;  // what could not be read last may have been the beginning of a record
};

/// Where in `bytes` the next record stands, and how long it is with what stands before it.
struct DlfPlace {
    std::size_t before = 0;  ///< 0, 1 (a log type byte) or 3 (a prefix as well)
    std::size_t size = 0;    ///< of the record
};

/// The record at the front of `bytes`; none when there is no sound one: its length must lie within them, its time must
/// be one of a modem, and so must it be with the next `following` records, as far as the bytes go.
std::optional<DlfPlace> dlfRecordAt(ByteView bytes, int following);

}  // namespace kelvo
