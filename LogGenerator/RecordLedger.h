#pragma once

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdint>
#include <cstring>
#include <memory>
#include <span>
#include <vector>

#include "LogGenerator/Framing.h"
#include "LogGenerator/RecordBeingShown.h"
#include "platform/telephony/RecordTime.h"
#include "platform/values/Bytes.h"
#include "platform/values/Value.h"

namespace kelvo {

/// Numbers the records that are written to one display, from 1 on, and remembers those behind its values: the value
/// keeps the number, the ledger the rest. It lives as long as the display, over reconnections and generators.
///
/// Two clocks: arrivals are told by the caller, in nanoseconds of any clock that does not go back. The stream's clock
/// goes with the records' own times, so that a replay at ten times the speed ages its values ten times as fast; it
/// leaps neither when a replay begins anew nor when a modem learns the time, and goes with the arrivals where records
/// bear no time.
///
/// Memory: at most `kCapacity` entries of 40 bytes, and of each log code that has shown something the bytes of the
/// record that did so last.
class RecordLedger {
public:
    using Arrival = std::chrono::nanoseconds;
    using StreamTime = std::chrono::microseconds;

    static constexpr std::size_t kCapacity = 4096;

    struct Entry {
        std::uint64_t number;
        std::uint64_t timestamp;  ///< as the record bears it; 0 for none
        Arrival arrival;
        StreamTime stream;
        LogCode code;  ///< 0 for a message that is no packet
    };

    /// Counts one message; for as long as this lives, what is written to a display bears its number.
    class Counted {
    public:
        /// `packet` is the message without its prefix, empty for one that is no packet; borrowed as long as this lives.
        Counted(RecordLedger& ledger, ByteView packet, Arrival arrival)
            : _ledger(ledger), _packet(packet), _scope(ledger.append(packet, arrival)) {}
        ~Counted() {
            if (_scope.showsSomething()) _ledger.keepBytes(_packet);
        }
        Counted(const Counted&) = delete;
        Counted& operator=(const Counted&) = delete;

    private:
        RecordLedger& _ledger;
        const ByteView _packet;
        const RecordBeingShown::Scope _scope;
    };

    /// The packet of a message that bears one; else empty.
    static ByteView packetOf(ByteView message) {
        const ByteView packet = message.size() >= kMinimumMessageSize ? stripPrefix(message) : ByteView();
        return packet.size() >= kMinimumMessageSize ? packet : ByteView();
    }

    /// How many messages have been counted: the number of the last one.
    std::uint64_t count() const { return _count; }
    /// The record with that number; null when it is none of those remembered. Holds until the next is counted.
    const Entry* find(std::uint64_t number) const;
    /// The bytes of that record, from the log type byte on; empty when a later one of its code has shown something.
    ByteView bytesOf(const Entry& entry) const;
    /// The stream's time `now`, in the arrivals' clock: it goes on while no records come.
    StreamTime streamTime(Arrival now) const;

    /// No more than a few records fit: it is time for `forgetAllBut`. Without it the oldest are forgotten.
    bool isFull() const { return _size == kCapacity; }
    /// Forgets every record that no value of `display` comes from.
    void forgetAllBut(const Value& display);

private:
    struct Kept {
        LogCode code;
        std::uint64_t number;
        Bytes bytes;
    };

    static constexpr std::size_t kTimestampAt = 5;

    std::span<const Entry> entries() const { return {_entries.get(), _size}; }
    std::uint64_t append(ByteView packet, Arrival arrival);
    StreamTime advance(std::uint64_t timestamp, Arrival arrival);
    StreamTime leap(StreamTime own, Arrival arrival);
    void keepBytes(ByteView packet);
    Kept& keptOf(LogCode code);
    Kept& lookForKept(LogCode code);
    void forgetOldest();

    std::uint64_t _count = 0;
    StreamTime _now{0};          // the stream's time of the last one
    Arrival _arrived{0};         // and when it came
    StreamTime _clockOffset{0};  // from a record's own time to the stream's
    std::size_t _size = 0;
    std::unique_ptr<Entry[]> _entries = std::make_unique_for_overwrite<Entry[]>(kCapacity);  // by number
    std::vector<Kept> _kept;                                                                 // one a code
    std::array<std::uint8_t, 64> _guess{};  // where the code with these lower bits was found last
};

// Every record passes here: what it costs is counted in instructions.

inline std::uint64_t RecordLedger::append(ByteView packet, Arrival arrival) {
    if (isFull()) forgetOldest();
    const bool isPacket = !packet.empty();
    std::uint64_t timestamp = 0;
    if (isPacket) std::memcpy(&timestamp, packet.data() + kTimestampAt, sizeof timestamp);
    _now = advance(timestamp, arrival);
    _arrived = arrival;
    _entries[_size++] = {.number = ++_count,
                         .timestamp = timestamp,
                         .arrival = arrival,
                         .stream = _now,
                         .code = isPacket ? logCode(packet.data()) : 0};
    return _count;
}

inline RecordLedger::StreamTime RecordLedger::advance(std::uint64_t timestamp, Arrival arrival) {
    constexpr StreamTime kTick{1250};
    constexpr StreamTime kDisorder = std::chrono::seconds(2);   // records of several senders come a little out of order
    constexpr StreamTime kLongestGap = std::chrono::hours(24);  // beyond it a clock was set
    if (timestamp == 0) return streamTime(arrival);
    const StreamTime own = static_cast<std::int64_t>(timestamp >> 16) * kTick;
    const StreamTime step = own + _clockOffset - _now;
    if (step < -kDisorder || step > kLongestGap) return leap(own, arrival);
    return _now + std::max(step, StreamTime());
}

inline void RecordLedger::keepBytes(ByteView packet) {
    if (packet.empty()) return;
    Kept& kept = keptOf(_entries[_size - 1].code);
    kept.number = _count;
    if (kept.bytes.size() != packet.size()) kept.bytes.resize(packet.size());
    std::memcpy(kept.bytes.data(), packet.data(), packet.size());
}

inline RecordLedger::Kept& RecordLedger::keptOf(LogCode code) {
    const std::uint8_t guess = _guess[code % 64];
    return guess < _kept.size() && _kept[guess].code == code ? _kept[guess] : lookForKept(code);
}

}  // namespace kelvo
