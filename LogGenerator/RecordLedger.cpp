#include "LogGenerator/RecordLedger.h"

#include <algorithm>
#include <cstring>

#include "LogGenerator/Framing.h"
#include "platform/values/Array.h"
#include "platform/values/Dictionary.h"

namespace kelvo {

using namespace std::chrono_literals;
using std::chrono::microseconds;

namespace {

constexpr std::size_t kTimestampAt = 5;
constexpr microseconds kTick = 1'250us;
constexpr microseconds kDisorder = 2s;     // records of several senders come a little out of order
constexpr microseconds kLongestGap = 24h;  // beyond it a clock was set

std::uint64_t timestampIn(ByteView packet) {
    const std::uint8_t* bytes = packet.data() + kTimestampAt;
    std::uint64_t timestamp = 0;
    for (int i = 7; i >= 0; --i) timestamp = timestamp << 8 | bytes[i];
    return timestamp;
}

void collect(const Value& value, std::vector<std::uint64_t>& numbers) {
    if (value.record() != 0 && (numbers.empty() || numbers.back() != value.record())) numbers.push_back(value.record());
    if (value.array()) {
        for (const Value& element : *value.array()) collect(element, numbers);
    } else if (value.dictionary()) {
        for (const auto& [key, child] : *value.dictionary()) collect(child, numbers);
    }
}

}  // namespace

ByteView RecordLedger::packetOf(ByteView message) {
    return message.size() >= kMinimumMessageSize ? stripPrefix(message) : ByteView();
}

std::uint64_t RecordLedger::append(ByteView packet, Arrival arrival) {
    if (isFull()) forgetOldest();
    const bool isPacket = packet.size() >= kMinimumMessageSize;
    const std::uint64_t timestamp = isPacket ? timestampIn(packet) : 0;
    _now = advance(timestamp, arrival);
    _arrived = arrival;
    _entries.push_back({.number = ++_count,
                        .timestamp = timestamp,
                        .arrival = arrival,
                        .stream = _now,
                        .code = isPacket ? logCode(packet.data()) : 0});
    return _count;
}

RecordLedger::StreamTime RecordLedger::advance(std::uint64_t timestamp, Arrival arrival) {
    const StreamTime own = static_cast<std::int64_t>(timestamp >> 16) * kTick;
    const StreamTime step = own + _clockOffset - _now;
    if (timestamp != 0 && step >= -kDisorder && step <= kLongestGap) return _now + std::max(step, StreamTime());
    const StreamTime waited = streamTime(arrival);
    if (timestamp != 0) _clockOffset = waited - own;
    return waited;
}

RecordLedger::StreamTime RecordLedger::streamTime(Arrival now) const {
    if (_count == 0) return {};
    return _now + std::chrono::duration_cast<StreamTime>(std::max(now - _arrived, Arrival()));
}

const RecordLedger::Entry* RecordLedger::find(std::uint64_t number) const {
    const auto at = std::ranges::lower_bound(_entries, number, {}, &Entry::number);
    return at != _entries.end() && at->number == number ? &*at : nullptr;
}

ByteView RecordLedger::bytesOf(const Entry& entry) const {
    const auto kept = std::ranges::find(_kept, entry.number, &Kept::number);
    return kept != _kept.end() ? ByteView(kept->bytes) : ByteView();
}

void RecordLedger::keepBytes(ByteView packet) {
    if (packet.size() < kMinimumMessageSize) return;
    const LogCode code = _entries.back().code;
    auto kept = std::find_if(_kept.begin(), _kept.end(), [code](const Kept& one) { return one.code == code; });
    if (kept == _kept.end()) kept = _kept.insert(kept, {.code = code, .number = 0, .bytes = {}});
    kept->number = _count;
    if (kept->bytes.size() != packet.size()) kept->bytes.resize(packet.size());
    std::memcpy(kept->bytes.data(), packet.data(), packet.size());
}

void RecordLedger::forgetAllBut(const Value& display) {
    std::vector<std::uint64_t> numbers;
    collect(display, numbers);
    std::ranges::sort(numbers);
    numbers.erase(std::unique(numbers.begin(), numbers.end()), numbers.end());
    std::vector<Entry> remembered;
    remembered.reserve(kCapacity);
    for (const std::uint64_t number : numbers) {
        if (const Entry* entry = find(number)) remembered.push_back(*entry);
    }
    _entries = std::move(remembered);
    if (_entries.size() > kCapacity / 2) forgetOldest();
}

void RecordLedger::forgetOldest() {
    const std::size_t excess = _entries.size() - std::min(_entries.size(), kCapacity / 2);
    _entries.erase(_entries.begin(), _entries.begin() + static_cast<std::ptrdiff_t>(excess));
}

}  // namespace kelvo
