#include "telephony/simulation/LTE/Reports.h"

#include <algorithm>

#include "telephony/simulation/LTE/Modem.h"

namespace kelvo::simulation::lte {

std::vector<MonitoredCell> monitoredCells(const Modem& modem) {
    const Cell& serving = modem.serving();
    std::vector<MonitoredCell> cells = {{.technology = MonitoredCell::Technology::LTE,
                                         .isServing = true,
                                         .mcc = kMcc,
                                         .mnc = kMnc,
                                         .tac = serving.trackingArea,
                                         .cellId = static_cast<int>(serving.identity),
                                         .pid = serving.pci,
                                         .uarfcn = serving.carrier.downlink,
                                         .bandInfo = serving.carrier.band}};
    const std::size_t count = std::min(modem.neighbors().size(), kMonitoredNeighbors);
    for (std::size_t i = 0; i < count; ++i) {
        cells.push_back({.technology = MonitoredCell::Technology::LTE,
                         .pid = modem.neighbors()[i].pci,
                         .uarfcn = modem.neighborsCarrier().downlink});
    }
    return cells;
}

std::vector<PdpContext> pdpContexts(const Modem& modem) {
    std::vector<PdpContext> contexts = {
        {.id = 5, .apn = "internet", .type = "IPv4v6", .state = "Active", .address = "10.20.30.40", .qos = "QCI 9"},
        {.id = 6, .apn = "ims", .type = "IPv6", .state = "Active", .address = "2001:db8:1::2", .qos = "QCI 5"},
    };
    if (modem.isOnCall()) contexts.push_back({.id = 7, .apn = "ims", .state = "Active", .qos = "QCI 1"});  // voice
    return contexts;
}

}  // namespace kelvo::simulation::lte
