// The drive on the screens: what each record shows is held against the world that it tells of.
#include "tests/telephony/simulation/GsmComparison.h"

using namespace kelvo::simulation;
using namespace std::chrono_literals;
using kelvo::test::GsmComparison;

TEST(GsmSimulationDisplay, ShowsForTenMinutesWhatTheWorldIs) {
    gsm::Simulation modem(1);
    GsmComparison comparison(modem);
    comparison.next();
    comparison.played().clearLog();  // the display's own first lines
    while (comparison.played().time() < 10min && !testing::Test::HasFailure()) comparison.next();
    for (const auto& [level, line] : comparison.played().log()) EXPECT_NE(level, 3) << line;
}

TEST(GsmSimulationDisplay, ShowsTheWorldOfOtherSeeds) {
    for (std::uint64_t seed = 2; seed < 8; ++seed) {
        SCOPED_TRACE(seed);
        gsm::Simulation modem(seed);
        GsmComparison comparison(modem);
        while (comparison.played().time() < 1min && !testing::Test::HasFailure()) comparison.next();
    }
}
