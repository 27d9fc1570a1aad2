#include "model/CellIdentity.h"

#include <algorithm>
#include <array>
#include <unordered_map>

#include "model/DisplayPath.h"

namespace kelvo {

namespace {

using Names = std::unordered_map<std::string_view, std::string>;

// clang-format off
const Names& shortNames() {
    static const Names kNames = {
        {"Physical Cell ID",         "PCI"},      {"Serving Physical Cell ID", "PCI"},
        {"Scrambling Code",          "PSC"},      {"Cell Scrambling Code",     "PSC"},
        {"PSC",                      "PSC"},      {"SCN",                      "PSC"},
        {"Serving PN Offset",        "PN"},       {"Pilot",                    "PN"},
        {"Cell ID",                  "cell"},     {"Cell Identity",            "cell"},
        {"CellId",                   "cell"},     {"Serving Cell ID",          "cell"},
        {"Base Station ID",          "station"},
        {"E-ARFCN",                  "EARFCN"},   {"E ARFCN",                  "EARFCN"},
        {"Serving EARFCN",           "EARFCN"},   {"EARFCN",                   "EARFCN"},
        {"UARFCN",                   "UARFCN"},   {"U ARFCN",                  "UARFCN"},
        {"Downlink Frequency",       "UARFCN"},
        {"ARFCN",                    "ARFCN"},    {"BSIC",                     "BSIC"},
        {"BSIC ID",                  "BSIC"},     {"Band",                     "band"},
        {"Channel",                  "channel"},  {"Candidate RAT Type",       ""},
        {"Transport Channel ID",     "channel"},  {"Process ID",               "process"},
        {"TRCH ID",                  "channel"},  {"CCTRCH ID",                "channel"},
        {"TSNUM",                    "timeslot"}, {"Context ID",               "context"},
    };
    return kNames;
}

/// Lists whose rows do not tell their channel, and where it is told.
struct ListChannel {
    std::string_view list;
    std::string_view channel;
};
constexpr std::array<ListChannel, 3> kListChannels = {{
    {"/Measured Neighbor Cells", "/Connected mode LTE Intra-frequency Measurement/E-ARFCN"},
    {"/Detected Cells",          "/Connected mode LTE Intra-frequency Measurement/E-ARFCN"},
    {"/Neighbor Cells List",     "/Neighbor Measurements/E-ARFCN"},
}};
// clang-format on

void append(std::string& identity, const std::string& shortName, const std::string& text) {
    if (!identity.empty()) identity += ", ";
    identity += shortName;
    if (!shortName.empty()) identity += ' ';
    identity += text;
}

}  // namespace

const std::string* shortNameOf(std::string_view key) {
    const auto at = shortNames().find(key);
    return at != shortNames().end() ? &at->second : nullptr;
}

bool namesAnArea(std::string_view key) {
    constexpr std::array<std::string_view, 4> kKeys = {"MCC", "MNC", "LAC", "RAC"};
    return std::ranges::find(kKeys, key) != kKeys.end();
}

int rankAsServingCell(std::string_view key) {
    constexpr std::array<std::string_view, 9> kKeys = {"Physical Cell ID",  "Serving Physical Cell ID",
                                                       "Scrambling Code",   "Cell Scrambling Code",
                                                       "Serving PN Offset", "Cell ID",
                                                       "Cell Identity",     "CellId",
                                                       "Base Station ID"};
    constexpr std::size_t kCodes = 5;  // the first of them are what the air itself tells
    for (std::size_t i = 0; i < kKeys.size(); ++i) {
        if (kKeys[i] == key) return i < kCodes ? 1 : 2;
    }
    return 0;
}

std::string identityOf(const Dictionary& row) {
    std::string identity;
    for (const auto& [key, value] : row) {
        const std::string* shortName = shortNameOf(nameOfSortedKey(key));
        const std::string* text = shortName != nullptr ? value.string() : nullptr;
        if (text != nullptr) append(identity, *shortName, *text);
    }
    return identity;
}

std::string channelOfList(const Value& display, std::string_view path) {
    for (const auto& [list, channel] : kListChannels) {
        if (list != path || !display.dictionary()) continue;
        const std::size_t slash = channel.find('/', 1);
        const DictionaryRef& section = (*display.dictionary())[channel.substr(1, slash - 1)].dictionary();
        const std::string_view key = channel.substr(slash + 1);
        const std::string* text = section ? (*section)[key].string() : nullptr;
        std::string identity;
        if (text != nullptr) append(identity, *shortNameOf(key), *text);
        return identity;
    }
    return {};
}

}  // namespace kelvo
