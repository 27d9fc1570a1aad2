#include <algorithm>

#include "overview/Families.h"

/// GSM and UMTS: the phone is on the radio whose serving cell was told last. What the other one's screens say, and what
/// a state was when the phone was here before, is of the past.
namespace kelvo::overview {
namespace {

constexpr const char* kGsmCell = "GSM Cell and Neighbours/GSM Serving Cell";
constexpr const char* kRrState = "GSM Cell and Neighbours/GSM RR Info/RR State";
constexpr const char* kUmtsCell = "UMTS Radio/UMTS RR Info";
constexpr const char* kActiveSet = "UMTS Cells/Active Set";

std::string in(const char* screen, const char* key) { return std::string(screen) + "/" + key; }

/// RXLEV of 3GPP TS 45.008 clause 8.1.4 names steps of 1 dB: n is -111 + n to -110 + n dBm. The screens show n.
std::optional<Measure> rxLevel(std::optional<Figure> figure) {
    if (!figure) return std::nullopt;
    if (figure->number >= 0) {
        const double dbm = figure->number - 110;
        figure->text = fmt::format("{:.0f} dBm", dbm);
        figure->number = dbm;
        figure->unit = "dBm";
    }
    return measure("RxLev", std::move(figure), Graded::RxLev);
}

/// `left` is the last record of the other radio.
std::string stateSince(std::uint64_t left, const Screens& screens, const std::string& path) {
    return screens.record(path) > left ? screens.text(path) : std::string();
}

void observeGsm(Observation& seen, const Screens& screens, std::uint64_t leftUmts) {
    const Screens cell(screens.at(kGsmCell));
    seen.access = "GSM";
    seen.state = stateSince(leftUmts, screens, kRrState);
    if (seen.state == "RR_INACTIVE") seen.state.clear();  // on its way to UMTS, or there already
    seen.isDedicated = seen.state == "RR_DATA_TRANSFER" || seen.state == "RR_G2W_INTERRAT_HANDOVER_ PROGRESS";
    seen.cellComesInParts = true;
    seen.channel = named("ARFCN", cell.text("ARFCN"));
    seen.cell = identity(seen.channel, named("BSIC", cell.text("BSIC")));
    seen.cellRecord = cell.record("ARFCN");
    if (const auto bsic = cell.whole("BSIC")) addColorCodes(seen, *bsic);
    add(seen.serving, "Cell identity", cell.text("Cell ID"));
    const auto arfcn = cell.whole("ARFCN");
    addBand(seen, arfcn ? gsmBands(*arfcn) : std::vector<BandChannel>());
    seen.level = rxLevel(cell.figure("RSSI"));
}

/// Of the cells of a soft handover the one that the cell's own screen names, else the first.
const Value* servingOf(const std::vector<Value>& active, const Screens& cell) {
    const std::string code = cell.text("Scrambling Code");
    const auto row =
        std::ranges::find_if(active, [&](const Value& one) { return Screens(one).text("Scrambling Code") == code; });
    return row != active.end() ? &*row : active.empty() ? nullptr : &active.front();
}

void observeUmts(Observation& seen, const Screens& screens, std::uint64_t leftGsm) {
    const Screens cell(screens.at(kUmtsCell));
    seen.access = "UMTS";
    seen.state = stateSince(leftGsm, screens, in(kUmtsCell, "RRC State"));
    seen.isDedicated = seen.state == "CELL_DCH";
    const std::string channel = cell.text("UARFCN").empty() ? "Downlink Frequency" : "UARFCN";
    seen.channel = named("UARFCN", cell.text(channel));
    const auto active = rowsOf(screens.at(kActiveSet));
    const Value* row = servingOf(active, cell);
    const std::uint64_t told = cell.record("Scrambling Code");
    if (row != nullptr) {
        const Screens serving(*row);
        seen.cell = identity(seen.channel, named("PSC", serving.text("Scrambling Code")));
        seen.cellRecord = serving.record("Scrambling Code");
        seen.level = measure("RSCP", serving.figure("RSCP"));
        seen.quality = measure("Ec/Io", serving.figure("Energy Per Chip"), Graded::EcIo);
    }
    if (told > seen.cellRecord) {  // the active set is not that of this cell yet
        seen.cell = identity(seen.channel, named("PSC", cell.text("Scrambling Code")));
        seen.cellRecord = told;
    }
    if (const auto id = cell.whole("Cell ID")) addRncAndCell(seen, *id);
    const auto uarfcn = cell.whole(channel);
    addBand(seen, uarfcn ? utraFddBands(*uarfcn) : std::vector<BandChannel>());
    add(seen.serving, "Transmit power", cell.text("Transmit Power"));
}

void addGsmCell(Observation& seen, const Value& row) {
    const Screens cell(row);
    HeardCell heard;
    const std::string channel = named("ARFCN", cell.text("ARFCN"));
    const std::string color = named("BSIC", cell.text("BSIC"));
    heard.identity = color.empty() ? channel : identity(channel, color);
    heard.level = rxLevel(cell.figure("RSSI"));
    heard.record = cell.record("ARFCN");
    if (!heard.identity.empty()) seen.cells.push_back(std::move(heard));
}

void addUmtsCell(Observation& seen, const Value& row, std::string channel, std::string_view mark) {
    const Screens cell(row);
    if (channel.empty()) channel = named("UARFCN", cell.text("UARFCN"));
    if (channel.empty()) channel = named("UARFCN", cell.text("Downlink Frequency"));
    HeardCell heard;
    heard.identity = identity(channel, named("PSC", cell.text("Scrambling Code")));
    heard.mark = mark;
    heard.level = measure("RSCP", cell.figure("RSCP"));
    heard.quality = measure("Ec/Io", cell.figure("Energy Per Chip"), Graded::EcIo);
    heard.record = cell.record("Scrambling Code");
    if (!heard.identity.empty()) seen.cells.push_back(std::move(heard));
}

void observeCells(Observation& seen, const Screens& screens) {
    const std::string channel = seen.access == "UMTS" ? seen.channel : std::string();
    const auto active = rowsOf(screens.at(kActiveSet));
    for (const Value& row : active) {
        if (!channel.empty()) addUmtsCell(seen, row, channel, "active");
    }
    std::erase_if(seen.cells, [&](const HeardCell& cell) { return cell.identity == seen.cell; });
    for (const Value& row : rowsOf(screens.at("UMTS Cells/UMTS Set"))) addUmtsCell(seen, row, {}, "");
    for (const char* list : {"Neighboring Cells", "GSM Set"}) {
        for (const Value& row : rowsOf(screens.at(in("GSM Cell and Neighbours", list)))) addGsmCell(seen, row);
    }
}

void observeRegistration(Observation& seen, const Screens& screens) {
    const Screens registration(screens.at("Registration and Network"));
    const Screens network(registration.at("Serving PLMN"));
    const std::string lac = named("LAC", network.text("Location Area Code"));
    const std::string rac = named("RAC", network.text("Routing Area Code"));
    seen.area = lac.empty() || rac.empty() ? lac : lac + ", " + rac;
    addNetwork(seen, network.text("Mobile Country Code"), network.text("Mobile Network Code"));
    const std::string service = network.text("Service Type");
    seen.knowsService = !service.empty();
    seen.isWithoutService = service == "NO_SERVICE" || service == "LIMITED_SERVICE";
    seen.registrationState = registration.text("Process PS/MM State");
    const std::string update = registration.text("Process CS/LU Reject Cause");
    const std::string attach = registration.text("Process PS/Attach Reject Cause");
    if (update.ends_with("NOT_ALLOWED")) seen.reject = update;
    if (attach.ends_with("NOT_ALLOWED")) seen.reject = attach;
    add(seen.registration, "Service", service);
    add(seen.registration, "MM", registration.text("Process CS/MM State"));
    add(seen.registration, "Location update", update);
    add(seen.registration, "GMM", registration.text("Process PS/MM State"));
    add(seen.registration, "Attach", attach);
}

}  // namespace

Observation observeGsmUmts(const Value& display) {
    const Screens screens(display);
    Observation seen;
    std::uint64_t umts = screens.record(in(kUmtsCell, "Scrambling Code"));
    for (const Value& row : rowsOf(screens.at(kActiveSet)))
        umts = std::max(umts, Screens(row).record("Scrambling Code"));
    const std::uint64_t gsm = screens.record(kGsmCell);
    if (umts > gsm) {
        observeUmts(seen, screens, gsm);
    } else if (gsm != 0) {
        observeGsm(seen, screens, umts);
    }
    observeCells(seen, screens);
    observeRegistration(seen, screens);
    for (const Value& row : rowsOf(screens.at("Counters/BLER/Transport Channels"))) {
        const Screens channel(row);
        const auto received = channel.whole("CRC Received");
        const auto wrong = channel.whole("CRC Received in Error");
        if (!received || !wrong || *received <= 0) continue;
        const double share = 100.0 * static_cast<double>(*wrong) / static_cast<double>(*received);
        const std::string text = fmt::format("{:.1f} %", share);
        seen.rates.push_back({"BLER, channel " + channel.text("Transport Channel ID"), text,
                              Figure{text, share, "%", channel.record("CRC Received")}});
    }
    addContexts(seen, screens.at("SIM and Data Contexts/PDP Context Info"));
    return seen;
}

}  // namespace kelvo::overview
