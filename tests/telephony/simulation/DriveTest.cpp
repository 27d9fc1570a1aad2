#include <gtest/gtest.h>

#include <cmath>

#include "telephony/simulation/Drive.h"
#include "telephony/simulation/HeldFor.h"

using namespace kelvo::simulation;
using namespace std::chrono_literals;

TEST(Random, GivesTheSameNumbersForTheSameSeed) {
    Random one(7);
    Random other(7);
    Random different(8);
    EXPECT_EQ(one.uniform(), other.uniform());
    EXPECT_EQ(one.normal(), other.normal());
    EXPECT_NE(one.uniform(), different.uniform());
}

TEST(Random, DrawsNormalNumbersOfMeanZeroAndDeviationOne) {
    Random random(1);
    double sum = 0;
    double squares = 0;
    for (int i = 0; i < 20'000; ++i) {
        const double value = random.normal();
        sum += value;
        squares += value * value;
    }
    EXPECT_NEAR(sum / 20'000, 0, 0.03);
    EXPECT_NEAR(squares / 20'000, 1, 0.05);
}

TEST(Random, DrawsWholeNumbersBetweenBothEnds) {
    Random random(3);
    bool low = false;
    bool high = false;
    for (int i = 0; i < 200; ++i) {
        const int value = random.between(-1, 2);
        EXPECT_GE(value, -1);
        EXPECT_LE(value, 2);
        low |= value == -1;
        high |= value == 2;
    }
    EXPECT_TRUE(low && high);
}

TEST(Journey, DrivesStopsAndBeginsAgain) {
    // 100 m east at 10 m/s, 5 s of standing, back at 20 m/s: a lap of 20 s.
    const Journey journey({{{0, 0}, 10, 0}, {{100, 0}, 20, 5}});
    EXPECT_DOUBLE_EQ(journey.at(4s).east, 40);
    EXPECT_DOUBLE_EQ(journey.at(12s).east, 100);
    EXPECT_DOUBLE_EQ(journey.driven(12s), 100);
    EXPECT_DOUBLE_EQ(journey.at(16s).east, 80);
    EXPECT_DOUBLE_EQ(journey.at(24s).east, 40);
    EXPECT_DOUBLE_EQ(journey.driven(24s), 240);
}

TEST(Bearing, CountsFromNorthClockwise) {
    EXPECT_DOUBLE_EQ(bearing({0, 0}, {0, 5}), 0);
    EXPECT_DOUBLE_EQ(bearing({0, 0}, {5, 0}), 90);
    EXPECT_DOUBLE_EQ(bearing({0, 0}, {-5, 0}), 270);
}

TEST(PathLoss, FollowsTheUrbanMacroCellModel) {
    EXPECT_NEAR(pathLoss(1000, 2000), 128.15, 0.01);          // 58.83 for the antenna, 69.32 for the carrier: 128.1
    EXPECT_NEAR(pathLoss(100, 2000), 128.15 - 37.6, 0.01);    // 37.6 dB a decade
    EXPECT_DOUBLE_EQ(pathLoss(1, 2000), pathLoss(35, 2000));  // no nearer than a mast is high
}

TEST(SectorGain, FallsOffToItsFrontToBackRatio) {
    EXPECT_DOUBLE_EQ(sectorGain(0), 0);
    EXPECT_DOUBLE_EQ(sectorGain(32.5), -3);
    EXPECT_DOUBLE_EQ(sectorGain(-32.5), -3);
    EXPECT_DOUBLE_EQ(sectorGain(360 + 32.5), -3);
    EXPECT_DOUBLE_EQ(sectorGain(180), -20);
}

TEST(Shadowing, StaysWhileThePhoneStandsAndForgetsOverDistance) {
    Shadowing shadow{Random(5)};
    const double before = shadow.after(0);
    EXPECT_EQ(shadow.after(0), before);
    double squares = 0;
    double products = 0;
    double last = before;
    for (int i = 1; i <= 20'000; ++i) {
        const double value = shadow.after(Shadowing::kReach * i);
        squares += value * value;
        products += value * last;
        last = value;
    }
    EXPECT_NEAR(std::sqrt(squares / 20'000), 6, 0.2);
    EXPECT_NEAR(products / squares, 1 / std::exp(1.0), 0.03);
}

TEST(RayleighFading, HasTheMeanPowerOfOne) {
    Random random(2);
    double power = 0;
    for (int i = 0; i < 20'000; ++i) power += toMilliwatts(rayleighFading(random));
    EXPECT_NEAR(power / 20'000, 1, 0.03);
}

TEST(LinkCapacity, IsThreeFifthsOfShannonsBound) {
    EXPECT_DOUBLE_EQ(linkCapacity(1000, 0), 600);                     // log2 of 2
    EXPECT_NEAR(linkCapacity(1000, 10 * std::log10(3)), 1200, 1e-9);  // log2 of 4
    EXPECT_NEAR(neededSinr(1000, 1200), 10 * std::log10(3), 1e-9);
}

TEST(Town, HasThreeSectorsASiteOneThirdOfATurnApart) {
    Random random(1);
    const auto sectors = buildSectors({}, random);
    ASSERT_GE(sectors.size(), 30U);
    ASSERT_EQ(sectors.size() % 3, 0U);
    EXPECT_EQ(sectors[0].siteNumber, 0);
    EXPECT_EQ(sectors[2].siteNumber, 0);
    EXPECT_EQ(sectors[3].siteNumber, 1);
    EXPECT_DOUBLE_EQ(sectors[1].direction - sectors[0].direction, 120);
}

TEST(Drive, ReceivesPowerLessLossWithinItsShadow) {
    // One sector 1 km north of a phone that drives 1 m: 58 dBm less 128.15 dB, and a shadow of 6 dB deviation.
    const Sector sector{.site = {0, 1000}, .direction = 180, .power = 58, .carrierMHz = 2000};
    double sum = 0;
    for (std::uint64_t seed = 0; seed < 400; ++seed) {
        const Drive drive({sector}, Journey({{{0, 0}}, {{1, 0}}}), Random(seed));
        sum += drive.received(0);
    }
    EXPECT_NEAR(sum / 400, 58 - 128.15, 1.0);
}

TEST(Drive, OrdersSectorsByStrength) {
    Random random(9);
    auto sectors = buildSectors({}, random);
    Drive drive(std::move(sectors), Journey::through(2000, random), random.split());
    drive.moveTo(60s);
    const auto order = drive.byStrength();
    for (std::size_t i = 1; i < order.size(); ++i) EXPECT_GE(drive.received(order[i - 1]), drive.received(order[i]));
}

TEST(HeldFor, FiresOnlyAfterTheWholeTimeWithoutABreak) {
    HeldFor held(100ms);
    EXPECT_FALSE(held(true, 3, 0ms));
    EXPECT_FALSE(held(true, 3, 80ms));
    EXPECT_TRUE(held(true, 3, 100ms));
    EXPECT_FALSE(held(false, 3, 120ms));
    EXPECT_FALSE(held(true, 3, 140ms));
    EXPECT_FALSE(held(true, 4, 240ms));  // another candidate begins anew
    EXPECT_TRUE(held(true, 4, 340ms));
}

TEST(EachHeldFor, NamesTheFirstThatHasHeldAndLetsNoneHoldUpAnother) {
    EachHeldFor held(100ms);
    using Subjects = std::vector<std::size_t>;
    EXPECT_EQ(held(Subjects{3, 4}, 0ms), std::nullopt);
    EXPECT_EQ(held(Subjects{4, 3}, 60ms), std::nullopt);
    EXPECT_EQ(held(Subjects{3, 4}, 100ms), 3U);
    EXPECT_EQ(held(Subjects{5, 4, 3}, 120ms), 4U);  // 5 is new
    EXPECT_EQ(held(Subjects{3}, 140ms), 3U);
    EXPECT_EQ(held(Subjects{4}, 200ms), std::nullopt);  // had a break
    held.restart();
    EXPECT_EQ(held(Subjects{4}, 300ms), std::nullopt);
    EXPECT_EQ(held(Subjects{4}, 400ms), 4U);
}
