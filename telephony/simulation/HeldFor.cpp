#include "telephony/simulation/HeldFor.h"

#include <utility>

namespace kelvo::simulation {

bool HeldFor::operator()(bool condition, std::size_t subject, Time now) {
    if (!condition) {
        _running = false;
        return false;
    }
    if (!_running || subject != _subject) {
        _running = true;
        _subject = subject;
        _since = now;
    }
    return now - _since >= _hold;
}

std::optional<std::size_t> EachHeldFor::operator()(const std::vector<std::size_t>& subjects, Time now) {
    std::map<std::size_t, Time> since;
    std::optional<std::size_t> first;
    for (const std::size_t subject : subjects) {
        const auto before = _since.find(subject);
        since[subject] = before != _since.end() ? before->second : now;
        if (!first && now - since[subject] >= _hold) first = subject;
    }
    _since = std::move(since);
    return first;
}

}  // namespace kelvo::simulation
