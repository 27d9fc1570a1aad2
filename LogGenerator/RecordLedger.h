#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <vector>

#include "LogGenerator/LogCode.h"
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
    static ByteView packetOf(ByteView message);

    /// How many messages have been counted: the number of the last one.
    std::uint64_t count() const { return _count; }
    /// The record with that number; null when it is none of those remembered. Holds until the next is counted.
    const Entry* find(std::uint64_t number) const;
    /// The bytes of that record, from the log type byte on; empty when a later one of its code has shown something.
    ByteView bytesOf(const Entry& entry) const;
    /// The stream's time `now`, in the arrivals' clock: it goes on while no records come.
    StreamTime streamTime(Arrival now) const;

    /// No more than a few records fit: it is time for `forgetAllBut`. Without it the oldest are forgotten.
    bool isFull() const { return _entries.size() >= kCapacity; }
    /// Forgets every record that no value of `display` comes from.
    void forgetAllBut(const Value& display);

private:
    struct Kept {
        LogCode code;
        std::uint64_t number;
        Bytes bytes;
    };

    std::uint64_t append(ByteView packet, Arrival arrival);
    StreamTime advance(std::uint64_t timestamp, Arrival arrival);
    void keepBytes(ByteView packet);
    void forgetOldest();

    std::uint64_t _count = 0;
    StreamTime _now{0};           // the stream's time of the last one
    Arrival _arrived{0};          // and when it came
    StreamTime _clockOffset{0};   // from a record's own time to the stream's
    std::vector<Entry> _entries;  // by number
    std::vector<Kept> _kept;      // one a code
};

}  // namespace kelvo
