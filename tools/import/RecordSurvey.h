#pragma once

#include <array>
#include <cstdint>
#include <map>
#include <optional>
#include <vector>

#include "platform/telephony/Technology.h"
#include "telephony/adaptation/AdaptationMeter.h"
#include "telephony/recordings/RecordingReader.h"
#include "tools/FamilyCodes.h"

namespace kelvo {

/// What stands in recordings: every code, version and length, and what would become of it.
class RecordSurvey {
public:
    struct Row {
        adaptation::RecordKind kind;
        adaptation::Adapted::Outcome outcome{};
        adaptation::Refusal refusal{};           ///< of refused ones
        std::optional<Technology> technology{};  ///< whose screens show it; none when several do, or none
        std::uint64_t records = 0;
        std::optional<wire::SystemTime> first{};
        std::optional<wire::SystemTime> last{};
    };

    RecordSurvey();

    /// Looks at one message, by itself or as a cell monitor's tree.
    void add(const RecordedMessage& message, bool isTree);

    /// By code, version and length, of the first 10,000 kinds: a file may be made of nothing but kinds.
    std::vector<Row> rows() const;
    /// Records of kinds beyond these.
    std::uint64_t ofFurtherKinds() const { return _ofFurtherKinds; }
    std::uint64_t records() const { return _records; }
    const adaptation::AdaptationMeter& meter() const { return _meter; }
    /// The earliest time of a record; none when no clock was set.
    std::optional<wire::SystemTime> first() const { return _first; }
    /// Whether a record of this code can be shown, as itself or in its place.
    bool shows(LogCode code) const;
    /// The family with most records that can be shown; none when there is no such record.
    std::optional<Technology> technology() const;
    /// The subscription of the first record that has one.
    std::optional<std::int32_t> subscription() const { return _subscription; }
    /// The only family that has this packet's code; none when several have it, or none.
    std::optional<Technology> technologyOf(ByteView packet) const;

private:
    using Key = std::tuple<adaptation::RecordKind, adaptation::Adapted::Outcome, adaptation::Refusal>;

    std::pair<const Key, Row>* rowOf(const adaptation::Adapted& adapted);
    void noteShown(ByteView packet);

    std::array<std::optional<FamilyCodes>, kTechnologies.size()> _families;  // none for the one without codes
    adaptation::RecordAdapter _adapter;
    adaptation::AdaptationMeter _meter;
    std::map<Key, Row> _rows;
    std::pair<const Key, Row>* _latest = nullptr;  // the row counted last: records come in runs
    std::vector<LogCode> _shown;                   // sorted: the codes that come out
    std::array<std::uint64_t, kTechnologies.size()> _recordsOf{};
    std::uint64_t _records = 0;
    std::uint64_t _ofFurtherKinds = 0;
    std::optional<wire::SystemTime> _first;
    std::optional<std::int32_t> _subscription;
};

}  // namespace kelvo
