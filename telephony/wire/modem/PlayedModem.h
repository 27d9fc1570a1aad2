#pragma once

#include <chrono>
#include <deque>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "telephony/wire/FrameReader.h"
#include "telephony/wire/modem/FaultyLine.h"
#include "telephony/wire/modem/ModemAnswers.h"
#include "telephony/wire/modem/ModemChatter.h"
#include "telephony/wire/modem/ModemRecords.h"

namespace kelvo::modem {

/// A modem behind its diagnostic port: takes what a reader writes, answers, and sends the records that it is asked for
/// in their time. What it plays begins when the first mask is set, a moment after the last of the first ones, and goes
/// on from then on whether or not anybody reads. The same records, faults, seed and bytes at the same times give the
/// same bytes. It has no clock: times are the caller's, and never go back.
class PlayedModem {
public:
    using Time = std::chrono::nanoseconds;

    /// `second` are the records of a second SIM; null: there is none.
    PlayedModem(std::unique_ptr<ModemRecords> first, std::unique_ptr<ModemRecords> second, Faults faults,
                std::uint64_t seed);
    PlayedModem(const PlayedModem&) = delete;
    PlayedModem& operator=(const PlayedModem&) = delete;

    /// Takes bytes of the reader's; while it is unplugged they are lost.
    void receive(ByteView bytes, Time now);
    /// The bytes that are to be sent next; nothing while there are none. Valid until the next call.
    ByteView output(Time now);
    /// So many bytes of the output have been sent.
    void sent(std::size_t bytes) { _sent += bytes; }
    /// When to look again once the output has been sent: a time in the past means at once, none that only the reader
    /// can change anything.
    std::optional<Time> nextDue() const;

    /// Whether its port can be seen. To be asked whenever something is due: this is where it hangs up and comes back.
    bool isPluggedIn(Time now);
    /// Pulled out by hand, and put back: then it has forgotten what its reader asked for.
    void unplug();
    void plugIn(Time now);

    const Tally& tally() const { return _tally; }

private:
    struct Sim {
        std::unique_ptr<ModemRecords> records;
        std::optional<ModemRecord> next;
    };
    struct Waiting {
        std::size_t sim;
        Bytes record;
    };
    struct Reply {
        Time due;
        Bytes frames;
    };

    void handle(ByteView request, Time now);
    Time delayOf(ByteView request);
    void begin(Time now);
    void gather(Time now);
    std::optional<std::size_t> nextSim() const;
    void take(std::size_t sim);
    void chat(Time now);
    bool hasRoom() const { return _output.size() - _sent < kLine && !_leaving; }
    void sendRecord();
    void hangUp();

    static constexpr std::size_t kLine = 4096;  // bytes on their way

    const Faults _faults;
    simulation::Random _random;
    Tally _tally;
    FaultyLine _line;
    ModemChatter _chatter;
    ModemAnswers _answers;
    wire::FrameReader _reader;
    std::vector<Sim> _sims;
    std::optional<Time> _began;  // the first record's time
    std::deque<Waiting> _waiting;
    std::deque<Reply> _replies;
    std::set<std::string> _asked;  // the beginnings of requests whose first answer has been lost
    std::optional<Time> _nextChat;
    Bytes _output;
    std::size_t _sent = 0;  // bytes of _output
    bool _pluggedIn = false;
    int _untilHangUp = 0;         // records
    bool _leaving = false;        // hangs up as soon as the output has been read
    std::optional<Time> _leaves;  // and when
    std::optional<Time> _returns;
};

}  // namespace kelvo::modem
