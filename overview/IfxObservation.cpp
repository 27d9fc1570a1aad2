#include "overview/Families.h"

/// The cell monitor's tree is the modem's own; it says which radio it is on.
namespace kelvo::overview {
namespace {

/// The state of a group; a group that has nothing but its state stands as that text.
std::string textOf(const Screens& screens, const std::string& group) {
    const std::string alone = screens.text(group);
    return alone.empty() ? screens.text(group + "/State") : alone;
}

void addCell(Observation& seen, const Value& row, bool isUmts) {
    HeardCell heard;
    heard.record = row.record();
    const std::string_view channelName = isUmts ? "UARFCN" : "ARFCN";
    if (row.string() != nullptr) {  // a cell of which the channel alone is known
        heard.identity = named(channelName, *row.string());
    } else {
        const Screens cell(row);
        std::string channel = named(channelName, cell.text(channelName));
        if (channel.empty() && isUmts && seen.access == "UMTS") channel = seen.channel;  // on the serving carrier
        const std::string code = isUmts ? named("PSC", cell.text("SCN")) : named("BSIC", cell.text("BSIC"));
        heard.identity = code.empty() ? channel : channel.empty() ? code : identity(channel, code);
        heard.record = cell.record("");
        heard.level =
            isUmts ? measure("RSCP", cell.figure("RSCP")) : measure("RSSI", cell.figure("RSSI"), Graded::RxLev);
        heard.quality = measure("Ec/N0", cell.figure("ECN0"), Graded::EcIo);
    }
    if (!heard.identity.empty()) seen.cells.push_back(std::move(heard));
}

}  // namespace

Observation observeIfx(const Value& display) {
    const Screens screens(display);
    const Screens serving(screens.at("Serving"));
    Observation seen;
    seen.access = serving.text("Technology");
    const bool isUmts = seen.access == "UMTS";
    seen.state = textOf(screens, "Connection");
    seen.isDedicated = !seen.state.empty() && seen.state != "Idle";
    seen.channel = isUmts ? named("UARFCN", serving.text("UARFCN")) : named("ARFCN", serving.text("ARFCN"));
    seen.cellRecord = serving.record("");
    seen.cell =
        identity(seen.channel, isUmts ? named("PSC", serving.text("SCN")) : named("BSIC", serving.text("BSIC")));
    addNetwork(seen, serving.text("MCC"), serving.text("MNC"));
    seen.area = named("LAC", serving.text("LAC"));
    const auto id = serving.whole("CellId");
    const auto bsic = serving.whole("BSIC");
    if (id && isUmts && *id >= 0) addRncAndCell(seen, *id);
    if (id && !isUmts) add(seen.serving, "Cell identity", std::to_string(*id));
    if (bsic && !isUmts) addColorCodes(seen, *bsic);
    seen.band = serving.text("BandInfo");
    const auto number = serving.whole(isUmts ? "UARFCN" : "ARFCN");
    auto bands = !number ? std::vector<BandChannel>() : isUmts ? utraFddBands(*number) : gsmBands(*number);
    if (bands.size() == 1 && !seen.band.empty()) bands.front().band = std::exchange(seen.band, {});
    addBand(seen, bands);
    seen.level =
        isUmts ? measure("RSCP", serving.figure("RSCP")) : measure("RSSI", serving.figure("RSSI"), Graded::RxLev);
    seen.quality = measure("Ec/N0", serving.figure("ECN0"), Graded::EcIo);

    for (const Value& row : rowsOf(screens.at("Neighbours/GSM"))) addCell(seen, row, false);
    for (const Value& row : rowsOf(screens.at("Neighbours/UMTS"))) addCell(seen, row, true);
    seen.registrationState = textOf(screens, "Registration");
    seen.knowsService = !seen.registrationState.empty();
    seen.isWithoutService = seen.registrationState == "Searching";
    add(seen.registration, "Registration", seen.registrationState);
    for (const char* rate : {"Errors", "Throughput", "TxPower"})
        addRate(seen.rates, rate, screens, std::string("Connection/") + rate);
    return seen;
}

}  // namespace kelvo::overview
