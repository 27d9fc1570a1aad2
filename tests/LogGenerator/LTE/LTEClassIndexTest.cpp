#include "LogGenerator/LTE/LTEClassIndex.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

using Names = std::vector<std::string>;

struct Row {
    const char* name;
    std::vector<LogCode> codes;
};

const std::vector<Row> kSections = {
    {"Serving Cell Info", {0xB0C2, 0xB0C1, 0xFF0001}},
    {"Connected mode LTE Intra-frequency Measurement", {0xB179}},
    {"Measured Neighbor Cells", {0xB179}},
    {"Detected Cells", {0xB179}},
    {"Serving Cell Measurements", {0xB17F}},
    {"Neighbor Measurements", {0xB180}},
    {"Neighbor Cells List", {0xB180}},
    {"Reselection Candidates", {0xB186}},
    {"Reselection Candidates List", {0xB186}},
    {"SIM Info", {0xFF0000}},
    {"PDP Context Info", {0xFF0002}},
};

Names subscribers(const ClassIndex& index, LogCode code) {
    Names names;
    if (const auto* sections = index.getSubscribers(code)) {
        for (const Base* section : *sections) names.emplace_back(section->getSectionName());
    }
    return names;
}

TEST(LTEClassIndex, HoldsItsSectionsByNameWithTheirCodes) {
    const LTEClassIndex index;
    EXPECT_EQ(index.getAllNames().size(), 11U);
    for (const Row& row : kSections) {
        const Base* section = index.getClass(row.name);
        ASSERT_NE(section, nullptr) << row.name;
        const auto codes = section->getLogCodeArray();
        EXPECT_EQ(std::vector<LogCode>(codes.begin(), codes.end()), row.codes) << row.name;
    }
}

TEST(LTEClassIndex, OffersARecordToItsSectionsInTheirOrder) {
    const LTEClassIndex index;
    EXPECT_EQ(subscribers(index, 0xB179),
              (Names{"Connected mode LTE Intra-frequency Measurement", "Measured Neighbor Cells", "Detected Cells"}));
    EXPECT_EQ(subscribers(index, 0xB180), (Names{"Neighbor Measurements", "Neighbor Cells List"}));
    EXPECT_EQ(subscribers(index, 0xB186), (Names{"Reselection Candidates", "Reselection Candidates List"}));
    EXPECT_EQ(subscribers(index, 0xFF0001), Names{"Serving Cell Info"});
    EXPECT_EQ(subscribers(index, 0xFF0000), Names{"SIM Info"});
    EXPECT_EQ(subscribers(index, 0xFF0002), Names{"PDP Context Info"});
}

TEST(LTEClassIndex, LeavesTheHsdpaRecordToTheGsmSections) {
    const LTEClassIndex index;
    EXPECT_EQ(index.getSubscribers(0x4221), nullptr);
    EXPECT_EQ(index.getClass("HSDPA Info"), nullptr);
}

}  // namespace
}  // namespace kelvo
