#include "tools/import/RecordSurvey.h"

#include <algorithm>

#include "LogGenerator/Framing.h"

namespace kelvo {

using adaptation::Adapted;

namespace {

constexpr std::size_t kMostKinds = 10'000;

}  // namespace

RecordSurvey::RecordSurvey() {
    for (const TechnologyNames& names : kTechnologies) {
        if (hasCodes(names.technology)) {
            _families[static_cast<std::size_t>(names.technology)] = FamilyCodes::of(names.technology);
        }
    }
}

void RecordSurvey::add(const RecordedMessage& message, bool isTree) {
    ++_records;
    if (message.time && (!_first || *message.time < *_first)) _first = message.time;
    if (message.subscription && !_subscription) _subscription = message.subscription;
    if (isTree) {
        ++_recordsOf[static_cast<std::size_t>(Technology::IFX)];
        return;
    }
    const Adapted adapted = _adapter.adapt(stripPrefix(message.message));
    _meter.count(adapted);
    _latest = rowOf(adapted);
    if (_latest == nullptr) {
        ++_ofFurtherKinds;
        if (adapted.outcome == Adapted::Outcome::Refused) return;
        noteShown(adapted.packet);
        const auto technology = technologyOf(adapted.packet);
        if (technology) ++_recordsOf[static_cast<std::size_t>(*technology)];
        return;
    }
    Row& row = _latest->second;
    ++row.records;
    if (message.time && (!row.first || *message.time < *row.first)) row.first = message.time;
    if (message.time && (!row.last || *message.time > *row.last)) row.last = message.time;
    if (row.technology) ++_recordsOf[static_cast<std::size_t>(*row.technology)];
}

/// The row of a record's kind; none when there are too many.
std::pair<const RecordSurvey::Key, RecordSurvey::Row>* RecordSurvey::rowOf(const Adapted& adapted) {
    const bool isRefused = adapted.outcome == Adapted::Outcome::Refused;
    const Key key{adapted.kind, adapted.outcome, isRefused ? adapted.refusal : adaptation::Refusal{}};
    if (_latest != nullptr && _latest->first == key) return _latest;
    if (const auto known = _rows.find(key); known != _rows.end()) return &*known;
    if (_rows.size() >= kMostKinds) return nullptr;
    const auto made =
        _rows.emplace(key, Row{.kind = adapted.kind, .outcome = adapted.outcome, .refusal = std::get<2>(key)});
    if (!isRefused) {
        made.first->second.technology = technologyOf(adapted.packet);
        noteShown(adapted.packet);
    }
    return &*made.first;
}

void RecordSurvey::noteShown(ByteView packet) {
    const LogCode code = logCode(packet.data());
    const auto place = std::ranges::lower_bound(_shown, code);
    if (place == _shown.end() || *place != code) _shown.insert(place, code);
}

std::optional<Technology> RecordSurvey::technologyOf(ByteView packet) const {
    std::optional<Technology> found;
    for (const TechnologyNames& names : kTechnologies) {
        const auto& codes = _families[static_cast<std::size_t>(names.technology)];
        if (!codes || !codes->include(packet)) continue;
        if (found) return std::nullopt;
        found = names.technology;
    }
    return found;
}

std::vector<RecordSurvey::Row> RecordSurvey::rows() const {
    std::vector<Row> rows;
    for (const auto& [key, row] : _rows) rows.push_back(row);
    return rows;
}

bool RecordSurvey::shows(LogCode code) const { return std::ranges::binary_search(_shown, code); }

std::optional<Technology> RecordSurvey::technology() const {
    const auto most = std::ranges::max_element(_recordsOf);
    if (*most == 0) return std::nullopt;
    return kTechnologies[static_cast<std::size_t>(most - _recordsOf.begin())].technology;
}

}  // namespace kelvo
