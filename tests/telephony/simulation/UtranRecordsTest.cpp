#include "telephony/simulation/UTRAN/Records.h"

#include <gtest/gtest.h>

#include "telephony/simulation/UTRAN/Simulation.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::simulation::utran;
using namespace std::chrono_literals;

TEST(UtranRecords, ReportLevelsInStepsOfOneDecibel) {
    EXPECT_EQ(rscpLevel(-115.1), 0);
    EXPECT_EQ(rscpLevel(-115), 1);
    EXPECT_EQ(rscpLevel(-114.1), 1);
    EXPECT_EQ(rscpLevel(-80), 36);
    EXPECT_EQ(rscpLevel(-25), 91);
    EXPECT_EQ(rscpLevel(0), 91);
}

TEST(UtranRecords, ReportBlockErrorsByTheirLogarithm) {
    EXPECT_EQ(blerLevel(0), 0);
    EXPECT_EQ(blerLevel(1e-5), 1);   // below -4.03
    EXPECT_EQ(blerLevel(0.01), 33);  // -2.015 to -1.95: the 32nd step from -4.03
    EXPECT_EQ(blerLevel(1), 63);
}

TEST(UtranRecords, ReportInterferenceInHalfDecibels) {
    EXPECT_EQ(sirLevel(-11.1), 0);
    EXPECT_EQ(sirLevel(-11), 1);
    EXPECT_EQ(sirLevel(7.1), 37);
    EXPECT_EQ(sirLevel(20), 63);
}

TEST(UtranRecords, ListGsmCellsThatNoScreenShows) {
    utran::Simulation simulation(1);
    simulation.next();
    const Modem& modem = simulation.modem();
    const auto& measured = modem.gsmMeasurements();
    ASSERT_EQ(measured.size(), 6U);
    const Bytes record = gsmCellsRecord(0s, modem);
    ASSERT_EQ(record.size(), 2U + 17 + 6 * 8);
    EXPECT_EQ(record[2 + 16], 6);
    for (std::size_t i = 0; i < 6; ++i) {
        const Cell& cell = modem.cells()[measured[i].cell];
        const auto* entry = record.data() + 2 + 17 + 8 * i;
        EXPECT_EQ((entry[0] | entry[1] << 8) & 0x3FFF, cell.gsmIdentity);
        EXPECT_EQ(entry[1] >> 6 & 1, 0);          // the band: 1800 MHz
        EXPECT_EQ(entry[1] >> 7, i < 4 ? 1 : 0);  // the four strongest are identified
        EXPECT_EQ(entry[2], cell.ncc);
        EXPECT_EQ(entry[3], cell.bcc);
        EXPECT_EQ(entry[4] | entry[5] << 8, cell.gsmArfcn);
        EXPECT_EQ(static_cast<std::int16_t>(entry[6] | entry[7] << 8), measured[i].rssi);
    }
}

TEST(UtranRecords, NameChannelsAndBandsConsistently) {
    Random random(1);
    const Network network(random);
    const auto& [sectors, cells] = network;
    for (std::size_t i = 0; i < cells.size(); ++i) {
        EXPECT_DOUBLE_EQ(sectors[i].carrierMHz * 5, cells[i].uarfcn);
        const bool isBandA = sectors[i].carrierMHz >= 2010 && sectors[i].carrierMHz <= 2025;
        const bool isBandF = sectors[i].carrierMHz >= 1880 && sectors[i].carrierMHz <= 1920;
        EXPECT_TRUE(cells[i].band == 1 ? isBandA : cells[i].band == 6 && isBandF);
        for (std::size_t other = 0; other < i; ++other) EXPECT_NE(cells[other].parameterId, cells[i].parameterId);
    }
}
