#include "telephony/simulation/LTE/Records.h"

#include <gtest/gtest.h>

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::simulation::lte;
using namespace std::chrono_literals;

// No drive comes so far out that a phone's own cell is too weak for it.
TEST(LteRecords, TellOfAnIdlePhoneThatItsCellIsTooWeakFor) {
    Cell cell;
    cell.searchIntra = 50;
    cell.searchOther = 36;
    const Reading reading{.rsrp = -131, .rsrq = -15, .rssi = -90, .filteredRsrp = -130, .filteredRsrq = -14};
    const IdleState idle{.srxlev = -6, .failedCycles = 3, .rules = 7, .rulesChanged = true};
    const Bytes record = servingMeasurementRecord(0s, cell, reading, idle);
    ASSERT_EQ(record.size(), 2U + 33);
    // From bit 0 up: 7 bits of 24 (-6 above -30), 6 of 3 cycles, 6 of 25 (50 by 2), 6 of 18 (36 by 2), 1, 4 of 7.
    // 24 + 3 * 0x80 + 25 * 0x2000 + 18 * 0x80000 + 0x2000000 + 7 * 0x4000000 = 0x1e932198
    EXPECT_EQ(Bytes(record.begin() + 2 + 29, record.end()), (Bytes{0x98, 0x21, 0x93, 0x1E}));
}

TEST(LteRecords, CountNoMoreFailedCyclesThanTheyHaveBitsFor) {
    IdleState idle;
    idle.srxlev = -30;
    idle.failedCycles = 64;
    const Bytes record = servingMeasurementRecord(0s, {}, {}, idle);
    EXPECT_EQ(record[2 + 29], 0x80);         // the lowest bit of 63
    EXPECT_EQ(record[2 + 30] & 0x1F, 0x1F);  // and the five above
}
