#pragma once

#include <chrono>
#include <functional>
#include <map>
#include <optional>
#include <string>

#include "platform/system/SteadyTime.h"
#include "telephony/wire/Answers.h"

namespace kelvo::wire {

/// Asks the modem one thing at a time, again when no answer comes, and knows the answer among everything else.
class Requester {
public:
    using nanoseconds = std::chrono::nanoseconds;

    struct Patience {
        nanoseconds limit;  ///< of one try
        int tries;
    };

    /// `send` takes the body of a frame.
    Requester(SteadyTime now, std::function<void(ByteView)> send) : _now(std::move(now)), _send(std::move(send)) {}

    void ask(Bytes request, Patience patience);
    void forget() { _request.clear(); }
    /// Nothing is waited for, and nothing that was asked before will be answered any more: the port was opened anew.
    void reset();
    bool isWaiting() const { return !_request.empty(); }
    const Bytes& request() const { return _request; }

    /// What `body` is to the request; after an answer or a refusal nothing is waited for any more.
    Match hear(ByteView body);
    /// Sends the request again when its time is over; true when that was its last: nothing is waited for any more.
    bool givesUp();
    /// When to call givesUp() next; none while nothing is waited for.
    std::optional<nanoseconds> deadline() const;

private:
    void send();
    std::string key() const;
    bool isLate(ByteView body);

    const SteadyTime _now;
    const std::function<void(ByteView)> _send;
    Bytes _request;  // empty: nothing is waited for
    Patience _patience{};
    int _sent = 0;
    nanoseconds _sentAt{0};
    std::map<std::string, int> _unanswered;  // how many answers each request is still owed
    int _late = 0;                           // answers to the same question, asked earlier, that may still come
};

}  // namespace kelvo::wire
