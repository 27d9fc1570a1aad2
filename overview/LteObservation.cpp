#include <algorithm>
#include <array>

#include "overview/Families.h"

/// LTE: idle and connected measurements stand on two screens, the cell's own broadcast on a third. The phone is in the
/// state whose record came last. A connected phone measures each of its carriers in turn, and each measurement calls
/// its carrier's cell the serving one: which it is the broadcast says, where there is one.
namespace kelvo::overview {
namespace {

/// Where the serving cell is told.
struct Source {
    const char* screen;
    const char* channel;
    const char* cell;
    const char* level;  // none: this screen has no levels
    const char* quality;
    const char* state;
};
constexpr std::array<Source, 3> kSources = {{
    {"Serving Cell Measurements", "E-ARFCN", "Physical Cell ID", "Measured RSRP", "Measured RSRQ", "idle"},
    {"Connected mode LTE Intra-frequency Measurement", "E-ARFCN", "Serving Physical Cell ID", "Serving Filtered RSRP",
     "Serving Filtered RSRQ", "connected"},
    {"Serving Cell Info", "Download Frequency", "Physical Cell ID", nullptr, nullptr, nullptr},
}};

std::string in(const Source& source, const char* key) { return std::string(source.screen) + "/" + key; }

constexpr const Source& kConnected = kSources[1];
constexpr const Source& kBroadcast = kSources[2];

std::string cellOf(const Source& source, const Screens& screens) {
    return identity(named("EARFCN", screens.text(in(source, source.channel))),
                    named("PCI", screens.text(in(source, source.cell))));
}

/// The EARFCN of the serving cell.
std::optional<std::int64_t> observeServing(Observation& seen, const Screens& screens) {
    const bool isBroadcast = screens.record(in(kBroadcast, kBroadcast.channel)) != 0;
    std::optional<std::int64_t> earfcn;
    const Source* newestLevel = nullptr;
    std::uint64_t levelRecord = 0;
    for (const Source& source : kSources) {
        const std::uint64_t record = screens.record(in(source, source.channel));
        if (source.level != nullptr && record > levelRecord) {
            levelRecord = record;
            newestLevel = &source;
        }
        if (record <= seen.cellRecord || (isBroadcast && &source == &kConnected)) continue;
        seen.cellRecord = record;
        earfcn = screens.whole(in(source, source.channel));
        seen.channel = named("EARFCN", screens.text(in(source, source.channel)));
        seen.cell = cellOf(source, screens);
        seen.cellIsOneOfSeveral = &source == &kConnected;
    }
    if (newestLevel == nullptr) return earfcn;
    seen.state = newestLevel->state;
    seen.isDedicated = seen.state == "connected";
    HeardCell heard;
    heard.identity = cellOf(*newestLevel, screens);
    heard.mark = "active";
    heard.level = measure("RSRP", screens.figure(in(*newestLevel, newestLevel->level)), Graded::Rsrp);
    heard.quality = measure("RSRQ", screens.figure(in(*newestLevel, newestLevel->quality)), Graded::Rsrq);
    heard.record = levelRecord;
    if (heard.identity == seen.cell) {
        seen.level = std::move(heard.level);
        seen.quality = std::move(heard.quality);
    } else if (seen.isDedicated && !heard.identity.empty()) {
        seen.cells.push_back(std::move(heard));
    }
    return earfcn;
}

void observeBroadcast(Observation& seen, const Screens& screens, std::optional<std::int64_t> earfcn) {
    const Screens info(screens.at("Serving Cell Info"));
    seen.area = named("TAC", info.text("Tracking Area Code"));
    if (const auto cell = info.whole("Cell Identity")) {
        add(seen.serving, "Cell identity", fmt::format("{} (eNB {}, sector {})", *cell, *cell >> 8, *cell & 0xFF));
    }
    auto bands = earfcn ? lteBands(*earfcn) : std::vector<BandChannel>();
    const auto up = info.whole("Upload Frequency");
    if (bands.size() == 1 && up && info.whole("Download Frequency") == earfcn) bands.front().upMHz = lteUplinkMHz(*up);
    addBand(seen, bands);
    const std::string down = info.text("Download Bandwidth");
    const std::string uplink = info.text("Upload Bandwidth");
    add(seen.serving, "Bandwidth", down == uplink ? down : fmt::format("{} down, {} up", down, uplink));
    add(seen.serving, "Antennas", info.text("Num Tx Antennas"));
}

void observeList(Observation& seen, const Value& list, const std::string& channel, const char* level,
                 const char* quality, std::string_view mark) {
    for (const Value& row : rowsOf(list)) {
        const Screens cell(row);
        HeardCell heard;
        heard.identity = identity(channel, named("PCI", cell.text("Physical Cell ID")));
        heard.mark = mark;
        heard.level = measure("RSRP", cell.figure(level), Graded::Rsrp);
        heard.quality = measure("RSRQ", cell.figure(quality), Graded::Rsrq);
        heard.record = cell.record("Physical Cell ID");
        if (!heard.identity.empty()) seen.cells.push_back(std::move(heard));
    }
}

/// A candidate is marked where it stands among the neighbors already; those of other radios are cells of their own.
void observeCandidates(Observation& seen, const Screens& screens) {
    for (const Value& row : rowsOf(screens.at("Reselection Candidates List"))) {
        const Screens cell(row);
        HeardCell heard;
        heard.mark = "candidate";
        heard.record = cell.record("Candidate RAT Type");
        const std::string kind = cell.text("Candidate RAT Type");
        if (kind == "LTE")
            heard.identity = identity(named("EARFCN", cell.text("E ARFCN")), named("PCI", cell.text("Cell ID")));
        if (kind == "UTRAN")
            heard.identity = identity(named("UARFCN", cell.text("U ARFCN")), named("PSC", cell.text("PSC")));
        if (kind == "GERAN")
            heard.identity = identity(named("ARFCN", cell.text("ARFCN")), named("BSIC", cell.text("BSIC ID")));
        if (kind.starts_with("CDMA"))
            heard.identity = identity(named("channel", cell.text("Channel")), named("PN", cell.text("Pilot")));
        if (heard.identity.empty()) continue;
        const auto known = std::ranges::find(seen.cells, heard.identity, &HeardCell::identity);
        if (known == seen.cells.end()) {
            seen.cells.push_back(std::move(heard));
        } else {
            known->mark = heard.mark;
        }
    }
}

}  // namespace

Observation observeLte(const Value& display) {
    const Screens screens(display);
    Observation seen;
    seen.access = "LTE";
    observeBroadcast(seen, screens, observeServing(seen, screens));
    observeList(seen, screens.at("Measured Neighbor Cells"),
                named("EARFCN", screens.text("Connected mode LTE Intra-frequency Measurement/E-ARFCN")),
                "Filtered RSRP", "Filtered RSRQ", "");
    observeList(seen, screens.at("Detected Cells"),
                named("EARFCN", screens.text("Connected mode LTE Intra-frequency Measurement/E-ARFCN")), "", "",
                "detected");
    observeList(seen, screens.at("Neighbor Cells List"), named("EARFCN", screens.text("Neighbor Measurements/E-ARFCN")),
                "Measured RSRP", "Measured RSRQ", "");
    observeCandidates(seen, screens);
    addContexts(seen, screens.at("PDP Context Info"));
    return seen;
}

}  // namespace kelvo::overview
