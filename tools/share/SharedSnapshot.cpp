#include "tools/share/SharedSnapshot.h"

#include <fmt/format.h>

#include <algorithm>
#include <array>

#include "LogGenerator/DLFVersionReport.h"
#include "LogGenerator/Factory.h"
#include "LogGenerator/SnapshotFormat.h"
#include "platform/encodings/PropertyList.h"
#include "platform/system/DateText.h"
#include "platform/telephony/TelephonyConstants.h"
#include "telephony/wire/LittleEndian.h"
#include "tools/RawRecords.h"
#include "tools/share/SharedDisplay.h"
#include "tools/share/SharedPayloads.h"

namespace kelvo {

namespace {

constexpr std::string_view kUnknown = "entry of a snapshot that Kelvo does not know";
// What generators count besides what they show.
constexpr std::array<std::string_view, 8> kCounters = {"FLDataSeqNum1", "FLDataSent1", "FLDataSeqNum2", "FLDataSent2",
                                                       "RLDataSeqNum1", "RLDataSent1", "RLDataSeqNum2", "RLDataSent2"};

class Sharing {
public:
    explicit Sharing(RecordSharer& sharer) : _sharer(sharer) {}

    SharedSnapshot all(const Dictionary& snapshot) {
        const DictionaryRef made = Dictionary::make();
        for (const auto& [key, value] : snapshot) {
            if (key == snapshot::kTimestamp) {
                set(*made, key, date(value));
            } else if (key == snapshot::kDescription) {
                if (value.string() == nullptr || !value.string()->empty()) {
                    _sharer.replacer().tally().removed("description in the user's words");
                }
                made->set(key, "");
            } else if (key == snapshot::kData && value.array()) {
                made->set(key, entries(*value.array()));
            } else {
                remove(kUnknown);
            }
        }
        _shared.content = made;
        return _shared;
    }

private:
    bool hidesZone() const { return _sharer.times().shifts() || _sharer.choices().hideCells; }

    void remove(std::string_view what, std::uint64_t count = 1) { _sharer.replacer().tally().removed(what, count); }

    void set(Dictionary& made, std::string_view key, Value value) {
        if (!value) return remove(kUnknown);
        made.set(key, std::move(value));
    }

    /// "2011-03-04 09:15:02 +0100"; in UTC unless places may be told, for a zone is one.
    Value date(const Value& value) {
        constexpr std::size_t kLength = 25;
        constexpr std::int64_t kLast = 0xFFFFFFFF;  // as captures have their seconds
        const std::string* text = value.string();
        const bool isDate = text != nullptr && text->size() == kLength &&
                            text->find_first_not_of("0123456789-: +") == std::string::npos;
        const auto time = isDate ? dateFromDescription(*text) : std::nullopt;
        if (!time || time->time_since_epoch().count() < 0 || time->time_since_epoch().count() > kLast) return {};
        if (!hidesZone()) return *text;
        return utcDateDescription(std::chrono::floor<std::chrono::seconds>(_sharer.times().host(*time)));
    }

    Value entries(const Array& history) {
        const ArrayRef made = Array::make();
        for (const Value& value : history) {
            if (!value.dictionary()) {
                remove(kUnknown);
                continue;
            }
            const Dictionary& entry = *value.dictionary();
            made->append(entry.find(snapshot::kDLF) != nullptr ? dlfEntry(entry) : historyEntry(entry));
        }
        return made;
    }

    Value historyEntry(const Dictionary& entry) {
        const DictionaryRef made = Dictionary::make();
        Value date;
        for (const auto& [key, value] : entry) {
            if (key == snapshot::kDisplayState) {
                set(*made, key, displayState(value));
            } else if (key == snapshot::kDisplay) {
                const Value& tree = entry[snapshot::kDisplayState];
                const bool isOfTree = tree && tree.data() == nullptr;
                set(*made, key,
                    isOfTree ? displayOf((*made)[snapshot::kDisplayState], tree)
                             : sharedDisplay(_sharer.replacer(), value));
            } else if (key == snapshot::kExtraInfo && value.dictionary()) {
                made->set(key, counters(*value.dictionary()));
            } else if (key == snapshot::kDate) {
                date = this->date(value);
                set(*made, key, date);
            } else if (key == snapshot::kDescription) {
                if (!date) date = this->date(entry[snapshot::kDate]);
                made->set(key, date ? fmt::format("Snapshot ({})", *date.string()) : std::string());
            } else {
                remove(kUnknown);
            }
        }
        return made;
    }

    Value displayState(const Value& state) {
        ++_shared.read;
        if (state.data() == nullptr) {
            Value tree = sharedTree(_sharer.replacer(), state);
            if (tree) ++_shared.records;
            return tree;
        }
        Bytes made;
        const RawRecords records = splitRawRecords(*state.data());
        _shared.read += records.messages.size() - 1;
        for (const ByteView message : records.messages) {
            const auto shared = _sharer.shareRecord(message);
            if (!shared) continue;
            made.insert(made.end(), shared->begin(), shared->end());
            ++_shared.records;
        }
        remove("byte behind raw records that forms none", records.leftOver);
        if (made.size() > 1) _log.insert(_log.end(), made.begin() + 1, made.end());  // as generators make theirs
        return made;
    }

    /// What a cell monitor's screens show is its tree and nothing else.
    Value displayOf(const Value& shared, const Value& tree) {
        const Value state = shared ? shared : sharedTree(_sharer.replacer(), tree);
        const Result<Bytes> message = state ? writeXmlPropertyList(state) : Result<Bytes>(Failure{"no tree"});
        if (!message) return {};
        Dictionary screens;
        generatorFromTechnology(kPLLogChannelTechnology_IFX)->updateState(screens, *message);
        return screens[snapshot::kDisplay];
    }

    Value counters(const Dictionary& info) {
        const DictionaryRef made = Dictionary::make();
        for (const auto& [key, value] : info) {
            const bool isCounter = std::ranges::find(kCounters, std::string_view(key)) != kCounters.end();
            set(*made, key, isCounter && value.number() != nullptr ? value : Value());
        }
        return made;
    }

    Value dlfEntry(const Dictionary& entry) {
        for (const auto& [key, value] : entry) {
            if (key != snapshot::kDLF && key != snapshot::kDescription) remove(kUnknown);
        }
        Bytes log = report(entry[snapshot::kDLF]);
        log.insert(log.end(), _log.begin(), _log.end());
        const std::string description = fmt::format("DLF binary ({} bytes)", log.size());
        return Dictionary::make({{snapshot::kDescription, description}, {snapshot::kDLF, std::move(log)}});
    }

    /// The record that heads a DLF file: of the original's its time is kept, and the zone where places may be told.
    Bytes report(const Value& dlf) {
        constexpr std::size_t kTimeAt = 81;
        constexpr std::size_t kZoneAt = 85;
        constexpr std::size_t kDaylightAt = 87;
        DLFTimeRecord time;
        const Bytes* bytes = dlf.data();
        if (bytes != nullptr && bytes->size() >= kDLFVersionReportSize) {
            using std::chrono::seconds;
            const SharedTimes::Time told{seconds(wire::u32At(*bytes, kTimeAt))};
            const auto shared = std::chrono::floor<seconds>(_sharer.times().host(told)).time_since_epoch().count();
            time.seconds = static_cast<std::uint32_t>(shared);
            if (!hidesZone()) {
                time.zoneMinutes = static_cast<std::int16_t>(wire::u16At(*bytes, kZoneAt));
                time.daylight = (*bytes)[kDaylightAt] != 0 ? 1 : 0;
            }
        }
        Bytes made(kDLFVersionReportSize);
        std::size_t written = 0;
        DLFAddVersionReport(made.data(), made.size(), written, 1, 1, "Kelvo", "EXECUTABLE_NAME", "Mar  7 2019 22:35:20",
                            time);
        return made;
    }

    RecordSharer& _sharer;
    SharedSnapshot _shared;
    Bytes _log;  // the shared records, as the DLF has them
};

}  // namespace

SharedSnapshot sharedSnapshot(RecordSharer& sharer, const Value& snapshot) {
    const DictionaryRef& content = snapshot.dictionary();
    if (!content || (!(*content)[snapshot::kTimestamp] && !(*content)[snapshot::kData])) return {};
    return Sharing(sharer).all(*content);
}

}  // namespace kelvo
