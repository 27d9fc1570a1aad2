#include "LogGenerator/RecordLedger.h"

#include <algorithm>

#include "platform/values/Array.h"
#include "platform/values/Dictionary.h"

namespace kelvo {

namespace {

void collect(const Value& value, std::vector<std::uint64_t>& numbers) {
    if (value.record() != 0 && (numbers.empty() || numbers.back() != value.record())) numbers.push_back(value.record());
    if (value.array()) {
        for (const Value& element : *value.array()) collect(element, numbers);
    } else if (value.dictionary()) {
        for (const auto& [key, child] : *value.dictionary()) collect(child, numbers);
    }
}

}  // namespace

/// The record's own time says nothing about the one before it: the stream's goes by the clock.
RecordLedger::StreamTime RecordLedger::leap(StreamTime own, Arrival arrival) {
    const StreamTime waited = streamTime(arrival);
    _clockOffset = waited - own;
    return waited;
}

RecordLedger::StreamTime RecordLedger::streamTime(Arrival now) const {
    if (_count == 0) return {};
    return _now + std::chrono::duration_cast<StreamTime>(std::max(now - _arrived, Arrival()));
}

const RecordLedger::Entry* RecordLedger::find(std::uint64_t number) const {
    const std::span<const Entry> entries = this->entries();
    const auto at = std::ranges::lower_bound(entries, number, {}, &Entry::number);
    return at != entries.end() && at->number == number ? &*at : nullptr;
}

ByteView RecordLedger::bytesOf(const Entry& entry) const {
    const auto kept = std::ranges::find(_kept, entry.number, &Kept::number);
    return kept != _kept.end() ? ByteView(kept->bytes) : ByteView();
}

RecordLedger::Kept& RecordLedger::lookForKept(LogCode code) {
    auto found = std::ranges::find(_kept, code, &Kept::code);
    if (found == _kept.end()) found = _kept.insert(found, {.code = code, .number = 0, .bytes = {}});
    _guess[code % 64] = static_cast<std::uint8_t>(found - _kept.begin());
    return *found;
}

void RecordLedger::forgetAllBut(const Value& display) {
    std::vector<std::uint64_t> numbers;
    collect(display, numbers);
    std::ranges::sort(numbers);
    numbers.erase(std::unique(numbers.begin(), numbers.end()), numbers.end());
    // In place: what has been moved to the front stays in order with what has not been looked for yet.
    std::size_t remembered = 0;
    for (const std::uint64_t number : numbers) {
        if (const Entry* entry = find(number)) _entries[remembered++] = *entry;
    }
    _size = remembered;
    forgetOldest();
}

void RecordLedger::forgetOldest() {
    const std::size_t kept = std::min(_size, kCapacity / 2);
    std::copy(_entries.get() + (_size - kept), _entries.get() + _size, _entries.get());
    _size = kept;
}

}  // namespace kelvo
