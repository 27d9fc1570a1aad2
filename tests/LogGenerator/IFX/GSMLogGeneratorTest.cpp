#include "LogGenerator/IFX/GSMLogGenerator.h"

#include <fmt/printf.h>
#include <gtest/gtest.h>

#include "LogGenerator/AssertionFailure.h"
#include "platform/encodings/PropertyList.h"
#include "platform/system/Environment.h"
#include "tests/support/RecordingLog.h"

namespace kelvo {
namespace {

using Lines = std::vector<test::RecordingLog::Line>;

Value dict(std::initializer_list<std::pair<std::string_view, Value>> entries) { return Dictionary::make(entries); }
Value list(std::initializer_list<Value> elements) { return Array::make(elements); }
Value simplified(const Value& tree) { return GSMLogGenerator::processObject(tree); }

TEST(GSMLogGenerator, ReplacesAOneEntryDictionaryByItsValue) {
    EXPECT_EQ(simplified(dict({{"Serving", dict({{"Cell", "A"}})}})), dict({{"Serving", "A"}}));
    EXPECT_EQ(simplified(dict({{"Serving", dict({{"Cell", dict({{"ARFCN", "12"}})}})}})), dict({{"Serving", "12"}}));
    EXPECT_EQ(simplified(dict({{"Cells", list({"header", "x", dict({{"k", "y"}})})}})),
              dict({{"Cells", list({"x", "y"})}}));
}

TEST(GSMLogGenerator, KeepsTheTopAndOtherDictionaries) {
    EXPECT_EQ(simplified(dict({{"Cell", "A"}})), dict({{"Cell", "A"}}));
    const Value two = dict({{"Serving", dict({{"A", "1"}, {"B", "2"}})}, {"None", dict({})}});
    EXPECT_EQ(simplified(two), two);
    EXPECT_EQ(simplified(dict({{"Serving", dict({{"A", dict({{"x", "1"}})}, {"B", "2"}})}})),
              dict({{"Serving", dict({{"A", "1"}, {"B", "2"}})}}));
}

TEST(GSMLogGenerator, KeepsTheOrderOfKeys) {
    const Value result = simplified(dict({{"z", "1"}, {"a", dict({{"k", "2"}})}, {"m", "3"}}));
    std::string keys;
    for (const auto& [key, value] : *result.dictionary()) keys += key;
    EXPECT_EQ(keys, "zam");
}

TEST(GSMLogGenerator, DropsTheFirstElementOfEveryArray) {
    EXPECT_EQ(simplified(list({})), list({}));
    EXPECT_EQ(simplified(list({"header"})), list({}));
    EXPECT_EQ(simplified(list({"header", list({"inner", "x"}), "y"})), list({list({"x"}), "y"}));
    EXPECT_EQ(simplified(list({"header", dict({{"only", list({"a", "b"})}})})), list({list({"b"})}));
    EXPECT_EQ(simplified(list({7, "x"})), list({"x"}));  // not looked at either
}

TEST(GSMLogGenerator, SaysThatItWasMade) {
    test::RecordingLog log;
    const Environment::Scope environment({.log = &log});
    const auto generator = GSMLogGenerator::generator();
    EXPECT_EQ(log.lines(), (Lines{{4, fmt::sprintf("Creating Log object: %p", static_cast<void*>(generator.get()))}}));
}

TEST(GSMLogGenerator, LeavesTheReceivedTreeAsItIs) {
    const Value tree = dict({{"Cells", list({"header", dict({{"k", "y"}})})}});
    const Value before = tree.copy();
    simplified(tree);
    EXPECT_EQ(tree, before);
}

TEST(GSMLogGenerator, CollapsesADictionaryOfOneEntryAlone) {
    EXPECT_EQ(GSMLogGenerator::canCollapse(dict({{"k", "y"}})), Value("y"));
    EXPECT_EQ(GSMLogGenerator::canCollapse(dict({{"k", dict({{"l", "y"}})}})), dict({{"l", "y"}}));
    for (const Value& other : {dict({}), dict({{"a", "1"}, {"b", "2"}}), list({"x"}), Value("x"), Value()}) {
        EXPECT_FALSE(GSMLogGenerator::canCollapse(other));
    }
}

TEST(GSMLogGenerator, TakesTreesAsDeepAsPropertyListsReach) {
    Value chain = "leaf";
    Value nest = "leaf";
    for (int i = 0; i < 512; ++i) {
        chain = dict({{"k", chain}});
        nest = list({"header", nest});
    }
    EXPECT_EQ(simplified(chain), dict({{"k", "leaf"}}));

    Value inner = simplified(nest);
    int depth = 0;
    for (; inner.array(); ++depth) {
        ASSERT_EQ(inner.array()->size(), 1U);
        inner = Value((*inner.array())[0]);
    }
    EXPECT_EQ(depth, 512);
    EXPECT_EQ(inner, Value("leaf"));
}

class IFX : public testing::Test {
protected:
    void feed(const Value& tree) { generator.updateState(state, *writeXmlPropertyList(tree)); }
    void feedText(std::string_view text) { generator.updateState(state, bytesOf(text)); }
    std::string failureOf(std::string_view text) {
        try {
            feedText(text);
        } catch (const AssertionFailure& failure) {
            return failure.what();
        }
        return "no failure";
    }

    test::RecordingLog log;
    Environment::Scope environment{{.log = &log}};
    Dictionary state;
    GSMLogGenerator generator;
};

TEST_F(IFX, ShowsTheSimplifiedTreeAndKeepsTheReceivedOne) {
    const Value tree = dict({{"Serving", dict({{"Cell", "A"}})}, {"Band", "20"}});
    feed(tree);
    EXPECT_EQ(state["DisplayState"], tree);
    EXPECT_EQ(state["Display"], dict({{"Serving", "A"}, {"Band", "20"}}));
    EXPECT_EQ(state["ExtraInfo"], dict({}));
    EXPECT_EQ(state.size(), 3U);
}

TEST_F(IFX, ReadsEveryEncoding) {
    feedText("{ Serving = { Cell = A; }; }");
    EXPECT_EQ(state["Display"], dict({{"Serving", "A"}}));
    const std::string binary(
        "bplist00\xd1\x01\x02QaQb\x08\x0b\x0d\0\0\0\0\0\0\x01\x01\0\0\0\0\0\0\0\x03"
        "\0\0\0\0\0\0\0\0\0\0\0\0\0\0\0\x0f",
        50);
    feedText(binary);
    EXPECT_EQ(state["Display"], dict({{"a", "b"}}));
    feedText("\"a bare text\"");
    EXPECT_EQ(state["Display"], Value("a bare text"));
}

TEST_F(IFX, ShowsABareTextAsTheWholeDisplay) {
    feedText("<plist><string>A</string></plist>");
    EXPECT_EQ(state["DisplayState"], Value("A"));
    EXPECT_EQ(state["Display"], Value("A"));
    EXPECT_EQ(generator.generateLogUsingState(state), Value("A"));
}

TEST_F(IFX, ReplacesTheWholeDisplayWithEachMessage) {
    feed(dict({{"A", "1"}}));
    state["ExtraInfo"].dictionary()->set("note", "x");
    feed(dict({{"B", "2"}}));
    EXPECT_EQ(state["Display"], dict({{"B", "2"}}));
    EXPECT_EQ(state["ExtraInfo"], dict({}));
}

TEST_F(IFX, ShowsNothingBeforeTheFirstMessage) {
    EXPECT_FALSE(generator.generateLogUsingState(state));
    EXPECT_EQ(state["History"], list({dict({})}));
}

TEST_F(IFX, KeepsTheNumberBesideATextThatIsOne) {
    const Value tree =
        dict({{"Serving", dict({{"Cell", dict({{"MNC", "01"}, {"RSSI", "-71 dBm"}, {"C1", "33"}})}})},
              {"Neighbours", list({"2", dict({{"ARFCN", "70"}}), dict({{"SCN", "9"}, {"ECN0", "-4.5 dB"}})})}});
    feed(tree);
    const Value& display = state["Display"];
    const Dictionary& serving = *(*display.dictionary())["Serving"].dictionary();
    EXPECT_FALSE(serving["MNC"].measurement());
    EXPECT_EQ(serving["RSSI"].measurement()->number, -71);
    EXPECT_EQ(serving["RSSI"].measurement()->unit, "dBm");
    EXPECT_EQ(serving["C1"].measurement()->number, 33);
    EXPECT_EQ(serving["C1"].measurement()->unit, "");
    const Array& neighbors = *(*display.dictionary())["Neighbours"].array();
    EXPECT_FALSE(neighbors[0].measurement());  // a row that has lost its key
    EXPECT_EQ((*neighbors[1].dictionary())["ECN0"].measurement()->number, -4.5);

    // What is shown, told and saved are the texts as they came.
    const Value texts = dict({{"Serving", dict({{"MNC", "01"}, {"RSSI", "-71 dBm"}, {"C1", "33"}})},
                              {"Neighbours", list({"70", dict({{"SCN", "9"}, {"ECN0", "-4.5 dB"}})})}});
    EXPECT_EQ(display, texts);
    EXPECT_EQ(writeXmlPropertyList(display).value(), writeXmlPropertyList(texts).value());
    EXPECT_EQ(state["DisplayState"], tree);
}

TEST_F(IFX, SavesItsHistoryAlone) {
    EXPECT_EQ(generator.getSaveContentsFromState(state)->size(), 0U);
    feed(dict({{"A", dict({{"only", "1"}})}}));
    EXPECT_EQ(generator.generateLogUsingState(state), dict({{"A", "1"}}));
    generator.generateLogUsingState(state);
    const ArrayRef contents = generator.getSaveContentsFromState(state);
    ASSERT_EQ(contents->size(), 2U);
    const Dictionary& snapshot = *(*contents)[0].dictionary();
    EXPECT_EQ(snapshot["DisplayState"], dict({{"A", dict({{"only", "1"}})}}));
    EXPECT_EQ(snapshot["Display"], dict({{"A", "1"}}));
    contents->clear();
    EXPECT_EQ(state["History"].array()->size(), 2U);
}

TEST_F(IFX, AsksForStreamingAndNoLogCodes) {
    EXPECT_EQ(Value(generator.getStartCommand()), dict({{"SetState", "Streaming"}}));
}

TEST_F(IFX, EndsAtATypeItDoesNotKnow) {
    feed(dict({{"A", "1"}}));
    const std::pair<const char*, const char*> cases[] = {{"<integer>1</integer>", "number"},
                                                         {"<real>1.5</real>", "number"},
                                                         {"<date>2011-03-04T09:15:02Z</date>", "date"},
                                                         {"<data>AA==</data>", "data"},
                                                         {"<true/>", "boolean"}};
    for (const auto& [xml, type] : cases) {
        const std::string expected =
            "Assertion failure in processObject:, LogGenerator/GSM/GSMLogGenerator:78: "
            "Unknown object of type " +
            std::string(type) + " encountered";
        const std::string value = xml;
        for (const std::string& tree : {value, "<array><string>header</string>" + value + "</array>",
                                        "<dict><key>A</key><dict><key>B</key>" + value + "</dict></dict>"}) {
            log.clear();
            EXPECT_EQ(failureOf("<plist>" + tree + "</plist>"), expected);
            EXPECT_EQ(log.lines(), (Lines{{3, expected}}));
        }
    }
    EXPECT_EQ(state["Display"], dict({{"A", "1"}}));
}

TEST_F(IFX, EndsAtAMessageThatDoesNotParse) {
    const std::string expected =
        "Assertion failure in updateState:withData:, LogGenerator/GSM/GSMLogGenerator:90: "
        "Could not deserialize the object";
    std::string deep;
    for (int i = 0; i < 10000; ++i) deep += "<array>";
    for (const std::string& message : {std::string(), std::string("<plist><dict>"), std::string("bplist00"),
                                       std::string(40, '\x01'), "<plist>" + deep}) {
        log.clear();
        EXPECT_EQ(failureOf(message), expected);
        EXPECT_EQ(log.lines(), (Lines{{3, expected}}));
    }
    EXPECT_TRUE(state.empty());
}

}  // namespace
}  // namespace kelvo
