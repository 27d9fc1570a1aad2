#include "telephony/wire/Session.h"

#include <fmt/format.h>

#include <algorithm>

#include "platform/system/Environment.h"
#include "telephony/wire/FrameWriter.h"
#include "telephony/wire/LittleEndian.h"
#include "telephony/wire/Protocol.h"
#include "telephony/wire/RecordFrame.h"
#include "telephony/wire/Wrapper.h"

namespace kelvo::wire {
namespace {

using namespace std::chrono_literals;

constexpr auto kQuiet = 200ms;
constexpr auto kLongestSilencing = 2s;
constexpr Requester::Patience kVersionPatience{1s, 2};
constexpr Requester::Patience kBuildIdPatience{2s, 1};  // the session goes on without it
constexpr Requester::Patience kPatience{5s, 3};
constexpr Requester::Patience kNoEquipmentPatience{1s, 1};  // what the modem says it does not have

// What a modem writes, without what a terminal would obey.
std::string printable(ByteView text) {
    std::string shown;
    for (const std::uint8_t c : text) {
        if (c == 0) break;
        shown += c >= 0x20 && c < 0x7F ? static_cast<char>(c) : '?';
    }
    shown.erase(shown.find_last_not_of(' ') + 1);
    return shown;
}

std::string listOf(const std::vector<LogCode>& codes) {
    std::string text;
    for (const LogCode code : codes) text += fmt::format("{}0x{:04x}", text.empty() ? "" : ", ", code);
    return text;
}

bool is(ByteView body, Command command) { return body[0] == static_cast<std::uint8_t>(command); }

bool isSilencing(Session::State state) { return state == Session::State::Silencing || state == Session::State::Ending; }

}  // namespace

Session::Session(Owner& owner, SteadyTime now, Options options)
    : _owner(owner),
      _now(now),
      _options(options),
      _requester(std::move(now), [this](ByteView body) { sendFrame(body); }),
      _subscription(options.subscription) {
    want({});
}

void Session::begin(std::string name) {
    _name = std::move(name);
    _failure.clear();
    _asked = false;
    _reader.reset();
    _requester.reset();
    _masks.begin({});
    ++_counts.sessions;
    _before = _counts;
    silence(State::Silencing);
}

void Session::receive(MutableBytes bytes) {
    if (_state == State::Closed || bytes.empty()) return;
    _lastHeard = _now();
    if (_state == State::Silencing) return;          // an earlier reader's
    if (_state == State::Ending && _before) return;  // no modem's
    while (const auto body = _reader.next(bytes)) handle(*body);
    _counts.frames = _reader.counts();
    proceed();
}

void Session::tick() {
    if (_state != State::Closed) proceed();
}

std::optional<std::chrono::nanoseconds> Session::deadline() const {
    if (_state == State::Closed) return std::nullopt;
    std::optional<nanoseconds> earliest;
    const auto consider = [&earliest](std::optional<nanoseconds> deadline) {
        if (deadline && (!earliest || *deadline < *earliest)) earliest = deadline;
    };
    if (isSilencing(_state)) {
        consider(std::min<nanoseconds>(_lastHeard + kQuiet, _stateBegan + kLongestSilencing));
    } else {
        consider(_requester.deadline());
        consider(_camped.deadline());
    }
    consider(_loss.deadline());
    return earliest;
}

void Session::want(const RecordCodes& codes, const RecordCodes& instead) {
    _wanted = codes;
    const RecordCodes asked = codes | instead;
    _masks.want(_options.technology ? asked : asked | CampedTechnology::codes());
    if (_state != State::Running) return;
    tellUnknownCodes();
    askNext();
}

void Session::end() {
    if (_state == State::Closed || _state == State::Ending) return;
    _requester.forget();
    _camped.pause();
    silence(State::Ending);
}

void Session::lose() {
    if (_state == State::Closed) return;
    _state = State::Closed;
    _requester.reset();
    _camped.pause();
    _reader.reset();
    _counts.frames = _reader.counts();
    if (_before) disown();
    settleLoss();
    if (const auto line = _loss.finish(_counts)) tell(Level::Warning, *line);
}

void Session::forgetTechnology() { _camped.forget(); }

std::optional<Technology> Session::technology() const {
    return _options.technology ? _options.technology : _camped.known();
}

void Session::sendFrame(ByteView body) { _owner.sendToModem(frameOf(body)); }

// Nobody waits for these answers: the one to kEventsOff looks like an event.
void Session::silence(State state) {
    _state = state;
    _stateBegan = _lastHeard = _now();
    sendFrame(kEventsOff);
    sendFrame(kRecordsOff);
    sendFrame(kTextsOff);
}

void Session::identify() {
    _reader.reset();  // the rest of a frame of which nothing was read
    ask(Bytes(kVersionRequest.begin(), kVersionRequest.end()), State::Identifying, kVersionPatience);
}

void Session::disown() {
    _counts = *_before;
    _reader.rewind(_counts.frames);
}

void Session::ask(const Bytes& request, State state, Requester::Patience patience) {
    _state = state;
    _toldShort = false;
    _requester.ask(request, patience);
}

void Session::empty(std::uint32_t equipment) {
    if (equipment == kEquipmentIds) return run();
    _emptying = equipment;
    const std::uint32_t items = _masks.ranges()[equipment];
    ask(setMaskRequest(LogMask(equipment, items)), State::Emptying, items > 0 ? kPatience : kNoEquipmentPatience);
}

void Session::run() {
    _state = State::Running;
    _asked = true;
    tellUnknownCodes();
    askNext();
}

void Session::askNext() {
    if (_requester.isWaiting()) return;
    if (const auto mask = _masks.takeNext()) return ask(setMaskRequest(*mask), State::Running, kPatience);
    if (!_options.technology && !_camped.isListening()) _camped.begin(_now());
}

void Session::fail(std::string reason) {
    _failure = std::move(reason);
    end();
}

void Session::handle(MutableBytes body) {
    std::int32_t subscription = 0;
    if (is(body, Command::MultiRadio)) {
        const auto wrapped = unwrap(body);
        if (!wrapped) {
            ++_counts.strange;
            return;
        }
        subscription = wrapped->subscription;
        body = wrapped->body;
    }
    if (is(body, Command::Record)) return handleRecord(body, subscription);
    if (is(body, Command::EncryptedRecord)) return handleEncrypted();
    if (is(body, Command::Text) && body.size() > 3) _counts.textsDropped += body[3];
    handleAnswer(body);
}

void Session::handleRecord(MutableBytes body, std::int32_t subscription) {
    if (!_asked) return;  // an earlier reader's
    const auto frame = parseRecord(body);
    if (!frame) {
        ++_counts.lyingLengths;
        return;
    }
    ++_counts.records;
    _counts.waiting = frame->waiting;
    _counts.mostWaiting = std::max(_counts.mostWaiting, frame->waiting);
    if (!_subscription.admits(subscription)) {
        ++_counts.otherSubscriptions;
        return;
    }
    if (!_options.technology) _camped.heard(frame->code, _lastHeard);
    const LogCode code = frame->code;
    switch (_owner.takeRecord(packetOf(body), frame->timestamp)) {
        case Taken::Delivered: ++_counts.delivered; return;
        case Taken::Refused: ++_counts.refused; return;
        case Taken::ForNobody: break;
    }
    ++(!_wanted.test(code) && _masks.wants(code) ? _counts.listenedTo : _counts.forNobody);
}

void Session::handleEncrypted() {
    ++_counts.encrypted;
    if (!std::exchange(_encrypted, true)) tell(Level::Error, "this modem encrypts its records");
}

void Session::handleAnswer(ByteView body) {
    switch (_requester.hear(body)) {
        case Match::No: ++_counts.passedBy; return;
        case Match::Answer: return answered(body);
        case Match::Refusal: return refused(refusalText(body[0]));
        case Match::TooShort:
            ++_counts.passedBy;
            if (!std::exchange(_toldShort, true))
                tell(Level::Warning, fmt::format("an answer of {} bytes is too short", body.size()));
    }
}

void Session::answered(ByteView body) {
    switch (_state) {
        case State::Identifying:
            _before.reset();
            _target = printable(body.subspan(kTargetNameAt, kTargetNameSize));
            return ask(Bytes(kBuildIdRequest.begin(), kBuildIdRequest.end()), State::Naming, kBuildIdPatience);
        case State::Naming:
            _buildId = printable(body.subspan(kBuildIdTextAt));
            return ask(rangesRequest(), State::Ranging, kPatience);
        case State::Ranging: return applyRanges(body);
        case State::Emptying: return empty(_emptying + 1);
        case State::Running: {
            const auto answer = parseConfigurationAnswer(body);
            return applyMask(answer && answer->status == 0 ? parseMask(answer->data) : std::nullopt);
        }
        default: return;
    }
}

void Session::refused(std::string_view why) {
    switch (_state) {
        case State::Identifying:
            _before.reset();
            tell(Level::Warning, fmt::format("the modem refuses to tell its version: {}", why));
            return ask(Bytes(kBuildIdRequest.begin(), kBuildIdRequest.end()), State::Naming, kBuildIdPatience);
        case State::Naming: return ask(rangesRequest(), State::Ranging, kPatience);
        case State::Ranging: return fail(fmt::format("the modem refuses to tell which records it has: {}", why));
        case State::Emptying: return empty(_emptying + 1);
        case State::Running:
            tell(Level::Warning, fmt::format("the modem refuses a mask: {}", why));
            return applyMask(std::nullopt);
        default: return;
    }
}

void Session::gaveUp() {
    switch (_state) {
        case State::Identifying: return fail("not a diagnostic port, or in use");
        case State::Naming: return ask(rangesRequest(), State::Ranging, kPatience);
        case State::Ranging: return fail("the modem does not tell which records it has");
        case State::Emptying:
            if (_masks.ranges()[_emptying] == 0) return empty(_emptying + 1);
            [[fallthrough]];
        case State::Running: return fail("the modem does not answer any more");
        default: return;
    }
}

void Session::applyRanges(ByteView body) {
    const auto answer = parseConfigurationAnswer(body);
    const auto ranges = answer && answer->status == 0 ? parseRanges(answer->data) : std::nullopt;
    if (!ranges) return refused(fmt::format("status {}", answer ? answer->status : 0));
    _masks.begin(*ranges);
    empty(0);
}

// The modem has said what of the mask that was asked for is in force; none: it refuses it.
void Session::applyMask(const std::optional<LogMask>& inForce) {
    auto codes = _masks.takeRefused(inForce);
    std::erase_if(codes, [this](LogCode code) { return !_wanted.test(code); });
    if (!codes.empty()) tell(Level::Warning, "the modem refuses record " + listOf(codes));
    askNext();
}

// Whatever is due now.
void Session::proceed() {
    const nanoseconds now = _now();
    if (isSilencing(_state) && (now - _lastHeard >= kQuiet || now - _stateBegan >= kLongestSilencing)) {
        if (_state == State::Silencing) {
            identify();
        } else {
            return lose();
        }
    }
    if (_requester.givesUp()) gaveUp();
    if (_state == State::Running) settleTechnology();
    settleLoss();
}

void Session::settleTechnology() {
    const auto before = _camped.known();
    if (!_camped.settle(_masks.ranges(), _now())) return;
    tell(Level::Notice,
         fmt::format("the phone {} {}", before ? "has changed to" : "is camped on", namesOf(*_camped.known()).name));
}

void Session::settleLoss() {
    if (_before) return;
    if (const auto line = _loss.update(_counts, _now())) tell(Level::Warning, *line);
}

void Session::tell(Level level, const std::string& text) const { logLine(level, "%s: %s", _name, text); }

void Session::tellUnknownCodes() {
    auto codes = _masks.takeUnknown();
    std::erase_if(codes,
                  [this](LogCode code) { return !_wanted.test(code); });  // clients are not told of the service's own
    if (!codes.empty()) tell(Level::Warning, "this modem cannot send: " + listOf(codes));
}

}  // namespace kelvo::wire
