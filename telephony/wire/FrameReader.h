#pragma once

#include <cstdint>
#include <optional>
#include <span>

#include "platform/values/Bytes.h"

namespace kelvo::wire {

/// Borrowed raw bytes that may be written to.
using MutableBytes = std::span<std::uint8_t>;

/// Finds the frames in a stream that comes in pieces of any size. Whatever the pieces, the frames and the counts are
/// the same. A damaged frame is counted and costs itself alone; the first one after the opening is usually the end of a
/// frame whose beginning nobody read, and counts for nothing when it is damaged. Keeps at most one frame.
class FrameReader {
public:
    /// A record's length is 16 bits: no frame is longer, escapes and end mark included.
    static constexpr std::size_t kLongestFrame = 2 * 65'551 + 3;

    struct Counts {
        std::uint64_t bytes = 0;         ///< all that were read, end marks and damaged frames included
        std::uint64_t frames = 0;        ///< good ones
        std::uint64_t tooShort = 0;      ///< fewer than three bytes; an empty one is none
        std::uint64_t badEscapes = 0;    ///< 0x7D with neither 0x5D nor 0x5E behind it
        std::uint64_t badChecksums = 0;  ///< the checksum is that of other bytes
        std::uint64_t oversized = 0;     ///< longer than kLongestFrame
        std::uint64_t unfinished = 0;    ///< their end had not come when the stream ended

        std::uint64_t damaged() const { return tooShort + badEscapes + badChecksums + oversized + unfinished; }
        bool operator==(const Counts&) const = default;
    };

    /// Takes bytes off the front of `input` up to the end of the next good frame, and gives its body, unescaped and
    /// without its checksum; none once `input` is used up. A body lies in `input` or in the reader, may be written to,
    /// and is valid until the next call. What has been taken off `input` is not as it was.
    std::optional<MutableBytes> next(MutableBytes& input);

    const Counts& counts() const { return _counts; }

    /// The stream has ended, and another begins. The counts go on.
    void reset();
    /// Likewise, but what has been read of it counts for nothing: the counts are `counts` again.
    void rewind(const Counts& counts);

private:
    void keep(MutableBytes beginning);
    std::optional<MutableBytes> finish(MutableBytes ending);
    std::optional<MutableBytes> open(MutableBytes frame);
    std::optional<MutableBytes> refuse(std::uint64_t& count);

    Bytes _kept;              // the beginning of the frame whose end has not come yet
    bool _handedOut = false;  // _kept is the body that was given last
    bool _skipping = false;   // until the end of an oversized frame
    bool _first = true;       // no end mark has been seen
    Counts _counts;
};

}  // namespace kelvo::wire
