#include <gtest/gtest.h>

#include <functional>
#include <set>

#include "LogGenerator/CDMA/C2KLogGenerator.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "tests/support/Record.h"
#include "tests/support/Subpackets.h"

namespace kelvo {
namespace {

using test::Record;
using test::Subpackets;

/// The generator over the application's own template.
class C2KTemplate : public testing::Test {
protected:
    void feed(const Record& record) { generator.updateState(state, record.bytes()); }
    const Value& shown(const char* screen, const char* key) {
        return (*(*state["Display"].dictionary())[screen].dictionary())[key];
    }

    DirectoryResources resources{KELVO_RESOURCE_DIR};
    Environment::Scope environment{{.resources = &resources}};
    C2KLogGenerator generator;
    Dictionary state;
};

TEST_F(C2KTemplate, HasAPlaceForEveryLookupKeyAndNoOther) {
    C2KLogGenerator::getDisplayFromState(state);
    std::set<std::string> bound;
    for (const auto& [key, bindings] : *state["Lookup"].dictionary()) bound.insert(key);
    EXPECT_EQ(
        bound,
        (std::set<std::string>{
            "kFingerC2I",       "kChannel",        "k1xEVDODeviceState", "kBandClass",       "kRxAGC0",
            "kRxAGC1",          "kTxAGC",          "kServingPNOffset",   "kSessionState",    "kUATI24",
            "kColorCode",       "kFLDataRate",     "k1xDeviceState",     "k1xRx0BandClass",  "k1xRx0ChanNum",
            "k1xRxAGC0",        "k1xRx1BandClass", "k1xRx1ChanNum",      "k1xRxAGC1",        "k1xTxAGC",
            "k1xActiveSetInfo", "k1xTrafficFER",   "kRLDataRate",        "kActiveSetPilots", "k1xRoamingHome",
            "kSystemId",        "kNetworkId",      "kPacketZoneId",      "kBaseId",          "kProtocolRevision"}));
}

TEST_F(C2KTemplate, SortsEveryScreenByLabelsWithAPrefix) {
    const std::function<void(const Dictionary&)> check = [&](const Dictionary& screen) {
        EXPECT_EQ(screen["_sorted"], Value("_sorted"));
        std::set<std::string> prefixes;
        std::set<std::string> labels;
        for (const auto& [key, value] : screen) {
            if (key == "_sorted") continue;
            const std::size_t semicolon = key.find(';');
            ASSERT_NE(semicolon, std::string::npos) << key;
            EXPECT_EQ(key.find(';', semicolon + 1), std::string::npos) << key;
            EXPECT_EQ(key.find('/'), std::string::npos) << key << ": would part its path";
            EXPECT_TRUE(prefixes.insert(key.substr(0, semicolon)).second) << key;
            EXPECT_TRUE(labels.insert(key.substr(semicolon + 1)).second) << key;
            if (value.dictionary()) check(*value.dictionary());
        }
    };
    check(*C2KLogGenerator::getDisplayFromState(state).dictionary());
}

TEST_F(C2KTemplate, ShowsRecordsOnTheirScreens) {
    feed(Record(0x1183, 50).u8(13, 0x2C).u8(14, 3).u8(36, 5).u8(37, 4).u8(17, 23));
    feed(Record(0x108a, 37).u8(22, 1).u16(23, 168).u16(29, 256));
    feed(Record(0x12b6, 25));
    feed(Record(0x1192, 241).u32(13, 1));
    feed(Record(0x1192, 241).u32(13, 2).u32(29, 614));  // packets of 1024 bits
    feed(Subpackets(0x119d).add(11, 25).u8(24, 1));
    feed(Record(0x134f, 186).u8(13, 2).u32(46, 2).u16(50, 4139));

    EXPECT_EQ(shown("2;EV-DO", "01;Device State"), Value("Connected [5]"));
    EXPECT_EQ(shown("2;EV-DO", "09;Channel"), Value("812"));
    EXPECT_EQ(shown("2;EV-DO", "04;Fingers"), Value(Dictionary::make({{"_sorted", "_sorted"}, {"0;168", "-3.01 dB"}})));
    EXPECT_EQ(shown("2;EV-DO", "03;Active Set"), Value("(none)"));
    EXPECT_EQ(shown("3;Rates and Errors", "1;EV-DO Forward Rate"), Value("614.00 kbps"));
    EXPECT_EQ(shown("3;Rates and Errors", "3;1x Traffic FER"), Value("1.56%"));
    EXPECT_EQ(shown("1;1x", "03;Traffic FER"), Value("1.56%"));
    EXPECT_EQ(shown("4;System", "2;System ID"), Value("4139"));
    EXPECT_EQ(shown("1;1x", "01;State"), Value(""));
}

TEST_F(C2KTemplate, ReplacesALeafByAListAndBack) {
    feed(Record(0x12b6, 37).u8(15, 1).u16(25, 12).u16(27, 512));
    EXPECT_EQ(shown("2;EV-DO", "03;Active Set"),
              Value(Dictionary::make({{"_sorted", "_sorted"}, {"0;12", "+0.00 dB"}})));
    feed(Record(0x12b6, 25));
    EXPECT_EQ(shown("2;EV-DO", "03;Active Set"), Value("(none)"));
}

TEST_F(C2KTemplate, KeepsTheRatesBookkeepingWithTheSnapshot) {
    feed(Record(0x1192, 241).u32(13, 7));
    feed(Record(0x1192, 241).u32(13, 8).u32(29, 1));
    generator.generateLogUsingState(state);
    const Dictionary& snapshot = *(*state["History"].array())[0].dictionary();
    EXPECT_EQ(snapshot["ExtraInfo"],
              Value(Dictionary::make(
                  {{"FLDataSeqNum1", 8}, {"FLDataSent1", 1024}, {"FLDataSeqNum2", 7}, {"FLDataSent2", 0}})));
}

}  // namespace
}  // namespace kelvo
