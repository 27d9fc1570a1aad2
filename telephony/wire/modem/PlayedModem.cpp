#include "telephony/wire/modem/PlayedModem.h"

#include <algorithm>
#include <utility>

#include "telephony/wire/FrameWriter.h"
#include "telephony/wire/LittleEndian.h"
#include "telephony/wire/Protocol.h"
#include "telephony/wire/RecordFrame.h"

namespace kelvo::modem {
namespace {

using namespace std::chrono_literals;
using Time = PlayedModem::Time;
using wire::Command;

constexpr Time kSettling = 250ms;  // from the last of the first masks to the first record
constexpr Time kQuiet = 500ms;     // before it hangs up, so that the reader has all that was sent
constexpr Time kChatEvery = 50ms;
constexpr Time kSlowRanges = 5200ms;  // a reader asks again after five seconds
constexpr std::size_t kMostWaiting = 4096;
constexpr std::size_t kFloodWaiting = 300;  // more than the gauge can tell
constexpr std::size_t kRecordsPerTurn = 4096;
constexpr std::size_t kFloodUnwanted = 64;  // a turn: each takes time to simulate, and the reader is to be heard
constexpr std::size_t kRequestKey = 12;     // command, operation, equipment
constexpr std::size_t kTimestampAt = 4;

std::uint16_t codeOf(ByteView record) { return wire::u16At(record, 2); }

Time milliseconds(int count) { return std::chrono::milliseconds(count); }

// The time of a modem that has never heard a network: since it was switched on.
void countFrom1980(Bytes& record, Time at) {
    const auto ticks = static_cast<std::uint64_t>(at / 1250us);
    for (std::size_t i = 0; i < 8; ++i)
        record[kTimestampAt + i] = i < 2 ? 0 : static_cast<std::uint8_t>(ticks >> (8 * (i - 2)));
}

}  // namespace

PlayedModem::PlayedModem(std::unique_ptr<ModemRecords> first, std::unique_ptr<ModemRecords> second, Faults faults,
                         std::uint64_t seed)
    : _faults(faults), _random(seed), _line(faults, seed + 1, _tally), _chatter(seed + 2, _tally), _answers(faults) {
    for (auto* records : {&first, &second}) {
        if (!*records) continue;
        _sims.push_back({std::move(*records), {}});
        _sims.back().next = _sims.back().records->next();
    }
}

void PlayedModem::unplug() {
    _pluggedIn = false;
    _returns.reset();
}

void PlayedModem::plugIn(Time now) {
    _pluggedIn = true;
    _answers.restart();
    _reader = {};
    _waiting.clear();
    _replies.clear();
    _asked.clear();
    _output.clear();
    _sent = 0;
    _leaving = false;
    _leaves.reset();
    _returns.reset();
    _untilHangUp = _random.between(50, 200);
    _nextChat = _faults.has(Fault::EarlierSession) ? std::optional(now) : std::nullopt;
    if (_answers.masks().wantAny() && !_began) _began = now;
}

// One step a call, so that whoever looks late sees it gone all the same.
bool PlayedModem::isPluggedIn(Time now) {
    if (_returns && now >= *_returns) {
        plugIn(now);
    } else if (_leaving && !_leaves && _sent == _output.size()) {
        _leaves = now + kQuiet;
    } else if (_pluggedIn && _leaves && now >= *_leaves) {
        unplug();
        _returns = now + milliseconds(_random.between(300, 1500));
    }
    return _pluggedIn;
}

void PlayedModem::receive(ByteView bytes, Time now) {
    if (!_pluggedIn || _faults.has(Fault::Silent)) return;
    if (_faults.has(Fault::AtPort)) {
        const ByteView error = bytesOf("\r\nERROR\r\n");
        _output.insert(_output.end(), bytes.begin(), bytes.end());
        _output.insert(_output.end(), error.begin(), error.end());
        return;
    }
    Bytes copy(bytes.begin(), bytes.end());
    wire::MutableBytes input(copy);
    while (const auto body = _reader.next(input)) handle(*body, now);
}

void PlayedModem::handle(ByteView request, Time now) {
    const Bytes answer = _answers.answer(request);
    const auto command = static_cast<Command>(request[0]);
    if (command == Command::RecordConfiguration && _answers.masks().wantAny()) begin(now);
    if (_faults.has(Fault::MissingAnswers)) {
        const auto key = request.first(std::min(request.size(), kRequestKey));
        if (_asked.emplace(textOf(key)).second) return;
    }
    Bytes frames;
    if (_faults.has(Fault::Asynchronous)) {
        for (const Bytes& body : _chatter.before(request)) wire::appendFrame(frames, body);
    }
    _line.carry(answer, frames);
    const Time due = now + delayOf(request);
    _replies.push_back({_replies.empty() ? due : std::max(due, _replies.back().due), std::move(frames)});
}

Time PlayedModem::delayOf(ByteView request) {
    if (!_faults.has(Fault::SlowAnswers)) return 0ns;
    const auto configuration = wire::parseConfigurationRequest(request);
    if (configuration && configuration->operation == wire::Operation::Ranges) return kSlowRanges;
    return milliseconds(_random.between(200, 1500));
}

// Masks come one by one: the first record waits for the last of them.
void PlayedModem::begin(Time now) {
    if (!_began || now < *_began) _began = now + kSettling;
}

// The one whose next record comes first.
std::optional<std::size_t> PlayedModem::nextSim() const {
    std::optional<std::size_t> next;
    for (std::size_t i = 0; i < _sims.size(); ++i) {
        if (_sims[i].next && (!next || _sims[i].next->at < _sims[*next].next->at)) next = i;
    }
    return next;
}

// What is due by now, or, of a flood, what there is room for.
void PlayedModem::gather(Time now) {
    if (!_began) return;
    const bool floods = _faults.has(Fault::Flood) && _answers.masks().wantAny() && now >= *_began;
    std::size_t unwanted = 0;
    for (std::size_t i = 0; i < kRecordsPerTurn && (!floods || unwanted < kFloodUnwanted); ++i) {
        const auto sim = nextSim();
        if (!sim) return;
        if (floods ? _waiting.size() >= kFloodWaiting : *_began + _sims[*sim].next->at > now) return;
        const std::size_t waiting = _waiting.size();
        take(*sim);
        if (_waiting.size() == waiting) ++unwanted;
    }
}

void PlayedModem::take(std::size_t sim) {
    const ModemRecord& record = *_sims[sim].next;
    if (_pluggedIn && _answers.masks().wants(codeOf(record.bytes))) {
        if (_waiting.size() < kMostWaiting) {
            Bytes bytes(record.bytes.begin(), record.bytes.end());
            if (_faults.has(Fault::Clock1980)) countFrom1980(bytes, record.at);
            _waiting.push_back({sim, std::move(bytes)});
        } else {
            ++_tally.notSent;
        }
    }
    _sims[sim].next = _sims[sim].records->next();
}

void PlayedModem::chat(Time now) {
    for (; _nextChat && now >= *_nextChat && hasRoom(); *_nextChat += kChatEvery) {
        if (!_answers.sendsEvents() && !_answers.sendsTexts()) return _nextChat.reset();
        if (_answers.sendsEvents()) _line.carry(_chatter.event(), _output);
        if (_answers.sendsTexts()) _line.carry(_chatter.text(), _output);
    }
}

ByteView PlayedModem::output(Time now) {
    gather(now);
    if (!_pluggedIn) return {};
    if (_sent == _output.size()) {
        _output.clear();
        _sent = 0;
    }
    for (; !_replies.empty() && _replies.front().due <= now && hasRoom(); _replies.pop_front())
        _output.insert(_output.end(), _replies.front().frames.begin(), _replies.front().frames.end());
    chat(now);
    while (!_waiting.empty() && hasRoom()) sendRecord();
    return ByteView(_output).subspan(_sent);
}

void PlayedModem::sendRecord() {
    const Waiting waiting = std::move(_waiting.front());
    _waiting.pop_front();
    const auto behind = static_cast<std::uint8_t>(std::min<std::size_t>(_waiting.size(), 255));
    const Bytes body = wire::recordBody(behind, waiting.record);
    if (_faults.has(Fault::HangUp) && --_untilHangUp == 0) {
        const Bytes frame = wire::frameOf(body);
        _output.insert(_output.end(), frame.begin(), frame.begin() + static_cast<std::ptrdiff_t>(frame.size() / 2));
        ++_tally.cutOff;
        _tally.notSent += _waiting.size();
        _waiting.clear();
        _leaving = true;
    } else {
        _line.carryRecord(body, waiting.sim, _output);
    }
}

std::optional<Time> PlayedModem::nextDue() const {
    if (!_pluggedIn) return _returns;
    if (_leaving) return _leaves.value_or(Time::min());
    if (!_waiting.empty()) return Time::min();
    std::optional<Time> due;
    const auto consider = [&due](Time time) { due = std::min(due.value_or(time), time); };
    if (!_replies.empty()) consider(_replies.front().due);
    if (_nextChat) consider(*_nextChat);
    const auto sim = nextSim();
    if (_began && sim) {
        const bool floods = _faults.has(Fault::Flood) && _answers.masks().wantAny();
        consider(floods ? *_began : *_began + _sims[*sim].next->at);
    }
    return due;
}

}  // namespace kelvo::modem
