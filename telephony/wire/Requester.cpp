#include "telephony/wire/Requester.h"

#include <algorithm>

#include "telephony/wire/RecordConfiguration.h"

namespace kelvo::wire {

void Requester::ask(Bytes request, Patience patience) {
    _request = std::move(request);
    _patience = patience;
    _sent = 0;
    _late = _unanswered[key()];
    send();
}

void Requester::reset() {
    forget();
    _unanswered.clear();
}

Match Requester::hear(ByteView body) {
    if (!isWaiting()) return Match::No;
    const Match what = match(_request, body);
    if (what != Match::Answer && what != Match::Refusal) return what;
    int& unanswered = _unanswered[key()];
    unanswered = std::max(0, unanswered - 1);
    if (isLate(body)) return Match::No;
    forget();
    return what;
}

// After a repeat, answers come twice: one to the mask before is told by the mask that it says is in force.
bool Requester::isLate(ByteView body) {
    if (_late == 0) return false;
    const auto request = parseConfigurationRequest(_request);
    const auto answer = parseConfigurationAnswer(body);
    if (request && answer && parseMask(answer->data) == parseMask(request->data)) return false;
    --_late;
    return true;
}

bool Requester::givesUp() {
    if (!isWaiting() || _now() < *deadline()) return false;
    if (_sent < _patience.tries) {
        send();
        return false;
    }
    forget();
    return true;
}

std::optional<std::chrono::nanoseconds> Requester::deadline() const {
    return isWaiting() ? std::optional(_sentAt + _patience.limit) : std::nullopt;
}

void Requester::send() {
    ++_sent;
    ++_unanswered[key()];
    _sentAt = _now();
    _send(_request);
}

std::string Requester::key() const {
    constexpr std::size_t kUpToTheEquipment = 12;
    return std::string(textOf(_request).substr(0, kUpToTheEquipment));
}

}  // namespace kelvo::wire
