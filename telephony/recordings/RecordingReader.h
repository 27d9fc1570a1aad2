#pragma once

#include <cstdint>
#include <optional>

#include "platform/values/Bytes.h"
#include "platform/values/Result.h"
#include "telephony/wire/Timestamp.h"

namespace kelvo {

/// One record of a recording.
struct RecordedMessage {
    ByteView message;                          ///< as the service would deliver it; borrowed until the next one
    std::optional<wire::SystemTime> time;      ///< when it was recorded; none while the modem's clock was not set
    std::optional<std::int32_t> subscription;  ///< of a phone with several SIMs: which one's
};

/// What a recording holds besides sound records.
struct RecordingDamage {
    std::uint64_t damagedFrames = 0;     ///< bad checksums, escapes and lengths: each cost itself
    std::uint64_t skippedBytes = 0;      ///< between records, until the next sound one
    std::uint64_t encryptedRecords = 0;  ///< the modem has encrypted them
    bool isCut = false;                  ///< ends within a record, a frame or packed data

    bool operator==(const RecordingDamage&) const = default;
};

/// The records of a file, in its order. A damaged stretch costs itself and is counted.
class RecordingReader {
public:
    virtual ~RecordingReader() = default;

    /// The next record, none after the last. A failure is one of the file system.
    virtual Result<std::optional<RecordedMessage>> next() = 0;
    /// What has been met so far.
    virtual RecordingDamage damage() const = 0;
};

}  // namespace kelvo
