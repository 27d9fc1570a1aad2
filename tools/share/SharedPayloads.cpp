#include "tools/share/SharedPayloads.h"

#include <algorithm>
#include <array>

#include "LogGenerator/PhoneServices/PhoneCodes.h"
#include "LogGenerator/PhoneServices/SimFiles.h"
#include "platform/encodings/PropertyList.h"
#include "platform/telephony/TelephonyConstants.h"
#include "tools/share/SharedKeys.h"

namespace kelvo {

namespace {

struct CellKey {
    std::string_view key;
    std::string_view name;
    Identity identity;
};

// clang-format off
constexpr CellKey kCellKeys[] = {
    { kPLCellMonitorMCC,      "Mobile Country Code", Identity::Country        },
    { kPLCellMonitorMNC,      "Mobile Network Code", Identity::Network        },
    { kPLCellMonitorLAC,      "Location Area Code",  Identity::Area           },
    { kPLCellMonitorTAC,      "Tracking Area Code",  Identity::Area           },
    { kPLCellMonitorCellId,   "Cell ID",             Identity::Cell           },
    { kPLCellMonitorPID,      "Physical Cell ID",    Identity::PhysicalCell   },
    { kPLCellMonitorSCN,      "Scrambling Code",     Identity::ScramblingCode },
    { kPLCellMonitorARFCN,    "",                    Identity::None           },
    { kPLCellMonitorUARFCN,   "",                    Identity::None           },
    { kPLCellMonitorBandInfo, "",                    Identity::None           },
    { kPLCellMonitorRSSI,     "",                    Identity::None           },
    { kPLCellMonitorRSCP,     "",                    Identity::None           },
    { kPLCellMonitorECN0,     "",                    Identity::None           },
};
constexpr std::array kCellWords = {
    kPLCellMonitorRadioAccessTechnologyGSM,    kPLCellMonitorRadioAccessTechnologyUMTS,
    kPLCellMonitorRadioAccessTechnologyUTRAN2, kPLCellMonitorRadioAccessTechnologyLTE,
    kPLCellMonitorCellTypeServing,             kPLCellMonitorCellTypeNeighbor,
};
// clang-format on

constexpr std::string_view kUnknownKey = "entry of a phone's record under a name that Kelvo does not know";
constexpr std::string_view kUnknownForm = "value in a form that Kelvo does not know";

Value sharedFiles(Replacer& replacer, const Dictionary& files) {
    const DictionaryRef shared = Dictionary::make();
    for (const auto& [key, value] : files) {
        const auto file = std::ranges::find(kElementaryFiles, Key(key), &SimFile::key);
        if (file == std::end(kElementaryFiles)) {
            replacer.tally().removed(kUnknownKey);
            continue;
        }
        const auto identity = identityOf({}, file->label.text());
        if (Value other = sharedValue(replacer, identity.value_or(Identity::None), file->label.text(), value)) {
            shared->set(key, std::move(other));
        }
    }
    return shared;
}

/// Which parts a cell's number has, its technology says.
Identity identityOf(const CellKey& known, const Dictionary& cell) {
    if (known.identity != Identity::Cell) return known.identity;
    const Value* const technology = cell.find(kPLCellMonitorCellRadioAccessTechnology);
    const std::string* const word = technology != nullptr ? technology->string() : nullptr;
    if (word == nullptr || *word == kPLCellMonitorRadioAccessTechnologyGSM) return Identity::Cell;
    return *word == kPLCellMonitorRadioAccessTechnologyLTE ? Identity::EutranCell : Identity::UtranCell;
}

Value sharedCell(Replacer& replacer, const Value& cell) {
    if (!cell.dictionary()) return {};
    const DictionaryRef shared = Dictionary::make();
    for (const auto& [key, value] : *cell.dictionary()) {
        const bool isWord = key == kPLCellMonitorCellRadioAccessTechnology || key == kPLCellMonitorCellType;
        const auto known = std::ranges::find(kCellKeys, std::string_view(key), &CellKey::key);
        if (isWord) {
            const std::string* word = value.string();
            if (word == nullptr || std::ranges::find(kCellWords, *word) == kCellWords.end()) return {};
            shared->set(key, value);
        } else if (known == std::end(kCellKeys)) {
            replacer.tally().removed(kUnknownKey);
        } else if (const auto number = value.number() != nullptr ? value.number()->int32() : std::nullopt) {
            const auto bits = static_cast<std::uint32_t>(*number);
            const Identity identity = identityOf(*known, *cell.dictionary());
            const std::uint32_t other = replacer.number(identity, known->name, bits);
            shared->set(key, std::int64_t{static_cast<std::int32_t>(other)});
        } else {
            replacer.tally().removed(kUnknownForm);
        }
    }
    return shared;
}

template <class Share>
Value sharedList(Replacer& replacer, const Value& list, Share share) {
    const ArrayRef shared = Array::make();
    for (const Value& entry : *list.array()) {
        if (Value other = share(replacer, entry)) {
            shared->append(std::move(other));
        } else {
            replacer.tally().removed("entry of a phone's list that Kelvo does not know");
        }
    }
    return shared;
}

}  // namespace

bool isPlainText(std::string_view text) {
    constexpr std::size_t kLongest = 64;
    constexpr int kMostDigits = 8;  // shorter than any number of a person, a card or a phone
    if (text.size() > kLongest) return false;
    int digits = 0;
    for (const char c : text) {
        digits = c >= '0' && c <= '9' ? digits + 1 : 0;
        if (digits > kMostDigits) return false;
    }
    return true;
}

Value sharedValue(Replacer& replacer, Identity identity, std::string_view key, const Value& value) {
    Value shared;
    if (identity != Identity::None) {
        shared = replacer.value(identity, key, value);
    } else {
        const Bytes* data = value.data();
        const bool isPlain = (value.string() != nullptr && isPlainText(*value.string())) ||
                             value.boolean() != nullptr ||
                             (value.number() != nullptr && isPlainText(std::to_string(value.number()->integer()))) ||
                             (data != nullptr && data->size() <= 4);
        if (isPlain) shared = value;
    }
    if (!shared) replacer.tally().removed(kUnknownForm);
    return shared;
}

Value sharedContext(Replacer& replacer, const Value& context) {
    if (!context.dictionary()) return {};
    const DictionaryRef shared = Dictionary::make();
    for (const auto& [key, value] : *context.dictionary()) {
        const auto identity = identityOf("PDP Context Info", key);
        if (!identity) {
            replacer.tally().removed(kUnknownKey);
        } else if (Value other = sharedValue(replacer, *identity, key, value)) {
            shared->set(key, std::move(other));
        }
    }
    return shared;
}

std::optional<Bytes> sharedPayload(Replacer& replacer, LogCode code, ByteView payload) {
    const Result<Value> tree = readPropertyList(payload);
    if (!tree) return std::nullopt;
    Value shared;
    if (code == code::kSimFiles && tree->dictionary()) shared = sharedFiles(replacer, *tree->dictionary());
    if (code == code::kCellArray && tree->array()) shared = sharedList(replacer, *tree, sharedCell);
    if (code == code::kPDPContexts && tree->array()) shared = sharedList(replacer, *tree, sharedContext);
    if (!shared) return std::nullopt;
    Result<Bytes> bytes = writeXmlPropertyList(shared);
    return bytes ? std::optional(*std::move(bytes)) : std::nullopt;
}

}  // namespace kelvo
