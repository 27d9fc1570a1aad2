#include "telephony/simulation/UTRAN/Reports.h"

#include "telephony/simulation/UTRAN/Modem.h"

namespace kelvo::simulation::utran {

std::vector<MonitoredCell> monitoredCells(const Modem& modem) {
    using enum MonitoredCell::Technology;
    const Cell& serving = modem.serving();
    std::vector<MonitoredCell> cells = {{.technology = UTRAN2,
                                         .isServing = true,
                                         .mcc = kMcc,
                                         .mnc = kMnc,
                                         .lac = serving.locationArea,
                                         .cellId = static_cast<int>(serving.identity),
                                         .uarfcn = serving.uarfcn,
                                         .scn = serving.parameterId,
                                         .bandInfo = serving.band}};
    for (const Measurement& measured : modem.measurements()) {
        if (cells.size() > kMonitoredNeighbors) break;
        const Cell& cell = modem.cells()[measured.cell];
        if (measured.cell == modem.servingIndex()) continue;
        cells.push_back({.technology = UTRAN2,
                         .uarfcn = cell.uarfcn,
                         .scn = cell.parameterId,
                         .rscp = static_cast<int>(measured.rscp)});
    }
    return cells;
}

std::vector<PdpContext> pdpContexts(const Modem& modem) {
    std::vector<PdpContext> contexts;
    for (const std::string& apn : modem.contexts()) {
        const bool isFirst = contexts.empty();
        contexts.push_back({.id = isFirst ? 5 : 6,
                            .apn = apn,
                            .type = "IPv4",
                            .state = "Active",
                            .address = isFirst ? "10.20.30.40" : "10.20.30.41",
                            .qos = "Interactive"});
    }
    return contexts;
}

}  // namespace kelvo::simulation::utran
