#include "tools/doctor/ModemProbe.h"

#include <algorithm>
#include <string_view>

#include "telephony/wire/FrameReader.h"
#include "telephony/wire/FrameWriter.h"
#include "telephony/wire/Protocol.h"
#include "telephony/wire/Requester.h"
#include "telephony/wire/Wrapper.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using wire::Command;
using wire::Match;

constexpr wire::Requester::Patience kVersionPatience{1s, 2};
constexpr wire::Requester::Patience kPatience{5s, 3};

bool is(ByteView body, Command command) { return body[0] == static_cast<std::uint8_t>(command); }

// A text of the modem's, up to its zero and without the blanks that fill it up.
std::string textIn(ByteView bytes) {
    std::string_view text = textOf(bytes);
    text = text.substr(0, text.find('\0'));
    return std::string(text.substr(0, text.find_last_not_of(' ') + 1));
}

/// Asks one thing after the other, and waits.
class Conversation {
public:
    Conversation(ProbedPort& port, const SteadyTime& now)
        : _port(port), _now(now), _requester(now, [&port](ByteView body) { port.write(wire::frameOf(body)); }) {}

    /// The answer's body; empty when there was none, with the reason in failure().
    Bytes ask(ByteView request, wire::Requester::Patience patience) {
        _answer.clear();
        _failure.clear();
        _requester.ask(Bytes(request.begin(), request.end()), patience);
        while (_requester.isWaiting() && _port.isOpen()) {
            if (_requester.givesUp()) break;
            Bytes bytes = _port.read(std::max(*_requester.deadline() - _now(), std::chrono::nanoseconds(0)));
            _heardAnything |= !bytes.empty();
            wire::MutableBytes input(bytes);
            while (const auto body = _reader.next(input)) hear(*body);
        }
        if (_answer.empty() && _failure.empty()) _failure = _port.isOpen() ? "no answer" : "the other end has gone";
        return _answer;
    }
    const std::string& failure() const { return _failure; }
    bool isStreaming() const { return _streaming; }
    bool heardAnything() const { return _heardAnything; }

private:
    void hear(wire::MutableBytes body) {
        if (is(body, Command::MultiRadio)) {
            const auto wrapped = wire::unwrap(body);
            if (!wrapped) return;
            body = wrapped->body;
        }
        _streaming |= is(body, Command::Record) || is(body, Command::EncryptedRecord);
        switch (_requester.hear(body)) {
            case Match::Answer: _answer.assign(body.begin(), body.end()); break;
            case Match::Refusal: _failure = "refused: " + std::string(wire::refusalText(body[0])); break;
            case Match::TooShort:
            case Match::No: break;
        }
    }

    ProbedPort& _port;
    const SteadyTime& _now;
    wire::Requester _requester;
    wire::FrameReader _reader;
    Bytes _answer;
    std::string _failure;
    bool _streaming = false;
    bool _heardAnything = false;
};

}  // namespace

ModemProbe probeModem(ProbedPort& port, const SteadyTime& now) {
    ModemProbe probe;
    Conversation modem(port, now);
    const Bytes version = modem.ask(wire::kVersionRequest, kVersionPatience);
    if (version.empty()) {
        probe.failure = !port.isOpen()          ? "the other end has gone"
                        : modem.heardAnything() ? "answers, but not as a diagnostic port does"
                                                : "does not answer: not a diagnostic port, or in use";
        return probe;
    }
    probe.target = textIn(ByteView(version).subspan(wire::kTargetNameAt, wire::kTargetNameSize));
    const Bytes build = modem.ask(wire::kBuildIdRequest, kPatience);
    if (!build.empty()) probe.buildId = textIn(ByteView(build).subspan(wire::kBuildIdTextAt));
    const Bytes ranges = modem.ask(wire::rangesRequest(), kPatience);
    const auto answer = wire::parseConfigurationAnswer(ranges);
    if (answer && answer->status == 0) probe.ranges = wire::parseRanges(answer->data);
    if (!probe.ranges) probe.rangesFailure = modem.failure().empty() ? "refused" : modem.failure();
    probe.isStreaming = modem.isStreaming();
    return probe;
}

}  // namespace kelvo
