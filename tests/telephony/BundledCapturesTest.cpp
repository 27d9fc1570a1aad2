#include <gtest/gtest.h>

#include <filesystem>

#include "platform/host/Capture.h"
#include "telephony/SimulationStream.h"

using namespace kelvo;

namespace {

class BundledCaptures : public testing::TestWithParam<Technology> {
protected:
    std::filesystem::path path() const {
        return std::filesystem::path(KELVO_CAPTURES) / (std::string(namesOf(GetParam()).word) + ".pcap");
    }
};

INSTANTIATE_TEST_SUITE_P(Families, BundledCaptures,
                         testing::Values(Technology::IFX, Technology::GSM, Technology::CDMA, Technology::LTE,
                                         Technology::UTRAN),
                         [](const auto& info) { return std::string(namesOf(info.param).name); });

}  // namespace

// One that differs was made by an older simulation: resources/make-captures makes it anew.
TEST_P(BundledCaptures, HoldTheFirstMinutesOfTheirSimulation) {
    auto capture = CaptureReader::open(path());
    ASSERT_TRUE(capture) << capture.error().reason;
    EXPECT_EQ(capture->technology(), GetParam());
    SimulationStream simulation(GetParam(), 1);
    CaptureTime first;
    CaptureTime last;
    for (int count = 0;; ++count) {
        const auto packet = capture->next();
        ASSERT_TRUE(packet) << packet.error().reason;
        if (!*packet) break;
        const auto simulated = simulation.next();
        if (count == 0) first = simulated->time;
        last = simulated->time;
        ASSERT_EQ((*packet)->time, std::chrono::floor<std::chrono::microseconds>(simulated->time)) << count;
        ASSERT_EQ(Bytes((*packet)->bytes.begin(), (*packet)->bytes.end()),
                  Bytes(simulated->bytes.begin(), simulated->bytes.end()))
            << count;
    }
    EXPECT_GE(last - first, std::chrono::minutes(3));
    EXPECT_LE(last - first, std::chrono::minutes(6));
}

TEST_P(BundledCaptures, AreSmall) { EXPECT_LT(std::filesystem::file_size(path()), 300'000U); }
