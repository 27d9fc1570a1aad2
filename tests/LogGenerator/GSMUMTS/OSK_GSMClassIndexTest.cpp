#include "LogGenerator/GSMUMTS/OSK_GSMClassIndex.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "platform/system/Environment.h"
#include "tests/support/RecordingLog.h"

namespace kelvo {
namespace {

struct Row {
    const char* name;
    std::vector<LogCode> codes;
};

const std::vector<Row> kSections = {
    {"Active Set", {0x417a}},
    {"Coding Scheme", {}},
    {"GPRS Information", {0x51f5, 0x7135, 0x51f6, 0x51fb, 0x51fd, 0x51f4, 0x5137}},
    {"GSM Serving Cell", {0x5134, 0x5137, 0x5076, 0xff0001}},
    {"Mobile Allocation", {0x51f8}},
    {"Neighboring Cells", {0x5137, 0x51ff, 0xff0001}},
    {"PDP Context Info", {0xff0002}},
    {"Process PS", {0x7130, 0x7132}},
    {"UMTS RR Measurement", {}},
    {"Cell Change Counters", {}},
    {"Detected Set", {0x417a}},
    {"GSM Set", {0x4005}},
    {"Non-Ranked GSM Set", {}},
    {"Process CO", {0x7131, 0x7132}},
    {"Serving PLMN", {0x7135, 0x7132, 0xff0001}},
    {"UMTS Set", {0x4005, 0xff0001}},
    {"Equivalent PLMN List", {0x7150}},
    {"GSM RR Info", {0x512c, 0x5137, 0x5072, 0x51f6}},
    {"Monitored Set", {0x417a}},
    {"Non-Ranked UMTS Set", {}},
    {"Process CS", {0x7131, 0x7132}},
    {"UMTS RR Info", {0x4125, 0x4031, 0x4127, 0x4157, 0xff0001}},
    {"BLER", {0x4116}},
    {"Virtual Active Set", {0x417a}},
    {"SIM Info", {0xff0000}},
    {"HSDPA Info", {0x4221}},
};

std::vector<std::string> subscribers(const ClassIndex& index, LogCode code) {
    std::vector<std::string> names;
    if (const auto* sections = index.getSubscribers(code)) {
        for (const Base* section : *sections) names.emplace_back(section->getSectionName());
    }
    return names;
}

TEST(OSK_GSMClassIndex, HoldsItsSectionsByNameWithTheirCodes) {
    const OSK_GSMClassIndex index;
    EXPECT_EQ(index.getAllNames().size(), 26U);
    for (const Row& row : kSections) {
        const Base* section = index.getClass(row.name);
        ASSERT_NE(section, nullptr) << row.name;
        const auto codes = section->getLogCodeArray();
        EXPECT_EQ(std::vector<LogCode>(codes.begin(), codes.end()), row.codes) << row.name;
    }
}

TEST(OSK_GSMClassIndex, SaysOfEachSectionInTurnHowManyCodesItHas) {
    test::RecordingLog log;
    const Environment::Scope environment({.log = &log});
    const OSK_GSMClassIndex index;
    std::vector<test::RecordingLog::Line> expected;
    for (int codes : {1, 0, 7, 4, 1, 3, 1, 2, 0, 0, 1, 1, 0, 2, 3, 2, 1, 4, 1, 0, 2, 5, 1, 1, 1, 1}) {
        expected.emplace_back(4, "Array Count: " + std::to_string(codes));
    }
    EXPECT_EQ(log.lines(), expected);
}

TEST(OSK_GSMClassIndex, OffersARecordToItsSectionsInTheirOrder) {
    const OSK_GSMClassIndex index;
    for (const Row& row : kSections) {
        for (LogCode code : row.codes) {
            std::vector<std::string> expected;
            for (const Row& other : kSections) {
                if (std::count(other.codes.begin(), other.codes.end(), code) > 0) expected.emplace_back(other.name);
            }
            EXPECT_EQ(subscribers(index, code), expected) << code;
        }
    }
    EXPECT_EQ(subscribers(index, 0x417a),
              (std::vector<std::string>{"Active Set", "Detected Set", "Monitored Set", "Virtual Active Set"}));
    EXPECT_EQ(index.getSubscribers(0x4222), nullptr);
}

}  // namespace
}  // namespace kelvo
