#include <gtest/gtest.h>

#include "overview/Observation.h"
#include "tests/overview/Shown.h"

namespace kelvo::overview {
namespace {

/// The reference pilot's level as a record's reading: its text says more than its number.
class ReferencePilot final : public Quantity {
public:
    void print(std::string& text, std::int64_t) const override { text = "(ref pilot) -9.58 dB"; }
    std::optional<Measurement> measure(std::int64_t) const override { return Measurement{-9.58, "dB"}; }
};
constexpr ReferencePilot kReferencePilot;

TEST(CdmaObservation, TheCellIsTheReferencePilot) {
    const Value pilots = shown({{"0;180", "-12.50 dB"}, {"1;240", "-19.67 dB"}}, 6);
    pilots.dictionary()->set("_sorted", Value("_sorted"));
    const Value oneX = shown({{"01;State", "Traffic [8]"},
                              {"05;Rx0 AGC", "-74.60 dBm"},
                              {"06;Rx0 Channel", "283"},
                              {"07;Rx0 Band Class", "800 MHz cellular band [0]"},
                              {"03;Traffic FER", "1.42%"}},
                             6);
    pilots.dictionary()->slot("0;180").set({.raw = 0, .quantity = &kReferencePilot}, 6);
    oneX.dictionary()->set("02;Active Set", pilots);
    const Observation seen =
        observe(Technology::CDMA,
                group({{"1;1x", oneX},
                       {"2;EV-DO", shown({{"01;Device State", "Idle [3]"}, {"02;Session State", "Open [4]"}})},
                       {"4;System", shown({{"1;Roaming Indicator", "OFF [0]"},
                                           {"2;System ID", "4110"},
                                           {"3;Network ID", "2"},
                                           {"4;Base Station ID", "50"}})}}));
    EXPECT_EQ(seen.access, "CDMA2000 1x");
    EXPECT_EQ(seen.state, "in traffic");
    EXPECT_TRUE(seen.isDedicated);
    EXPECT_EQ(seen.cell, "channel 283, PN 180");
    EXPECT_EQ(seen.cellRecord, 6u);
    EXPECT_EQ(seen.level->name, "Rx AGC");
    EXPECT_DOUBLE_EQ(seen.level->figure.number, -74.6);
    EXPECT_EQ(seen.quality->figure.text, "-9.58 dB");
    EXPECT_DOUBLE_EQ(seen.quality->figure.number, -9.58);
    EXPECT_EQ(seen.quality->grade, "good");
    EXPECT_EQ(seen.area, "SID 4110, NID 2");
    const std::vector<Fact> facts = {
        {"Band", "BC 0 (878.5 MHz down, 833.5 MHz up)"}, {"Base station", "50"}, {"EV-DO", "Idle, session Open"}};
    EXPECT_EQ(seen.serving, facts);
    ASSERT_EQ(seen.cells.size(), 1u);
    EXPECT_EQ(seen.cells[0].identity, "channel 283, PN 240");
    EXPECT_EQ(seen.cells[0].mark, "active");
    EXPECT_DOUBLE_EQ(seen.cells[0].quality->figure.number, -19.67);
    EXPECT_EQ(seen.registrationState, "OFF");
    EXPECT_EQ(seen.rates, (std::vector<Fact>{{"Traffic FER", "1.42%"}}));
    ASSERT_TRUE(seen.rates[0].figure);
    EXPECT_DOUBLE_EQ(seen.rates[0].figure->number, 1.42);
    EXPECT_EQ(seen.rates[0].figure->unit, "%");
}

TEST(CdmaObservation, AnIdlePhoneSleepsAndWakes) {
    const auto state = [](const char* label) {
        return observe(Technology::CDMA, group({{"1;1x", shown({{"01;State", label}})}})).state;
    };
    EXPECT_EQ(state("Paging [6]"), "idle");
    EXPECT_EQ(state("Slotted mode sleep state [7]"), "idle");
    EXPECT_EQ(state("Acquisition [3]"), "Acquisition");
}

TEST(CdmaObservation, ASystemOfAnotherKindIsNoArea) {
    const Value system =
        shown({{"2;System ID", "(unknown system type 0)"}, {"3;Network ID", "(unknown system type 0)"}});
    EXPECT_EQ(observe(Technology::CDMA, group({{"4;System", system}})).area, "");
}

TEST(CdmaObservation, ABadBandClassIsNone) {
    const Observation seen =
        observe(Technology::CDMA,
                group({{"1;1x", shown({{"06;Rx0 Channel", "283"}, {"07;Rx0 Band Class", "[Bad Value 0]"}})}}));
    EXPECT_EQ(seen.band, "");
    EXPECT_TRUE(seen.serving.empty());
}

}  // namespace
}  // namespace kelvo::overview
