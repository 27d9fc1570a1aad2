#include "telephony/RecordRates.h"

#include <gtest/gtest.h>

using namespace kelvo;
using namespace std::chrono_literals;

namespace {

class RecordRatesTest : public testing::Test {
protected:
    double rateOf(LogCode code) const {
        for (const auto& rate : _rates.rates())
            if (rate.code == code) return rate.perSecond;
        return -1;
    }

    std::chrono::nanoseconds _now = 100s;
    RecordRates _rates{[this] { return _now; }};
};

}  // namespace

TEST_F(RecordRatesTest, CountsTheFirstSecondAsAWholeOne) {
    _rates.count(0xB0C2);
    _rates.count(0xB0C2);
    EXPECT_DOUBLE_EQ(rateOf(0xB0C2), 2);
    _now += 500ms;
    EXPECT_DOUBLE_EQ(rateOf(0xB0C2), 2);
}

TEST_F(RecordRatesTest, AveragesOverTheTimeSinceTheStart) {
    for (int i = 0; i < 8; ++i) _rates.count(0xB0C2);
    _now += 4s;
    EXPECT_DOUBLE_EQ(rateOf(0xB0C2), 2);
}

TEST_F(RecordRatesTest, AveragesASteadyStreamOverTenSeconds) {
    for (int i = 0; i < 600; ++i) {  // 20 a second, for half a minute
        _rates.count(0xB0C2);
        _now += 50ms;
    }
    EXPECT_NEAR(rateOf(0xB0C2), 20, 0.5);
}

TEST_F(RecordRatesTest, ForgetsWhatIsTenSecondsOld) {
    for (int i = 0; i < 50; ++i) _rates.count(0xB0C2);
    _now += 9s;
    EXPECT_GT(rateOf(0xB0C2), 5);
    _now += 1s;
    EXPECT_DOUBLE_EQ(rateOf(0xB0C2), 0);
    _now += 1h;
    _rates.count(0xB0C2);
    EXPECT_NEAR(rateOf(0xB0C2), 0.11, 0.01);
    EXPECT_EQ(_rates.rates()[0].records, 51U);
}

TEST_F(RecordRatesTest, ListsCodesInOrderAndRecordsWithoutOneFirst) {
    for (const std::optional<LogCode> code :
         {std::optional<LogCode>(0xFF0001), std::optional<LogCode>(0xB0C2), std::optional<LogCode>()})
        _rates.count(code);
    const auto rates = _rates.rates();
    ASSERT_EQ(rates.size(), 3U);
    EXPECT_EQ(rates[0].code, std::nullopt);
    EXPECT_EQ(rates[1].code, 0xB0C2U);
    EXPECT_EQ(rates[2].code, 0xFF0001U);
}

TEST_F(RecordRatesTest, CountsCodesBeyondTheLimitAsOne) {
    for (LogCode code = 0; code < 300; ++code) _rates.count(code);
    const auto rates = _rates.rates();
    ASSERT_EQ(rates.size(), 257U);
    EXPECT_EQ(rates[0].code, std::nullopt);
    EXPECT_EQ(rates[0].records, 44U);
}
