#include "telephony/adaptation/AdaptationMeter.h"

#include <fmt/format.h>

namespace kelvo::adaptation {

namespace {

/// A stream of noise has no end of kinds: beyond these they are counted, not named.
constexpr std::size_t kMostKinds = 1000;

std::string described(const RecordKind& kind, Refusal refusal) { return describe(kind) + ": " + reasonOf(refusal); }

}  // namespace

std::optional<std::string> AdaptationMeter::count(const Adapted& adapted) {
    if (adapted.outcome == Adapted::Outcome::Refused) {
        ++_refused;
        const std::pair kind(adapted.kind, adapted.refusal);
        const auto known = _refusals.find(kind);
        if (known != _refusals.end()) {
            ++known->second;
            return std::nullopt;
        }
        if (_refusals.size() >= kMostKinds) return std::nullopt;
        _refusals.emplace(kind, 1);
        return described(adapted.kind, adapted.refusal);
    }
    ++(adapted.outcome == Adapted::Outcome::Passed ? _passed : _turned);
    if (adapted.derivation == Adapted::Derivation::Completed) ++_completed;
    if (adapted.derivation == Adapted::Derivation::Neutral) ++_neutral;
    if (adapted.channel) {
        ++_extendedChannels;
        _lastExtendedChannel = adapted.channel;
    }
    _leftOut += static_cast<std::uint64_t>(adapted.leftOut);
    return std::nullopt;
}

std::vector<AdaptationMeter::Refused> AdaptationMeter::refusals() const {
    std::vector<Refused> refusals;
    for (const auto& [kind, records] : _refusals) {
        refusals.push_back({described(kind.first, kind.second), kind.first.code, records});
    }
    return refusals;
}

std::vector<std::string> AdaptationMeter::lines() const {
    std::vector<std::string> lines;
    if (_passed != 0 && _turned + _refused != 0) lines.push_back(fmt::format("{} passed as they are", _passed));
    if (_turned != 0) lines.push_back(fmt::format("{} turned from newer layouts", _turned));
    if (derived() != 0) lines.push_back(fmt::format("{} of them 0xB17F derived from 0xB193", derived()));
    if (_neutral != 0) {
        lines.push_back(fmt::format(
            "{} of those without a 0xB17F of their cell: no priority, limits, search thresholds and rules", _neutral));
    }
    if (_extendedChannels != 0) {
        lines.push_back(fmt::format("{} with an extended channel, shown as 65535; the last is {}", _extendedChannels,
                                    *_lastExtendedChannel));
    }
    if (_leftOut != 0) lines.push_back(fmt::format("{} list entries left out", _leftOut));
    for (const Refused& refused : refusals())
        lines.push_back(fmt::format("{} refused: {}", refused.records, refused.what));
    return lines;
}

}  // namespace kelvo::adaptation
