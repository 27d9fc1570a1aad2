#include "telephony/simulation/LTE/Simulation.h"
#include "tests/tools/export/SentDrive.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;

using DriveTest = test::SentDrive;

TEST_F(DriveTest, WhatIsExportedIsTheSimulatedWorlds) {
    simulation::lte::Simulation simulation(5);
    const simulation::lte::Modem& modem = simulation.modem();
    drive(simulation, 4min, [&](int code) {
        const std::string connected = "/Connected mode LTE Intra-frequency Measurement/Serving ";
        if (code == 0xB179) {
            send(connected + "Physical Cell ID", "", modem.serving().pci);
            send(connected + "Filtered RSRP", "dBm", modem.reading().filteredRsrp, 0.125);
            send(connected + "Filtered RSRQ", "dB", modem.reading().filteredRsrq, 0.0625);
            for (const auto& neighbor : modem.neighbors()) {
                const int channel = modem.neighborsCarrier().downlink;
                send(
                    fmt::format("/Measured Neighbor Cells/PCI {}, EARFCN {}/Filtered RSRP", int{neighbor.pci}, channel),
                    "dBm", neighbor.reading.filteredRsrp, 0.125);
            }
        } else if (code == 0xB17F) {
            send("/Serving Cell Measurements/Physical Cell ID", "", modem.serving().pci);
            send("/Serving Cell Measurements/Measured RSRP", "dBm", modem.reading().rsrp, 0.125);
            send("/Serving Cell Measurements/Measured RSRQ", "dB", modem.reading().rsrq, 0.125);
        } else if (code == 0xB0C2) {
            send("/Serving Cell Info/Cell Identity", "", modem.serving().identity);
            send("/Serving Cell Info/Tracking Area Code", "", modem.serving().trackingArea);
        }
    });
    expectExported();
    EXPECT_GT(sentLevels(), 1000);
    // And no level of the serving cell that the world did not send.
    const char* const level = "/Serving Cell Measurements/Measured RSRP";
    EXPECT_EQ(exported(level), sentTo(level));
}

}  // namespace
}  // namespace kelvo
