#include "LogGenerator/Base.h"

#include <gtest/gtest.h>

#include "LogGenerator/ClassIndex.h"
#include "platform/system/Environment.h"
#include "tests/support/CapturedOutput.h"
#include "tests/support/RecordingLog.h"

namespace kelvo {
namespace {

using Lines = std::vector<test::RecordingLog::Line>;

class First final : public Section<First> {
public:
    static constexpr std::string_view kSectionName = "First";
    static constexpr std::array<LogCode, 2> kLogCodes = {0x417a, 0xff0001};
    using Section::Section;
    void updateWithData(ByteView, LogCode) override {}
};

class Second final : public Section<Second> {
public:
    static constexpr std::string_view kSectionName = "Second";
    static constexpr std::array<LogCode, 3> kLogCodes = {0x7132, 0x417a, 0x7132};
    using Section::Section;
    void updateWithData(ByteView, LogCode) override {}
};

class TwoSections final : public ClassIndex {
public:
    First first{classDict, codeDictionary};
    Second second{classDict, codeDictionary};
};

TEST(Base, ConvertsEcIoAtTheEdgesOfEveryBand) {
    const std::pair<std::uint32_t, int> cases[] = {
        {0, 0},       {705, 0},     {706, -31},   {756, -31},   {757, -31},     {813, -31},   {814, -30},
        {949, -30},   {950, -29},   {1120, -29},  {1121, -28},  {1336, -28},    {1337, -27},  {1607, -27},
        {1608, -26},  {1949, -26},  {1950, -25},  {2240, -25},  {2241, -24},    {2921, -24},  {2922, -23},
        {3603, -23},  {3604, -22},  {4461, -22},  {4462, -21},  {5542, -21},    {5543, -20},  {6902, -20},
        {6903, -19},  {8615, -19},  {8616, -18},  {10771, -18}, {10772, -17},   {13486, -17}, {13487, -16},
        {16903, -16}, {16904, -15}, {21205, -15}, {21206, -14}, {26621, -14},   {26622, -13}, {33440, -13},
        {33441, -12}, {42023, -12}, {42024, -11}, {52830, -11}, {52831, -10},   {66435, -10}, {66436, -9},
        {83562, -9},  {83563, -8},  {105123, -8}, {105124, -7}, {132268, -7},   {132269, -6}, {166441, -6},
        {166442, -5}, {209463, -5}, {209464, -4}, {263624, -4}, {263625, -3},   {331808, -3}, {331809, -2},
        {417647, -2}, {417648, -1}, {524287, -1}, {524288, 0},  {4294967295, 0}};
    for (const auto& [raw, decibel] : cases) EXPECT_EQ(Base::lookUpECNO(raw), decibel) << raw;
}

TEST(Base, ReplacesRowsAsAWhole) {
    const ArrayRef rows = Array::make({"old", "older"});
    Base::replaceArray(rows, {Value("new")});
    EXPECT_EQ(Value(rows), Value(Array::make({"new"})));
    Base::clearElementsInArray(rows);
    EXPECT_TRUE(rows->empty());
    Base::replaceArray(nullptr, {Value("nowhere")});
    Base::clearElementsInArray(nullptr);
}

TEST(ClassIndex, FindsSectionsByNameAndByLogCode) {
    TwoSections index;
    EXPECT_EQ(index.getClass("First"), &index.first);
    EXPECT_EQ(index.getClass("Second"), &index.second);
    EXPECT_EQ(index.getClass("Third"), nullptr);
    EXPECT_EQ(*index.getSubscribers(0x417a), (CodeDictionary::Subscribers{&index.first, &index.second}));
    EXPECT_EQ(*index.getSubscribers(0xff0001), (CodeDictionary::Subscribers{&index.first}));
    EXPECT_EQ(index.getSubscribers(0x0001), nullptr);
}

TEST(ClassIndex, SubscribesASectionTwiceThatListsACodeTwice) {
    TwoSections index;
    EXPECT_EQ(*index.getSubscribers(0x7132), (CodeDictionary::Subscribers{&index.second, &index.second}));
}

TEST(ClassIndex, NamesEveryCodeOnceInDecimal) {
    const TwoSections index;
    EXPECT_EQ(index.getAllLogCodes(), (std::vector<LogCode>{0x417a, 0xff0001, 0x7132}));
}

TEST(ClassIndex, WritesItsProgressToTheLog) {
    test::RecordingLog log;
    const Environment::Scope environment({.log = &log});
    TwoSections index;
    index.status();
    index.first.updateSectionRef(Dictionary::make());
    EXPECT_EQ(
        log.lines(),
        (Lines{{4, "Array Count: 2"}, {4, "Array Count: 3"}, {4, "Dictionary = 1"}, {4, "String = 0"}, {4, "First"}}));
}

TEST(ClassIndex, SaysOnStandardOutputThatItGoes) {
    const test::CapturedOutput output;
    {
        const Environment::Scope environment({.standardOutput = output.file()});
        const TwoSections index;
    }
    EXPECT_EQ(output.text(), "Deallocing ClassIndex\n");
}

}  // namespace
}  // namespace kelvo
