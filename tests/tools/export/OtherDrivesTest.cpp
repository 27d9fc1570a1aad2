#include <algorithm>
#include <cmath>

#include "telephony/simulation/CDMA/Simulation.h"
#include "telephony/simulation/GSMUMTS/Simulation.h"
#include "telephony/simulation/IFX/Simulation.h"
#include "telephony/simulation/UTRAN/Simulation.h"
#include "tests/tools/export/SentDrive.h"

namespace kelvo {
namespace {

using namespace simulation;
using namespace std::chrono_literals;

using OtherDrivesTest = test::SentDrive;

constexpr double kTwoDecimals = 0.00501;  // what a number loses that is shown with two

TEST_F(OtherDrivesTest, OfCdmaAreTheSimulatedWorlds) {
    cdma::Simulation simulation(5);
    drive(simulation, 3min, [&](int code) {
        const cdma::OneXStatus& status = simulation.modem().oneX().status();
        const cdma::System& system = simulation.modem().oneX().system();
        if (code == 0x119C) {
            send("/1x/Rx0 AGC", "dBm", status.rx0, 0.167 + kTwoDecimals);
            for (const cdma::PilotReading& pilot : status.active)
                send(fmt::format("/1x/Active Set/{}", int{pilot.pn}), "dB", pilot.strength, 0.025 + kTwoDecimals);
        } else if (code == 0x1183) {
            send("/EV-DO/Rx0 AGC", "dBm", simulation.modem().evdo().status().rx0, 0.5);
        } else if (code == 0x134F && system.type == cdma::System::kCdma) {
            send("/System/System ID", "", system.sid);
            send("/System/Network ID", "", system.nid);
            send("/System/Base Station ID", "", system.baseId);
        }
    });
    expectExported();
    EXPECT_GT(sentLevels(), 300);
    EXPECT_GT(sentTo("/System/System ID"), 3);
    EXPECT_EQ(exported("/1x/Rx0 AGC"), sentTo("/1x/Rx0 AGC"));
}

TEST_F(OtherDrivesTest, OfUtranAreTheSimulatedWorlds) {
    utran::Simulation simulation(5);
    const utran::Modem& modem = simulation.modem();
    drive(simulation, 3min, [&](int code) {
        if (code == 0xD00A) {
            for (const auto& measured : modem.measurements()) {
                const utran::Cell& cell = modem.cells()[measured.cell];
                const std::string row = fmt::format("UARFCN {}, cell {}", int{cell.uarfcn}, int{cell.parameterId});
                // Shown are 256ths of the steps of 1 dB that a phone reports, the first from -115 dBm on.
                send("/Neighbor Cell List/" + row + "/Filter RSCP", "",
                     std::max(std::floor(measured.rscp) + 116, 0.0) / 256);
            }
        } else if (code == 0xD0E2) {
            send("/Serving Cell Info/Cell ID", "", modem.serving().identity);
            send("/Serving Cell Info/Downlink UARFCN", "", modem.serving().uarfcn);
        }
    });
    expectExported();
    EXPECT_GT(sent.size(), 500U);
    EXPECT_GT(sentTo("/Serving Cell Info/Cell ID"), 10);
}

/// RXLEV has steps of 1 dB, whose upper end it stands for; the last one has none (3GPP TS 45.008, 8.1.4).
double rxLev(double level) { return std::min(level + 110.5, 63.0); }

TEST_F(OtherDrivesTest, OfGsmAndUmtsAreTheSimulatedWorlds) {
    gsm::Simulation simulation(5);
    const gsm::Modem& phone = simulation.modem();
    drive(simulation, 3min, [&](int code) {
        const std::string gsmCells = "/GSM Cell and Neighbours/";
        if (code == 0x5137) {
            send(gsmCells + "GSM Serving Cell/RSSI", "dBm", rxLev(simulation.air().gsmLevel(phone.serving())), 0.51);
            for (const std::size_t sector : phone.gsmNeighbors()) {
                const int channel = simulation.network().gsmCells[sector].arfcn;
                // Its code may be another's until it is read.
                send(fmt::format("{}Neighboring Cells/ARFCN {}[,/]*RSSI", gsmCells, channel), "",
                     rxLev(simulation.air().gsmLevel(sector)), 0.51);
            }
        } else if (code == 0x5134) {
            const gsm::GsmCell& cell = simulation.network().gsmCells[phone.serving()];
            send(gsmCells + "GSM Serving Cell/ARFCN", "", cell.arfcn);
            send(gsmCells + "GSM Serving Cell/BSIC", "", cell.bsic);
            send(gsmCells + "GSM Serving Cell/Cell ID", "", cell.cellId);
        } else if (code == 0x417A) {
            const gsm::UmtsCell& cell = simulation.network().umtsCells[phone.serving()];
            const std::string row = fmt::format("/UMTS Cells/Active Set/PSC {}/", int{cell.scramblingCode});
            // The searcher's steps of 1 dB are rounded down, and so is the power under the RSCP.
            send(row + "RSCP", "dB", simulation.air().rscp(phone.serving()) - 1.05, 1.25);
            send(row + "Energy Per Chip", "dB", simulation.air().ecNo(phone.serving()) - 0.55, 0.7);
        }
    });
    expectExported();
    EXPECT_GT(sentLevels(), 300);
    EXPECT_GT(sentTo("/GSM Cell and Neighbours/GSM Serving Cell/Cell ID"), 1);
}

TEST_F(OtherDrivesTest, OfACellMonitorAreTheSimulatedWorlds) {
    ifx::Simulation simulation(5);
    const ifx::Status& status = simulation.modem().status();
    drive(simulation, 6min, [&](int) {
        if (status.access == ifx::RadioAccess::None) return;
        if (status.access == ifx::RadioAccess::Gsm) {
            send("/Serving/RSSI", "dBm", status.rssi, 0.5);
            send("/Serving/CellId", "", simulation.network().gsmCells[status.serving].cellId);
        } else {
            send("/Serving/RSCP", "dBm", status.rscp, 0.5);
            send("/Serving/ECN0", "dB", status.ecN0, 0.25);
            send("/Serving/CellId", "", simulation.network().umtsCells[status.serving].cellId);
        }
        for (const ifx::GsmNeighbor& neighbor : status.gsm) {
            if (!neighbor.measured) continue;
            const ifx::GsmCell& cell = simulation.network().gsmCells[neighbor.sector];
            const std::string code = neighbor.identified ? fmt::format(", BSIC {}", int{cell.bsic}) : "";
            send(fmt::format("/Neighbours/GSM/ARFCN {}{}/RSSI", int{cell.arfcn}, code), "dBm", neighbor.rssi, 0.5);
        }
        for (const ifx::UmtsNeighbor& neighbor : status.umts) {
            const int code = simulation.network().umtsCells[neighbor.sector].scramblingCode;
            send(fmt::format("/Neighbours/UMTS/PSC {}/RSCP", code), "dBm", neighbor.rscp, 0.5);
        }
    });
    expectExported();
    EXPECT_GT(sentLevels(), 500);
    EXPECT_GT(sentTo("/Serving/RSSI"), 20);
    EXPECT_GT(sentTo("/Serving/RSCP"), 20);
    EXPECT_EQ(exported("/Serving/RSSI"), sentTo("/Serving/RSSI"));
}

}  // namespace
}  // namespace kelvo
