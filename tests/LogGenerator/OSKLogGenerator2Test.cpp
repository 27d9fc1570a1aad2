#include "LogGenerator/OSKLogGenerator2.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <stdexcept>

#include "LogGenerator/UnknownDataException.h"
#include "platform/system/Environment.h"
#include "tests/support/FakeResources.h"
#include "tests/support/Record.h"
#include "tests/support/RecordingLog.h"

namespace kelvo {
namespace {

using test::Record;

/// Shows the size of what it was handed, under the code.
template <class Derived>
class Echo : public Section<Derived> {
public:
    using Section<Derived>::Section;
    void updateWithData(ByteView data, LogCode logCode) override {
        if (this->values()) this->values()->set(std::to_string(logCode), std::to_string(data.size()));
    }
};

class Cell final : public Echo<Cell> {
public:
    static constexpr std::string_view kSectionName = "Cell";
    static constexpr std::array<LogCode, 2> kLogCodes = {0xB0C2, 0xff0010};
    using Echo::Echo;
};

class Power final : public Echo<Power> {
public:
    static constexpr std::string_view kSectionName = "Power";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xB0C2};
    using Echo::Echo;
};

class Broken final : public Section<Broken> {
public:
    static constexpr std::string_view kSectionName = "Broken";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xB0C2};
    using Section::Section;
    void updateWithData(ByteView, LogCode) override { throw LogCode_0xFF0000::UnknownDataException(); }
};

class Sections final : public ClassIndex {
    Cell cell{classDict, codeDictionary};
    Broken broken{classDict, codeDictionary};
    Power power{classDict, codeDictionary};
};

class Generator final : public OSKLogGenerator2 {
public:
    Generator() : OSKLogGenerator2("Test", std::make_unique<Sections>()) {}
};

class TemplateGenerator : public testing::Test {
protected:
    TemplateGenerator() {
        resources.dictionaries["Test"] =
            Dictionary::make({{"Group", Dictionary::make({{"Cell", Dictionary::make({{"45250", "–"}})}})},
                              {"Power", Dictionary::make({})},
                              {"Broken", Array::make({"row"})}});
    }

    DictionaryRef display() { return state["Display"].dictionary(); }
    std::string cellShows(const char* code) {
        const Value& shown = (*(*(*display())["Group"].dictionary())["Cell"].dictionary())[code];
        return shown.string() != nullptr ? *shown.string() : "(absent)";
    }
    bool logged(int level, const std::string& text) {
        return std::count(log.lines().begin(), log.lines().end(), test::RecordingLog::Line(level, text)) > 0;
    }

    test::FakeResources resources;
    test::RecordingLog log;
    Environment::Scope environment{{.log = &log, .resources = &resources}};
    Dictionary state;
    Generator generator;
};

TEST_F(TemplateGenerator, OffersARecordToEverySubscriberInOrder) {
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    EXPECT_EQ(cellShows("45250"), "38");
    EXPECT_EQ(*(*(*display())["Power"].dictionary())["45250"].string(), "38");  // behind the one that threw
}

TEST_F(TemplateGenerator, StripsThePrefixForSectionsButKeepsItInTheRawLog) {
    Bytes message = Record(0xB0C2, 38).bytes();
    message.insert(message.begin(), {0x81, 0x07});
    generator.updateState(state, message);
    EXPECT_EQ(cellShows("45250"), "38");
    generator.generateLogUsingState(state);
    EXPECT_EQ(*state["DisplayState"].data(), message);
}

TEST_F(TemplateGenerator, HandsOnAnElevenBytePacketOfAThirteenByteMessage) {
    Bytes message = Record(0xB0C2, 11).bytes();
    message.insert(message.begin(), {0x81, 0x00});
    generator.updateState(state, message);
    EXPECT_EQ(cellShows("45250"), "11");
}

TEST_F(TemplateGenerator, DropsShortMessagesSilently) {
    generator.updateState(state, Record(0xB0C2, 12).bytes());
    generator.updateState(state, Bytes{0x81});
    generator.updateState(state, Bytes{});
    EXPECT_EQ(cellShows("45250"), "–");
    EXPECT_FALSE(logged(3, "Invalid log type: 81. Dropping."));
}

TEST_F(TemplateGenerator, TakesLogTypesOneAndTwoHundredFiftyFiveAlone) {
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    generator.updateState(state, Record(0xB0C2, 40).u8(0, 254).bytes());
    EXPECT_TRUE(logged(3, "Invalid log type: fe. Dropping."));
    generator.updateState(state, Record(0xB0C2, 42).u8(0, 0).bytes());
    EXPECT_TRUE(logged(3, "Invalid log type: 0. Dropping."));
    EXPECT_EQ(cellShows("45250"), "38");
    EXPECT_EQ(*(*(*display())["Power"].dictionary())["45250"].string(), "38");
    generator.updateState(state, Record(0x0010, 20).u8(0, 255).bytes());
    EXPECT_EQ(cellShows("16711696"), "20");  // 0xff0010
}

TEST_F(TemplateGenerator, KeepsAPacketOfAnotherLogTypeInTheRawLog) {
    Bytes expected;
    for (const std::uint32_t type : {254U, 0U}) {
        const Bytes packet = Record(0xB0C2, 38).u8(0, type).bytes();
        generator.updateState(state, packet);
        expected.insert(expected.end(), packet.begin(), packet.end());
    }
    generator.generateLogUsingState(state);
    EXPECT_EQ(*state["DisplayState"].data(), expected);
}

TEST_F(TemplateGenerator, KeepsARecordThatNobodySubscribedToInTheRawLog) {
    const Bytes packet = Record(0x1234, 16).bytes();
    generator.updateState(state, packet);
    generator.generateLogUsingState(state);
    EXPECT_EQ(*state["DisplayState"].data(), packet);
}

TEST_F(TemplateGenerator, HandsOutTheDisplayFromTheSecondCallOn) {
    EXPECT_FALSE(generator.generateLogUsingState(state));
    ASSERT_TRUE(display());
    EXPECT_EQ(generator.generateLogUsingState(state).dictionary(), display());
    EXPECT_EQ(resources.loads, 1);
}

TEST_F(TemplateGenerator, StartsTheRawLogAnewAtEveryRebuild) {
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    generator.generateLogUsingState(state);
    EXPECT_EQ(state["DisplayState"].data()->size(), 38U);
    generator.generateLogUsingState(state);
    EXPECT_TRUE(state["DisplayState"].data()->empty());
    EXPECT_EQ(state["History"].array()->size(), 2U);
}

TEST_F(TemplateGenerator, DecodesWhatItsRawLogHasNoRoomForAndCountsIt) {
    generator.limitRawLog(100);
    for (int i = 0; i < 4; ++i) generator.updateState(state, Record(0xB0C2, 38).bytes());
    generator.updateState(state, Record(0xB0C2, 24).bytes());  // this one fits
    generator.updateState(state, Record(0xB0C2, 39).bytes());
    EXPECT_EQ(cellShows("45250"), "39");
    generator.generateLogUsingState(state);
    EXPECT_EQ(state["DisplayState"].data()->size(), 100U);
    EXPECT_TRUE(logged(3, "The raw log was full: it lacks 3 records"));
    log.clear();
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    generator.generateLogUsingState(state);
    EXPECT_EQ(state["DisplayState"].data()->size(), 38U);
    EXPECT_FALSE(logged(3, "The raw log was full: it lacks 3 records"));
}

TEST_F(TemplateGenerator, ForgetsTheRecordsThatANewLimitHasNoRoomFor) {
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    generator.limitRawLog(37);
    generator.generateLogUsingState(state);
    EXPECT_TRUE(state["DisplayState"].data()->empty());
}

TEST_F(TemplateGenerator, LeavesTheTemplateItselfUntouched) {
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    const Value& placeholder =
        (*(*(*state["Template"].dictionary())["Group"].dictionary())["Cell"].dictionary())["45250"];
    EXPECT_EQ(*placeholder.string(), "–");
    EXPECT_EQ(cellShows("45250"), "38");
}

TEST_F(TemplateGenerator, CreatesExtraInfoWithTheDisplay) {
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    ASSERT_TRUE(state["ExtraInfo"].dictionary());
    EXPECT_TRUE(state["ExtraInfo"].dictionary()->empty());
}

TEST_F(TemplateGenerator, SaysForEveryPacketThatTheTemplateIsMissing) {
    resources.dictionaries.clear();
    log.clear();
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    EXPECT_EQ(std::count(log.lines().begin(), log.lines().end(),
                         test::RecordingLog::Line(3, "Cannot load template for display")),
              2);
    EXPECT_FALSE(generator.generateLogUsingState(state));
    EXPECT_EQ(state["DisplayState"].data()->size(), 76U);  // nothing that arrived is lost
}

TEST_F(TemplateGenerator, BindsASectionNamedTwiceToThePlaceProcessedLast) {
    resources.dictionaries["Test"] = Dictionary::make({{"A", Dictionary::make({{"Cell", Dictionary::make()}})},
                                                       {"B", Dictionary::make({{"Cell", Dictionary::make()}})}});
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    EXPECT_TRUE((*(*display())["A"].dictionary())["Cell"].dictionary()->empty());
    EXPECT_EQ((*(*display())["B"].dictionary())["Cell"].dictionary()->size(), 1U);
}

TEST_F(TemplateGenerator, RefusesATemplateWithNumbers) {
    for (const Value& odd : {Value(7), Value(true), Value(Bytes{1}), Value(Date{}), Value()}) {
        log.clear();
        EXPECT_THROW(generator.processTemplate(Dictionary::make({{"Cell", odd}})), std::invalid_argument);
        EXPECT_EQ(log.lines(), (std::vector<test::RecordingLog::Line>{{3, "Received an object of unknown type"},
                                                                      {4, "Processing the template"},
                                                                      {4, "Cell"}}));  // bound before it is stored
        EXPECT_THROW(generator.processTemplate(Array::make({odd})), std::invalid_argument);
        EXPECT_FALSE(generator.processTemplate(odd));
    }
}

TEST_F(TemplateGenerator, ChecksAProcessedNode) {
    log.clear();
    generator.printDict(Dictionary::make({{"a", Array::make({"text", Dictionary::make()})}}));
    EXPECT_TRUE(log.lines().empty());
    generator.printDict(Dictionary::make({{"a", Array::make({7})}}));
    EXPECT_TRUE(logged(3, "Received an object of unknown type"));
}

TEST_F(TemplateGenerator, TakesOverTheDisplayOfItsPredecessor) {
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    const DictionaryRef before = display();
    Generator successor;
    successor.updateState(state, Record(0xB0C2, 40).bytes());
    EXPECT_EQ(display(), before);
    EXPECT_EQ(cellShows("45250"), "40");
}

TEST_F(TemplateGenerator, TakesNothingInsideASectionForAnothersPart) {
    const DictionaryRef likeASection = Dictionary::make();
    const DictionaryRef power = Dictionary::make();
    state.set("Display", Dictionary::make({{"Power", power},
                                           {"Broken", Array::make()},
                                           {"Cell", Dictionary::make({{"Power", likeASection}})}}));
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    EXPECT_EQ(*(*power)["45250"].string(), "38");
    EXPECT_TRUE(likeASection->empty());
}

TEST_F(TemplateGenerator, DoesNotCountAKeyInsideASectionAsAPlace) {
    const DictionaryRef foreign = Dictionary::make(
        {{"Broken", Array::make()}, {"Cell", Dictionary::make({{"Power", Dictionary::make()}, {"45250", "kept"}})}});
    state.set("Display", foreign);
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    EXPECT_EQ(*(*(*foreign)["Cell"].dictionary())["45250"].string(), "kept");
}

TEST_F(TemplateGenerator, LeavesTheDisplayOfAnotherTechnologyAlone) {
    const DictionaryRef foreign = Dictionary::make({{"Cell", Dictionary::make({{"45250", "kept"}})}});
    state.set("Display", foreign);
    generator.updateState(state, Record(0xB0C2, 38).bytes());
    EXPECT_EQ(*(*(*foreign)["Cell"].dictionary())["45250"].string(), "kept");
    EXPECT_EQ(generator.generateLogUsingState(state).dictionary(), foreign);
}

TEST_F(TemplateGenerator, AsksForItsSectionsCodesEachOnce) {
    const Value expected = Dictionary::make({{"SetState", "Streaming"},
                                             {"SetOskraLogCodes", Array::make({0xB0C2})},
                                             {"SetPlExtraCodes", Array::make({0x0010})}});
    EXPECT_EQ(Value(generator.getStartCommand()), expected);
}

TEST_F(TemplateGenerator, SendsAnEmptyListOfExtendedCodesRatherThanNone) {
    class OrdinaryOnly final : public ClassIndex {
        Power power{classDict, codeDictionary};
    };
    OSKLogGenerator2 ordinary("Test", std::make_unique<OrdinaryOnly>());
    const DictionaryRef command = ordinary.getStartCommand();
    ASSERT_TRUE((*command)["SetPlExtraCodes"].array());
    EXPECT_TRUE((*command)["SetPlExtraCodes"].array()->empty());
}

TEST_F(TemplateGenerator, LogsItsLifeInOrder) {
    log.clear();
    { const Generator other; }
    std::vector<std::string> texts;
    for (const auto& [level, text] : log.lines()) {
        texts.push_back(std::to_string(level) + " " + text.substr(0, text.find(" 0x")));
    }
    EXPECT_EQ(texts, (std::vector<std::string>{"4 Array Count: 2", "4 Array Count: 1", "4 Array Count: 1",
                                               "3 Creating OSKLogGenerator2 object with", "4 Creating Log object:",
                                               "3 Class Index: 1", "4 OSK_GSMLogGenerator is destructed"}));
}

TEST_F(TemplateGenerator, LogsTheBuildingOfTheDisplay) {
    log.clear();
    generator.generateLogUsingState(state);
    std::vector<std::string> texts;
    for (const auto& [level, text] : log.lines()) {
        texts.push_back(std::to_string(level) + " " + text.substr(0, text.find(" 0x")));
    }
    EXPECT_EQ(texts, (std::vector<std::string>{"4 Initialized class index:", "4 Dictionary = 1", "4 String = 0",
                                               "4 Cell", "4 Power", "4 Broken"}));
}

}  // namespace
}  // namespace kelvo
