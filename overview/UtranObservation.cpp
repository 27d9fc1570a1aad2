#include "overview/Families.h"

/// UTRA in time division: the serving cell is the row of the active set; its level has no unit on the screens.
namespace kelvo::overview {
namespace {

std::string_view markOf(const std::string& status) {
    if (status == "ASET") return "active";
    return status == "DSET" ? "detected" : "";
}

}  // namespace

Observation observeUtran(const Value& display) {
    const Screens screens(display);
    const Screens info(screens.at("Serving Cell Info"));
    Observation seen;
    seen.access = "UTRA TDD";
    seen.state = screens.text("RRC Info/State");
    seen.isDedicated = seen.state == "Cell DCH";
    seen.channel = named("UARFCN", info.text("Downlink UARFCN"));
    const std::string lac = named("LAC", info.text("Local Area Code"));
    const std::string ura = named("URA", info.text("URA ID"));
    seen.area = lac.empty() || ura.empty() ? lac + ura : lac + ", " + ura;
    if (const auto id = info.whole("Cell ID")) addRncAndCell(seen, *id);
    const auto uarfcn = info.whole("Downlink UARFCN");
    addBand(seen, uarfcn ? utraTddBands(*uarfcn) : std::vector<BandChannel>());
    add(seen.serving, "Access", info.text("Allowed Access"));

    for (const Value& row : rowsOf(screens.at("Neighbor Cell List"))) {
        const Screens cell(row);
        HeardCell heard;
        heard.identity = identity(named("UARFCN", cell.text("UARFCN")), named("cell", cell.text("Cell ID")));
        heard.mark = markOf(cell.text("Status"));
        heard.level = measure("RSCP", cell.figure("Filter RSCP"));
        heard.record = cell.record("UARFCN");
        if (heard.identity.empty()) continue;
        if (heard.mark == "active" && seen.cell.empty()) {
            seen.cell = heard.identity;
            seen.cellRecord = heard.record;
            seen.level = heard.level;
        } else {
            seen.cells.push_back(std::move(heard));
        }
    }
    if (seen.cell.empty()) {
        seen.cell = identity(seen.channel, named("cell", info.text("Cell Scrambling Code")));
        seen.cellRecord = info.record("Cell Scrambling Code");
    }
    for (const Value& row : rowsOf(screens.at("TRCH BLER"))) {
        const Screens channel(row);
        addRate(seen.rates, "BLER, channel " + channel.text("TRCH ID"), channel, "TRCH BLER Measurement");
    }
    addContexts(seen, screens.at("PDP Context Info"));
    return seen;
}

}  // namespace kelvo::overview
