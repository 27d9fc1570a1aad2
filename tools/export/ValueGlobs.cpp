#include "tools/export/ValueGlobs.h"

#include <fnmatch.h>

#include <algorithm>
#include <span>

namespace kelvo {

namespace {

// clang-format off
constexpr std::string_view kSignal[] = {
    "/Serving Cell Measurements/*RSR[PQ]", "/Serving Cell Measurements/*RSSI", "/Serving Cell Measurements/Srxlev",
    "/Connected mode LTE Intra-frequency Measurement/*RSR[PQ]",
    "/UMTS Cells/Active Set/*/RSCP", "/UMTS Cells/Active Set/*/Energy Per Chip", "/UMTS Radio/UMTS RR Info/Transmit Power",
    "/GSM Cell and Neighbours/GSM Serving Cell/RSSI", "/GSM Cell and Neighbours/GSM Serving Cell/C[12] Value",
    "/GSM Cell and Neighbours/GSM RR Info/Serving Rx Level", "/GSM Cell and Neighbours/GSM RR Info/Rx Quality*",
    "/1x/Active Set*", "/1x/*AGC", "/EV-DO/Active Set*", "/EV-DO/*AGC",
    "/CCTRCH SIR/*/SIR/*",
    "/Serving/RSCP", "/Serving/ECN0", "/Serving/RSSI", "/Serving/C1", "/Connection/TxPower",
};
constexpr std::string_view kCell[] = {
    "/Serving Cell Info/*", "/Serving Cell Measurements/E-ARFCN", "/Serving Cell Measurements/Physical Cell ID",
    "/Connected mode LTE Intra-frequency Measurement/E-ARFCN",
    "/Connected mode LTE Intra-frequency Measurement/Serving Physical Cell ID",
    "/Reselection Candidates/Serving*",
    "/UMTS Radio/UMTS RR Info/Cell ID", "/UMTS Radio/UMTS RR Info/URA ID", "/UMTS Radio/UMTS RR Info/Scrambling Code",
    "/UMTS Radio/UMTS RR Info/*link Frequency",
    "/GSM Cell and Neighbours/GSM Serving Cell/Cell ID", "/GSM Cell and Neighbours/GSM Serving Cell/*ARFCN",
    "/GSM Cell and Neighbours/GSM Serving Cell/BSIC",
    "/System/*ID", "/1x/*Channel", "/1x/*Band Class", "/EV-DO/Serving PN Offset", "/EV-DO/Channel", "/EV-DO/Band Class",
    "/Serving/Technology", "/Serving/M[CN]C", "/Serving/LAC", "/Serving/CellId", "/Serving/BandInfo", "/Serving/*ARFCN",
    "/Serving/SCN", "/Serving/BSIC",
};
constexpr std::string_view kNeighbors[] = {
    "/Measured Neighbor Cells/*", "/Detected Cells/*", "/Neighbor Measurements/*", "/Neighbor Cells List/*",
    "/Reselection Candidates List/*",
    "/UMTS Cells/Monitored Set/*", "/UMTS Cells/Detected Set/*", "/UMTS Cells/*UMTS Set/*",
    "/GSM Cell and Neighbours/Neighboring Cells/*", "/GSM Cell and Neighbours/*GSM Set/*",
    "/Neighbor Cell List/*", "/GSM Neighbor Cell List/*",
    "/Neighbours/*",
};
constexpr std::string_view kRegistration[] = {
    "/Serving Cell Info/Tracking Area Code", "/Serving Cell Info/Local Area Code",
    "/Registration and Network/*", "/UMTS Radio/UMTS RR Info/RRC State", "/GSM Cell and Neighbours/GSM RR Info/RR*",
    "/1x/State", "/EV-DO/*State", "/System/Roaming Indicator",
    "/RRC Info/State", "/Serving Cell Info/*Access*",
    "/Registration", "/Registration/*", "/Connection", "/Connection/State", "/Connection/Channel",
};
constexpr std::string_view kThroughput[] = {
    "/Rates and Errors/*", "/1x/Traffic FER",
    "/UMTS Radio/HSDPA Info/*", "/Counters/BLER/*",
    "/TRCH BLER/*",
    "/Connection/Throughput", "/Connection/Errors",
};
struct ShortName {
    std::string_view name;
    std::span<const std::string_view> globs;
};
constexpr ShortName kShortNames[] = {
    { "signal",       kSignal       },
    { "cell",         kCell         },
    { "neighbours",   kNeighbors    },
    { "neighbors",    kNeighbors    },
    { "registration", kRegistration },
    { "throughput",   kThroughput   },
};
// clang-format on

constexpr std::string_view kPattern = "*?[";

bool isPattern(std::string_view text) { return text.find_first_of(kPattern) != text.npos; }

}  // namespace

Result<ValueGlobs> ValueGlobs::of(const std::vector<std::string>& words) {
    ValueGlobs globs;
    for (const std::string& word : words) {
        const auto* known = std::ranges::find(kShortNames, word, &ShortName::name);
        if (known != std::end(kShortNames)) {
            globs._words.push_back({word, {known->globs.begin(), known->globs.end()}});
        } else if (word.starts_with('/') || isPattern(word)) {
            globs._words.push_back({word, {word}});
        } else {
            return Failure{"--values takes signal, cell, neighbours, registration, throughput, or paths such as " +
                           std::string("'*RSRP*', not ") + word};
        }
    }
    return globs;
}

bool ValueGlobs::want(const std::string& path) {
    if (_words.empty()) return true;
    bool wanted = false;
    for (Word& word : _words) {
        const bool matches = std::ranges::any_of(word.globs, [&path](const std::string& glob) {
            return ::fnmatch(glob.c_str(), path.c_str(), FNM_CASEFOLD | FNM_NOESCAPE) == 0;
        });
        word.hasMatched |= matches;
        wanted |= matches;
    }
    return wanted;
}

std::vector<std::string> ValueGlobs::unmatched() const {
    std::vector<std::string> words;
    for (const Word& word : _words) {
        if (!word.hasMatched) words.push_back(word.text);
    }
    return words;
}

std::vector<std::string> ValueGlobs::wholePaths() const {
    std::vector<std::string> paths;
    for (const Word& word : _words) {
        if (word.globs.size() != 1 || isPattern(word.text)) return {};
        paths.push_back(word.text);
    }
    return paths;
}

}  // namespace kelvo
