#pragma once

#include <optional>
#include <string>

#include "platform/system/SystemLog.h"
#include "telephony/wire/CampedTechnology.h"
#include "telephony/wire/LossMeter.h"
#include "telephony/wire/MaskKeeper.h"
#include "telephony/wire/Requester.h"
#include "telephony/wire/SubscriptionChoice.h"

namespace kelvo::wire {

/// What is said on a modem's diagnostic port, from its opening to its end: silences what an earlier reader left
/// running, asks what the modem is and has, asks it for the wanted records and hands them over, and silences it again.
/// Knows nothing of ports and timers: bytes, time and wishes are handed in. One object serves a port as often as it is
/// opened; counts and the choice of a SIM outlive its openings. Main queue only.
class Session {
public:
    using nanoseconds = std::chrono::nanoseconds;

    /// What becomes of a record.
    enum class Taken {
        Delivered,
        ForNobody,  ///< no client wants it
        Refused,    ///< clients want it, but not in a layout that nobody knows
    };

    /// Whose session it is. Must not call back into the session.
    class Owner {
    public:
        virtual ~Owner() = default;
        /// Bytes for the modem.
        virtual void sendToModem(ByteView bytes) = 0;
        /// A record as the modem worded it, with its own timestamp.
        virtual Taken takeRecord(ByteView packet, std::uint64_t timestamp) = 0;
    };

    struct Options {
        std::optional<Technology> technology;      ///< none: listens to what the phone is camped on
        std::optional<std::int32_t> subscription;  ///< none: the first that sends
    };

    enum class State {
        Closed,       ///< nothing is to be said: before the opening, and after the end
        Silencing,    ///< reads what comes until it is quiet
        Identifying,  ///< the version: is it a diagnostic port?
        Naming,       ///< the build
        Ranging,      ///< which records it has
        Emptying,     ///< one equipment after the other
        Running,
        Ending,  ///< reads what comes until it is quiet
    };

    Session(Owner& owner, SteadyTime now, Options options);

    /// The port called `name` is open.
    void begin(std::string name);
    /// What the modem sent; the bytes are not as they were afterwards.
    void receive(MutableBytes bytes);
    /// Time has passed: to be called at the deadline.
    void tick();
    std::optional<nanoseconds> deadline() const;
    /// Which records are wanted from now on, whether or not a port is open; a modem may send `instead` in their place,
    /// and nothing is said of one that cannot.
    void want(const RecordCodes& codes, const RecordCodes& instead = {});
    /// Silences the modem; the state is Closed when it is quiet, after two seconds at most.
    void end();
    /// The port has gone: Closed at once.
    void lose();
    /// The technology is of no interest any more: the next opening listens again.
    void forgetTechnology();

    State state() const { return _state; }
    /// Whether an answer is waited for.
    bool isAsking() const { return _requester.isWaiting(); }
    /// Why the session ended by itself; empty when it did not.
    const std::string& failure() const { return _failure; }
    /// None: not known yet.
    std::optional<Technology> technology() const;
    /// What the phone is camped on now; none: not known yet, or nobody listens, since the options name the technology.
    std::optional<Technology> campedOn() const { return _camped.known(); }
    std::optional<std::int32_t> subscription() const { return _subscription.chosen(); }
    /// Whatever a port gives that no modem has answered at counts for nothing.
    const PortCounts& counts() const { return _before ? *_before : _counts; }
    bool isLosing() const { return _loss.isLosing(); }
    bool isEncrypted() const { return _encrypted; }
    const std::string& target() const { return _target; }    ///< what the modem calls itself; may be empty
    const std::string& buildId() const { return _buildId; }  ///< likewise

private:
    void sendFrame(ByteView body);
    void silence(State state);
    void identify();
    void disown();
    void empty(std::uint32_t equipment);
    void run();
    void askNext();
    void ask(const Bytes& request, State state, Requester::Patience patience);
    void fail(std::string reason);

    void handle(MutableBytes body);
    void handleRecord(MutableBytes body, std::int32_t subscription);
    void handleEncrypted();
    void handleAnswer(ByteView body);
    void answered(ByteView body);
    void refused(std::string_view why);
    void gaveUp();
    void applyRanges(ByteView body);
    void applyMask(const std::optional<LogMask>& inForce);
    void proceed();
    void settleTechnology();
    void settleLoss();
    void tell(Level level, const std::string& text) const;
    void tellUnknownCodes();

    Owner& _owner;
    const SteadyTime _now;
    const Options _options;
    State _state = State::Closed;
    std::string _name;
    std::string _failure;
    FrameReader _reader;
    Requester _requester;
    MaskKeeper _masks;
    SubscriptionChoice _subscription;
    CampedTechnology _camped;
    LossMeter _loss;
    PortCounts _counts;
    std::optional<PortCounts> _before;  // the counts when an opening began that no modem has answered yet
    RecordCodes _wanted;                // by clients
    nanoseconds _stateBegan{0};         // of Silencing and Ending
    nanoseconds _lastHeard{0};          // likewise
    std::uint32_t _emptying = 0;        // the equipment
    bool _toldShort = false;            // of the request in wait
    bool _asked = false;                // the modem has been asked for records since the port was opened
    bool _encrypted = false;
    std::string _target;
    std::string _buildId;
};

}  // namespace kelvo::wire
