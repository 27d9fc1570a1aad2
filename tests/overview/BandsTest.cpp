#include "overview/Bands.h"

#include <gtest/gtest.h>

namespace kelvo::overview {
namespace {

TEST(Bands, AnEarfcnIsTenthsOfAMegahertzAboveItsBandsLowestCarrier) {
    const auto bands = lteBands(5780);
    ASSERT_EQ(bands.size(), 1u);
    EXPECT_EQ(bands[0].band, "17");
    EXPECT_DOUBLE_EQ(*bands[0].downMHz, 739.0);
    EXPECT_DOUBLE_EQ(*bands[0].upMHz, 709.0);
}

TEST(Bands, EveryEarfcnBelongsToOneBandAtMost) {
    int in = 0;
    for (int earfcn = 0; earfcn <= 65535; ++earfcn) {
        const auto bands = lteBands(earfcn);
        ASSERT_LE(bands.size(), 1u) << earfcn;
        in += static_cast<int>(bands.size());
    }
    // 0 to 10359 without 4950-5009, 5380-5729 and 7400-7499; 36000 to 60139.
    EXPECT_EQ(in, 10360 - 60 - 350 - 100 + 24140);
}

TEST(Bands, TheEdgesOfABandAreItsOwn) {
    EXPECT_EQ(lteBands(1199)[0].band, "2");
    EXPECT_EQ(lteBands(1200)[0].band, "3");
    EXPECT_EQ(lteBands(1949)[0].band, "3");
    EXPECT_TRUE(lteBands(4950).empty());
    EXPECT_TRUE(lteBands(65535).empty());
}

TEST(Bands, ATimeDivisionBandHasOneCarrierAndASupplementaryOneNoUplink) {
    EXPECT_DOUBLE_EQ(*lteBands(38950)[0].downMHz, 2330.0);
    EXPECT_DOUBLE_EQ(*lteBands(38950)[0].upMHz, 2330.0);
    EXPECT_EQ(lteBands(9700)[0].band, "29");
    EXPECT_FALSE(lteBands(9700)[0].upMHz);
}

TEST(Bands, AnUplinkEarfcnHasNumbersOfItsOwn) {
    EXPECT_DOUBLE_EQ(*lteUplinkMHz(19300), 1720.0);
    EXPECT_DOUBLE_EQ(*lteUplinkMHz(23780), 709.0);
    EXPECT_FALSE(lteUplinkMHz(17999));
}

TEST(Bands, AUarfcnIsAFifthOfAMegahertz) {
    const auto bands = utraFddBands(10562);
    ASSERT_EQ(bands.size(), 1u);
    EXPECT_EQ(bands[0].band, "I");
    EXPECT_NEAR(*bands[0].downMHz, 2112.4, 1e-9);
    EXPECT_NEAR(*bands[0].upMHz, 1922.4, 1e-9);
    EXPECT_NEAR(*utraFddBands(3000)[0].downMHz, 940.0, 1e-9);  // VIII: 340 + 3000 / 5
}

TEST(Bands, AUarfcnMayBeOfTwoBands) {
    const auto bands = utraFddBands(4400);  // 880 MHz
    ASSERT_EQ(bands.size(), 2u);
    EXPECT_EQ(bands[0].band, "V");
    EXPECT_EQ(bands[1].band, "VI");
    EXPECT_NEAR(*bands[0].downMHz, 880.0, 1e-9);
    EXPECT_NEAR(*bands[1].downMHz, 880.0, 1e-9);
}

TEST(Bands, TheAdditionalChannelsLieBetweenTheRaster) {
    EXPECT_NEAR(*utraFddBands(412)[0].downMHz, 1932.5, 1e-9);
    EXPECT_NEAR(*utraFddBands(437)[0].downMHz, 1937.5, 1e-9);
    EXPECT_NEAR(*utraFddBands(1887)[0].downMHz, 2112.5, 1e-9);
}

TEST(Bands, ATimeDivisionUarfcn) {
    const auto bands = utraTddBands(10063);
    ASSERT_EQ(bands.size(), 1u);
    EXPECT_EQ(bands[0].band, "a");
    EXPECT_NEAR(*bands[0].downMHz, 2012.6, 1e-9);
}

TEST(Bands, AnArfcnOf1800And1900IsBoth) {
    const auto bands = gsmBands(700);
    ASSERT_EQ(bands.size(), 2u);
    EXPECT_EQ(bands[0].band, "DCS 1800");
    EXPECT_NEAR(*bands[0].downMHz, 1842.8, 1e-9);
    EXPECT_EQ(bands[1].band, "PCS 1900");
    EXPECT_NEAR(*bands[1].downMHz, 1967.8, 1e-9);
    EXPECT_EQ(gsmBands(811).size(), 1u);
}

TEST(Bands, Gsm900WrapsAtZero) {
    EXPECT_NEAR(*gsmBands(0)[0].upMHz, 890.0, 1e-9);
    EXPECT_NEAR(*gsmBands(1023)[0].upMHz, 889.8, 1e-9);
    EXPECT_NEAR(*gsmBands(21)[0].downMHz, 939.2, 1e-9);
    EXPECT_NEAR(*gsmBands(128)[0].downMHz, 869.2, 1e-9);
}

TEST(Bands, ACdmaChannelNeedsItsBandClass) {
    EXPECT_NEAR(*cdmaBands(0, 283)[0].downMHz, 878.49, 1e-9);
    EXPECT_NEAR(*cdmaBands(0, 283)[0].upMHz, 833.49, 1e-9);
    EXPECT_NEAR(*cdmaBands(0, 1023)[0].upMHz, 825.0, 1e-9);
    EXPECT_NEAR(*cdmaBands(1, 475)[0].downMHz, 1953.75, 1e-9);
    EXPECT_TRUE(cdmaBands(0, 900).empty());
    EXPECT_TRUE(cdmaBands(99, 1).empty());
}

}  // namespace
}  // namespace kelvo::overview
