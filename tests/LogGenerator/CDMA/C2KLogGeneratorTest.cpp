#include "LogGenerator/CDMA/C2KLogGenerator.h"

#include <fmt/printf.h>
#include <gtest/gtest.h>

#include "LogGenerator/Factory.h"
#include "platform/telephony/TelephonyConstants.h"
#include "tests/support/C2KScreen.h"
#include "tests/support/FakeResources.h"

namespace kelvo {
namespace {

using test::C2KScreen;
using test::Lines;
using test::Record;

class C2KGeneratorState : public testing::Test {
protected:
    C2KGeneratorState() { installTemplate(); }

    void installTemplate() {
        resources.dictionaries["C2KTemplate"] =
            Dictionary::make({{"EV-DO", Dictionary::make({{"Channel", "kChannel"}})}});
    }
    Lines lines() {
        Lines taken = log.lines();
        log.clear();
        return taken;
    }
    std::string channel() {
        const DictionaryRef screen = (*state["Display"].dictionary())["EV-DO"].dictionary();
        return *(*screen)["Channel"].string();
    }

    test::RecordingLog log;
    test::FakeResources resources;
    Environment::Scope environment{{.log = &log, .resources = &resources}};
    Dictionary state;
};

Record status(std::uint32_t channel) { return Record(0x1183, 50).u8(13, channel); }

Bytes joined(std::initializer_list<Bytes> parts) {
    Bytes whole;
    for (const Bytes& part : parts) whole.insert(whole.end(), part.begin(), part.end());
    return whole;
}

Bytes prefixed(const Record& record) { return joined({{0x81, 0x55}, record.bytes()}); }

TEST_F(C2KGeneratorState, BeginsWithALineAboutItsGenerator) {
    const auto generator = C2KLogGenerator::generator();
    EXPECT_EQ(lines(), (Lines{{4, fmt::sprintf("Creating Log object: %p", static_cast<void*>(generator.get()))}}));
}

TEST_F(C2KGeneratorState, BelongsToTheGeneratorOfItsTechnology) {
    const auto generator = generatorFromTechnology(kPLLogChannelTechnology_Oskra_CDMA);
    EXPECT_NE(dynamic_cast<C2KLogGenerator*>(generator.get()), nullptr);
    EXPECT_EQ(generatorFromTechnology("kPLLogChannelTechnology_Oskra_CDM"), nullptr);
}

TEST_F(C2KGeneratorState, IsFedByTheEightCodesOfTheStartCommandInTheirOrder) {
    EXPECT_EQ(*C2KLogGenerator().getStartCommand(),
              *Dictionary::make({{"SetState", "Streaming"},
                                 {"SetOskraLogCodes", Array::make({4234, 4483, 4498, 4790, 4508, 4509, 4734, 4943})}}));
}

TEST_F(C2KGeneratorState, MakesScreensAndBindingsOfTheTemplate) {
    const DictionaryRef content = Dictionary::make({
        {"_sorted", "_sorted"},
        {"1;Levels", Dictionary::make({{"Rx", "kRxAGC0"}, {"_sorted", "_sorted"}, {"Tx", "kTxAGC"}})},
        {"Rx again", "kRxAGC0"},
        {"Number", 5},
        {"Switch", true},
        {"List", Array::make({"kTxAGC"})},
        {"Raw", Bytes{1}},
        {"Empty", Dictionary::make()},
    });
    const DictionaryRef display = Dictionary::make();
    Dictionary lookup;
    C2KLogGenerator::processTemplate(*content, display, lookup);

    EXPECT_EQ(*display,
              *Dictionary::make({{"_sorted", "_sorted"},
                                 {"1;Levels", Dictionary::make({{"Rx", ""}, {"_sorted", "_sorted"}, {"Tx", ""}})},
                                 {"Rx again", ""},
                                 {"Empty", Dictionary::make()}}));
    const DictionaryRef levels = (*display)["1;Levels"].dictionary();
    ASSERT_EQ(lookup.size(), 2U);
    const Array& receivers = *lookup["kRxAGC0"].array();
    ASSERT_EQ(receivers.size(), 2U);
    EXPECT_EQ(receivers[0], Value(Dictionary::make({{"key", "Rx"}, {"dict", levels}})));
    EXPECT_EQ((*receivers[0].dictionary())["dict"].dictionary(), levels);
    EXPECT_EQ((*receivers[1].dictionary())["dict"].dictionary(), display);
    EXPECT_EQ(lookup["kTxAGC"].array()->size(), 1U);
    // One line for each dictionary, the empty one as well.
    EXPECT_EQ(lines(), Lines(3, {4, "Processing the template"}));
}

TEST_F(C2KGeneratorState, HasADisplayFromTheFirstCallOn) {
    const Value display = C2KLogGenerator::getDisplayFromState(state);
    EXPECT_EQ(*display.dictionary(), *Dictionary::make({{"EV-DO", Dictionary::make({{"Channel", ""}})}}));
    EXPECT_EQ(state["Display"].dictionary(), display.dictionary());
    EXPECT_EQ(state["Template"].dictionary(), resources.dictionaries["C2KTemplate"]);
    EXPECT_EQ(state["ExtraInfo"], Value(Dictionary::make()));
    EXPECT_EQ(state["Lookup"].dictionary()->size(), 1U);
    EXPECT_EQ(C2KLogGenerator::getDisplayFromState(state).dictionary(), display.dictionary());
    EXPECT_EQ(resources.loads, 1);
}

TEST_F(C2KGeneratorState, IsAskedForItsTemplateFirst) {
    state.set("Template", Dictionary::make({{"Rate", "kFLDataRate"}}));
    EXPECT_EQ(C2KLogGenerator::getDisplayFromState(state), Value(Dictionary::make({{"Rate", ""}})));
    EXPECT_EQ(resources.loads, 0);
}

TEST_F(C2KGeneratorState, StaysWithoutADisplayUntilTheTemplateLoads) {
    resources.dictionaries.clear();
    C2KLogGenerator generator;
    log.clear();
    generator.updateState(state, status(5).bytes());
    EXPECT_EQ(lines(), (Lines{{3, "Cannot load C2K template for display"}}));
    EXPECT_FALSE(generator.generateLogUsingState(state));
    EXPECT_EQ(lines(), (Lines{{3, "Cannot load C2K template for display"}}));
    EXPECT_EQ(state["DisplayState"], Value(status(5).bytes()));
    EXPECT_FALSE(state["Lookup"]);

    installTemplate();
    generator.updateState(state, status(6).bytes());
    EXPECT_EQ(channel(), "6");
}

TEST_F(C2KGeneratorState, GoesOnUnderAnotherGenerator) {
    C2KLogGenerator().updateState(state, status(5).bytes());
    const DictionaryRef display = state["Display"].dictionary();
    C2KLogGenerator another;
    another.updateState(state, status(6).bytes());
    EXPECT_EQ(state["Display"].dictionary(), display);
    EXPECT_EQ(channel(), "6");
}

TEST_F(C2KGeneratorState, TakesTheRawPacketsSinceTheLastRefresh) {
    C2KLogGenerator generator;
    generator.updateState(state, status(5).bytes());
    generator.updateState(state, prefixed(status(6)));
    const Value display = generator.generateLogUsingState(state);
    EXPECT_EQ(display.dictionary(), state["Display"].dictionary());
    EXPECT_EQ(state["DisplayState"], Value(joined({status(5).bytes(), status(6).bytes()})));
    generator.generateLogUsingState(state);
    EXPECT_EQ(state["DisplayState"], Value(Bytes()));
    EXPECT_EQ(state["History"].array()->size(), 2U);
}

TEST_F(C2KGeneratorState, KeepsSnapshotsOutOfReachOfTheLiveDisplay) {
    C2KLogGenerator generator;
    generator.updateState(state, status(5).bytes());
    generator.generateLogUsingState(state);
    generator.updateState(state, status(6).bytes());
    const Dictionary& snapshot = *(*state["History"].array())[0].dictionary();
    EXPECT_EQ(snapshot["Display"], Value(Dictionary::make({{"EV-DO", Dictionary::make({{"Channel", "5"}})}})));
    EXPECT_EQ(channel(), "6");
}

TEST(C2KLogGenerator, IgnoresWhatIsTooShortForAPacket) {
    C2KScreen screen;
    for (std::size_t size = 0; size < 13; ++size) {
        screen.feed(status(5).cut(size));
        screen.feed(Bytes(size, 0x81));
    }
    EXPECT_EQ(screen.log(), Lines{});
    EXPECT_EQ(screen.rawLog(), Bytes());
}

TEST(C2KLogGenerator, IgnoresCodesThatWereNotAskedFor) {
    C2KScreen screen;
    for (const LogCode code : {0x1184U, 0x0000U, 0x8310U, 0xFFFFU}) screen.feed(Record(code, 13));
    EXPECT_EQ(screen.log(), Lines{});
    EXPECT_EQ(screen.rawLog(), Bytes());
    EXPECT_TRUE(screen.display->empty());
}

TEST(C2KLogGenerator, ReportsAWrongLogTypeAndDecodesAllTheSame) {
    C2KScreen screen;
    const Record record = status(5).u8(0, 0);
    screen.feed(record);
    EXPECT_EQ(screen.log(), (Lines{{3, "Invalid log type: 0. Dropping."}}));
    EXPECT_EQ(screen["kChannel"], "5");
    EXPECT_EQ(screen.rawLog(), record.bytes());
    screen.feed(status(6).u8(0, 254));
    EXPECT_EQ(screen.log(), (Lines{{3, "Invalid log type: fe. Dropping."}}));
    EXPECT_EQ(screen["kChannel"], "6");
}

TEST(C2KLogGenerator, TakesAnExtendedCodeForNoneOfItsOwn) {
    C2KScreen screen(status(5).u8(0, 255));
    EXPECT_EQ(screen.log(), (Lines{{3, "Invalid log type: ff. Dropping."}}));
    EXPECT_TRUE(screen.display->empty());
    EXPECT_EQ(screen.rawLog(), Bytes());
}

TEST(C2KLogGenerator, LooksAtTheTypeBehindThePrefix) {
    C2KScreen screen;
    screen.feed(prefixed(status(5)));
    EXPECT_EQ(screen["kChannel"], "5");
    EXPECT_EQ(screen.log(), Lines{});
    EXPECT_EQ(screen.rawLog(), status(5).bytes());
    screen.feed(Bytes{0x81, 0, 0x81, 0, 0, 0x83, 0x11, 0, 0, 0, 0, 0, 0});
    EXPECT_EQ(screen.log(), (Lines{{3, "Invalid log type: 81. Dropping."},
                                   {3, "Log code 0x1183 is 11 bytes long but should be 50 bytes."}}));
    EXPECT_EQ(screen.rawLog().size(), 11U);
}

struct Minimum {
    LogCode code;
    std::size_t bytes;
    const char* before;
    const char* after;
};

// clang-format off
constexpr Minimum kMinimums[] = {
    { 0x108a,   23, "Log code 0x108a is ", " bytes long but must be at least 23 bytes."   },
    { 0x1183,   50, "Log code 0x1183 is ", " bytes long but should be 50 bytes."          },
    { 0x1192,  241, "Log code 0x1192 is ", " bytes long but must be at least 241 bytes."  },
    { 0x12b6,   25, "Log code 0x12b6 is ", " bytes long but must be at least 25 bytes."   },
    { 0x119c,   17, "Log code 0x119c is ", " bytes long but must be at least 17 bytes."   },
    { 0x119d,   17, "Log code 0x119d is ", " bytes long but must be at least 17 bytes."   },
    { 0x127e, 1750, "Log code 0x127e is ", " bytes long but must be at least 1750 bytes." },
    { 0x134f,  171, "Log code 0x134f is ", " bytes long but must be at least 171 bytes."  },
};
// clang-format on

TEST(C2KLogGenerator, ReportsAndKeepsEveryShortRecordOfEveryCode) {
    for (const Minimum& minimum : kMinimums) {
        const Record whole(minimum.code, minimum.bytes);
        for (std::size_t size = 13; size < minimum.bytes; ++size) {
            C2KScreen screen;
            screen.feed(whole.cut(size));
            ASSERT_EQ(screen.log(), (Lines{{3, minimum.before + std::to_string(size) + minimum.after}}));
            ASSERT_TRUE(screen.display->empty()) << size;
            ASSERT_EQ(screen.state.size(), 1U) << "ExtraInfo alone";
            ASSERT_EQ(screen.rawLog(), whole.cut(size));
        }
    }
}

TEST(C2KLogGenerator, DoesNotReportTheLengthOfAWholeRecord) {
    for (const Minimum& minimum : kMinimums) {
        C2KScreen screen(Record(minimum.code, minimum.bytes));
        for (const auto& [level, text] : screen.log()) {
            EXPECT_EQ(text.find(" bytes long"), std::string::npos) << text;
        }
    }
}

TEST(C2KLogGenerator, ReadsNothingOutsideARecordWhateverItCounts) {
    for (const Minimum& minimum : kMinimums) {
        for (std::size_t size = 13; size <= minimum.bytes + 2; ++size) {
            Record record(minimum.code, size);
            for (std::size_t at = 13; at < size; ++at) record.u8(at, 0xFF);
            const Bytes bytes = record.bytes();
            C2KScreen screen;
            screen.feed(bytes);
            screen.feed(bytes);
            ASSERT_EQ(screen.rawLog(), joined({bytes, bytes}));
        }
    }
}

}  // namespace
}  // namespace kelvo
