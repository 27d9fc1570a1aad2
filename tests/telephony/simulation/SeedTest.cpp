#include <gtest/gtest.h>

#include "platform/telephony/Technology.h"
#include "telephony/simulation/MakeSimulation.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace std::chrono_literals;

namespace {

class Seed : public testing::TestWithParam<Technology> {
protected:
    static Bytes minuteOf(std::uint64_t seed) {
        const auto modem = makeSimulation(GetParam(), seed);
        Bytes all;
        for (auto message = modem->next(); message.time < 1min; message = modem->next()) {
            all.insert(all.end(), message.bytes.begin(), message.bytes.end());
        }
        return all;
    }
};

TEST_P(Seed, GivesTheSameBytesEveryTimeAndAnotherSeedOthers) {
    const Bytes minute = minuteOf(5);
    EXPECT_EQ(minuteOf(5), minute);
    EXPECT_NE(minuteOf(6), minute);
}

INSTANTIATE_TEST_SUITE_P(OfEveryFamily, Seed,
                         testing::Values(Technology::IFX, Technology::GSM, Technology::CDMA, Technology::LTE,
                                         Technology::UTRAN),
                         [](const auto& family) { return std::string(namesOf(family.param).name); });

}  // namespace
