#include "telephony/recordings/DlfRecording.h"

#include <array>
#include <chrono>

#include "LogGenerator/LogCode.h"
#include "telephony/wire/LittleEndian.h"

namespace kelvo {

namespace {

constexpr std::size_t kHeader = 12;
constexpr std::size_t kLongest = 65535;
constexpr std::size_t kMostBefore = 3;
constexpr int kFollowingWhenLost = 3;
constexpr std::size_t kLookAhead = (kFollowingWhenLost + 1) * (kLongest + kMostBefore);
constexpr std::size_t kPiece = 1024 * 1024;
constexpr std::uint8_t kOrdinary = 1;
constexpr std::uint8_t kExtended = 255;
constexpr std::uint16_t kMostExtendedCodes = 2;  // 0xff0000 to 0xff0002

/// A modem's clock shows the time, or counts from 1980 on for as long as one runs without a network.
bool isModemTime(std::uint64_t timestamp) {
    constexpr std::uint64_t kTenYears = std::uint64_t{800} * 86400 * 3653;
    return timestamp >> 16 < kTenYears || wire::timeOf(timestamp).has_value();
}

bool isLogType(std::uint8_t byte) { return byte == kOrdinary || byte == kExtended; }

/// The ways in which a record may stand at the front of `bytes`: behind its log type, behind a prefix and its log type,
/// and by itself.
constexpr std::array<std::size_t, 3> kBefore = {1, kMostBefore, 0};

bool mayStandBehind(ByteView bytes, std::size_t before) {
    if (before == 0) return true;
    if (bytes.size() <= before || !isLogType(bytes[before - 1])) return false;
    return before == 1 || bytes[0] == 0x81;
}

/// The size of the record at the front; 0 when there is no sound one.
std::size_t recordSizeAt(ByteView bytes) {
    if (bytes.size() < kHeader) return 0;
    const std::size_t size = wire::u16At(bytes, 0);
    const bool sound = size >= kHeader && size <= bytes.size() && isModemTime(wire::u64At(bytes, 4));
    return sound ? size : 0;
}

}  // namespace

std::optional<DlfPlace> dlfRecordAt(ByteView bytes, int following) {
    for (const std::size_t before : kBefore) {
        if (!mayStandBehind(bytes, before)) continue;
        const std::size_t size = recordSizeAt(bytes.subspan(before));
        if (size == 0) continue;
        const ByteView behind = bytes.subspan(before + size);
        if (following == 0 || behind.empty() || dlfRecordAt(behind, following - 1)) return DlfPlace{before, size};
    }
    return std::nullopt;
}

Result<std::optional<RecordedMessage>> DlfRecording::next() {
    for (;;) {
        if (const auto filled = fill(kLookAhead); !filled) return filled.error();
        const ByteView bytes = rest();
        if (bytes.empty()) return std::optional<RecordedMessage>();
        // What follows tells a record from what looks like one, until it is damaged itself.
        auto place = dlfRecordAt(bytes, _lost ? kFollowingWhenLost : 1);
        if (!place && !_lost) place = dlfRecordAt(bytes, 0);
        if (!place) {
            _cut = _cut || !_lost;
            _lost = true;
            ++_skipped;
            ++_at;
            continue;
        }
        _lost = false;
        _cut = false;
        _at += place->before + place->size;
        return std::optional(message(bytes.first(place->before + place->size), place->before));
    }
}

RecordedMessage DlfRecording::message(ByteView bytes, std::size_t before) {
    const ByteView record = bytes.subspan(before);
    const bool isExtended = wire::u16At(record, 2) <= kMostExtendedCodes;
    _packet.assign(1, before != 0 ? bytes[before - 1] : isExtended ? kExtended : kOrdinary);
    _packet.insert(_packet.end(), record.begin(), record.end());
    return {_packet, wire::timeOf(wire::u64At(record, 4)), std::nullopt};
}

Result<void> DlfRecording::fill(std::size_t bytes) {
    if (_ended || _bytes.size() - _at >= bytes) return {};
    _bytes.erase(_bytes.begin(), _bytes.begin() + static_cast<std::ptrdiff_t>(_at));
    _at = 0;
    const std::size_t had = _bytes.size();
    _bytes.resize(had + kPiece);
    const auto got = _file.read(std::span(_bytes).subspan(had));
    if (!got) return got.error();
    _bytes.resize(had + *got);
    _ended = *got < kPiece;
    return {};
}

}  // namespace kelvo
