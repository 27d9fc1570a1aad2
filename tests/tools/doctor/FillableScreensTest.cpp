#include "tools/doctor/FillableScreens.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace kelvo {
namespace {

using Names = std::vector<std::string>;

FillableScreens of(Technology technology, const wire::Ranges& ranges) {
    for (FillableScreens& screens : fillableScreens(ranges)) {
        if (screens.technology == technology) return screens;
    }
    ADD_FAILURE() << "the family is missing";
    return {};
}

bool has(const Names& names, const std::string& name) { return std::ranges::find(names, name) != names.end(); }

TEST(FillableScreens, AreToldOfFourFamilies) {
    std::vector<Technology> told;
    for (const FillableScreens& screens : fillableScreens(wire::Ranges{})) told.push_back(screens.technology);
    EXPECT_EQ(told, (std::vector{Technology::GSM, Technology::CDMA, Technology::LTE, Technology::UTRAN}));
}

TEST(FillableScreens, AreAllOfThemWhereTheModemHasEverything) {
    wire::Ranges ranges;
    ranges.fill(0x1000);
    for (const FillableScreens& screens : fillableScreens(ranges)) {
        EXPECT_FALSE(screens.filled.empty());
        EXPECT_EQ(screens.partly, Names());
        EXPECT_EQ(screens.empty, Names());
    }
}

TEST(FillableScreens, AreNoneWhereTheModemHasNothing) {
    for (const FillableScreens& screens : fillableScreens(wire::Ranges{})) {
        EXPECT_EQ(screens.filled, Names());
        EXPECT_EQ(screens.partly, Names());
        EXPECT_FALSE(screens.empty.empty());
    }
}

TEST(FillableScreens, OfLteDependOnTheItemsOfEquipment11) {
    wire::Ranges ranges{};
    ranges[0xB] = 0x180;  // up to 0xb17f: neither 0xb180 nor 0xb186
    const FillableScreens lte = of(Technology::LTE, ranges);
    EXPECT_TRUE(has(lte.filled, "Serving Cell Measurements"));
    EXPECT_TRUE(has(lte.empty, "Neighbor Cells List"));
    EXPECT_TRUE(has(lte.phone, "SIM Info"));
    ranges[0xB] = 0xC2;  // 0xb0c1 alone, of the two that the serving cell has
    EXPECT_TRUE(has(of(Technology::LTE, ranges).partly, "Serving Cell Info"));
}

TEST(FillableScreens, OfCdmaAreTheRecordsThatItAsksFor) {
    wire::Ranges ranges{};
    ranges[1] = 0x34F;  // all but 0x134f
    const FillableScreens cdma = of(Technology::CDMA, ranges);
    EXPECT_EQ(cdma.filled, (Names{"1x", "1x Traffic FER", "EV-DO Fingers", "EV-DO Session", "EV-DO Active Set",
                                  "EV-DO Forward Rate", "EV-DO Reverse Rate"}));
    EXPECT_EQ(cdma.empty, (Names{"System Identification"}));
}

}  // namespace
}  // namespace kelvo
