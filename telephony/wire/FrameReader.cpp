#include "telephony/wire/FrameReader.h"

#include <algorithm>
#include <cstring>
#include <utility>

#include "telephony/wire/Checksum.h"
#include "telephony/wire/FrameWriter.h"
#include "telephony/wire/LittleEndian.h"

namespace kelvo::wire {
namespace {

constexpr std::size_t kChecksumSize = 2;
constexpr std::size_t kShortestFrame = 3;
constexpr std::size_t kLongestContent = FrameReader::kLongestFrame - 1;  // without the end mark

std::uint8_t* find(std::uint8_t wanted, std::uint8_t* from, std::uint8_t* end) {
    void* const at = from == end ? nullptr : std::memchr(from, wanted, static_cast<std::size_t>(end - from));
    return at != nullptr ? static_cast<std::uint8_t*>(at) : end;
}

// Takes the escapes out, in place; none when one of them is bad.
std::optional<MutableBytes> unescape(MutableBytes frame) {
    std::uint8_t* const end = frame.data() + frame.size();
    std::uint8_t* from = find(kEscape, frame.data(), end);
    std::uint8_t* to = from;
    while (from != end) {
        if (end - from < 2 || (from[1] != (kEscape ^ kEscapeBit) && from[1] != (kFrameEnd ^ kEscapeBit)))
            return std::nullopt;
        *to++ = from[1] ^ kEscapeBit;
        from += 2;
        std::uint8_t* const next = find(kEscape, from, end);
        to = std::copy(from, next, to);  // towards the front
        from = next;
    }
    return frame.first(static_cast<std::size_t>(to - frame.data()));
}

}  // namespace

std::optional<MutableBytes> FrameReader::next(MutableBytes& input) {
    if (std::exchange(_handedOut, false)) _kept.clear();
    while (!input.empty()) {
        std::uint8_t* const inputEnd = input.data() + input.size();
        std::uint8_t* const mark = find(kFrameEnd, input.data(), inputEnd);
        const MutableBytes content = input.first(static_cast<std::size_t>(mark - input.data()));
        const bool ended = mark != inputEnd;
        input = input.subspan(content.size() + (ended ? 1 : 0));
        _counts.bytes += content.size() + (ended ? 1 : 0);
        if (!ended) {
            keep(content);
        } else if (const auto body = finish(content)) {
            return body;
        }
    }
    return std::nullopt;
}

void FrameReader::reset() {
    if (std::exchange(_handedOut, false)) _kept.clear();
    if (!_kept.empty()) refuse(_counts.unfinished);
    _skipping = false;
    _first = true;
}

void FrameReader::rewind(const Counts& counts) {
    reset();
    _counts = counts;
}

void FrameReader::keep(MutableBytes beginning) {
    if (_skipping) return;
    if (_kept.size() + beginning.size() > kLongestContent) {
        refuse(_counts.oversized);
        _skipping = true;
    } else {
        _kept.insert(_kept.end(), beginning.begin(), beginning.end());
    }
}

std::optional<MutableBytes> FrameReader::finish(MutableBytes ending) {
    std::optional<MutableBytes> body;
    if (_skipping) {
        _skipping = false;
    } else if (_kept.empty()) {
        body = open(ending);
    } else {
        keep(ending);
        body = std::exchange(_skipping, false) ? std::nullopt : open(_kept);
        _handedOut = body.has_value();
    }
    if (!_handedOut) _kept.clear();
    _first = false;
    return body;
}

std::optional<MutableBytes> FrameReader::open(MutableBytes frame) {
    if (frame.empty()) return std::nullopt;
    if (frame.size() > kLongestContent) return refuse(_counts.oversized);
    if (frame.size() < kShortestFrame) return refuse(_counts.tooShort);
    const auto content = unescape(frame);
    if (!content) return refuse(_counts.badEscapes);
    if (content->size() < kShortestFrame) return refuse(_counts.tooShort);
    const MutableBytes body = content->first(content->size() - kChecksumSize);
    if (checksum(body) != u16At(*content, body.size())) return refuse(_counts.badChecksums);
    ++_counts.frames;
    return body;
}

std::optional<MutableBytes> FrameReader::refuse(std::uint64_t& count) {
    if (!_first) ++count;
    _kept.clear();
    return std::nullopt;
}

}  // namespace kelvo::wire
