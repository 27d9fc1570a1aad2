#include "platform/encodings/PropertyList.h"
#include "tests/tools/KelvoctlTest.h"

namespace kelvo {
namespace {

using test::contentsOf;
using test::expectFailure;
using test::Finished;
using test::KelvoctlTest;
using test::servingCell;

struct DecodeCommand : KelvoctlTest {
    nlohmann::ordered_json servingSection(std::vector<std::string> arguments) {
        return json(std::move(arguments))["display"]["Serving Cell Info"];
    }
};

std::vector<std::string> keysOf(const nlohmann::ordered_json& object) {
    std::vector<std::string> keys;
    for (const auto& [key, value] : object.items()) keys.push_back(key);
    return keys;
}

TEST_F(DecodeCommand, ShowsWhatTheLastMessagesGave) {
    const auto shown =
        servingSection({"decode", "--json", capture(Technology::LTE, {servingCell(301), servingCell(302)})});
    EXPECT_EQ(shown["Physical Cell ID"], "302");
    EXPECT_EQ(shown["Download Frequency"], "5780");
    EXPECT_EQ(shown["Download Bandwidth"], "10 MHz");
    EXPECT_EQ(shown["Upload Bandwidth"], "5 MHz");
}

TEST_F(DecodeCommand, PrintsTheTreeWithAlignedValues) {
    const Finished done = kelvoctl({"decode", capture(Technology::LTE, {servingCell(301)})});
    EXPECT_EQ(done.status, 0);
    EXPECT_EQ(done.errors, "");
    EXPECT_EQ(done.output.find("Serving Cell Info\n"
                               "  Physical Cell ID     301\n"
                               "  Cell Identity        77\n"
                               "  Tracking Area Code   4566\n"),
              0U);
    EXPECT_EQ(done.output.find("Creating"), std::string::npos);
}

TEST_F(DecodeCommand, JsonHasThreeKeysAndTheLogOnlyWhenAsked) {
    const std::string file = capture(Technology::LTE, {servingCell(1), servingCell(2)});
    const auto plain = json({"decode", "--json", file});
    EXPECT_EQ(keysOf(plain), (std::vector<std::string>{"technology", "messages", "display"}));
    EXPECT_EQ(plain["technology"], "LTE");
    EXPECT_EQ(plain["messages"], 2);

    const auto logged = json({"decode", "--json", "--log", file});
    EXPECT_EQ(keysOf(logged), (std::vector<std::string>{"technology", "messages", "display", "log"}));
    const auto wanted = nlohmann::ordered_json::array({4, "LTE Serving Cell Info"});
    EXPECT_EQ(std::count(logged["log"].begin(), logged["log"].end(), wanted), 2);
}

TEST_F(DecodeCommand, TellsTheRecordBehindEachValueWhenAsked) {
    // 179 / 4 - 140 is -95.25; records a second apart, without a time of their own.
    const Bytes measured = test::Record(0xB17F, 33).u32(21, 179).u32(29, 32 << 13).bytes();
    const std::string file = capture(Technology::LTE, {servingCell(301), measured, servingCell(302), servingCell(303)});
    const auto display = json({"decode", "--json", "--provenance", file})["display"];
    EXPECT_EQ(display["Serving Cell Measurements"]["Measured RSRP"].dump(),
              R"({"text":"-95.25 dBm","number":-95.25,"unit":"dBm","code":"0xb17f","record":2,"age":2.0})");
    EXPECT_EQ(display["Serving Cell Measurements"]["S Intra Search"].dump(),
              R"({"text":"Not Present","code":"0xb17f","record":2,"age":2.0})");
    EXPECT_EQ(display["Serving Cell Info"]["Physical Cell ID"].dump(),
              R"({"text":"303","number":303,"code":"0xb0c2","record":4,"age":0.0})");
    EXPECT_EQ(display["Serving Cell Info"]["Num Tx Antennas"].dump(), R"({"text":"–"})");
    EXPECT_EQ(display["Measured Neighbor Cells"].dump(), "[]");
}

TEST_F(DecodeCommand, LeavesTheMarksOfAnOrderAloneAndWantsJsonForProvenance) {
    const std::string file = capture(Technology::CDMA, {test::Record(0x1183, 50).bytes()});
    const auto display = json({"decode", "--json", "--provenance", file})["display"];
    EXPECT_EQ(display["_sorted"], "_sorted");
    EXPECT_EQ(display["2;EV-DO"]["08;Rx1 AGC"]["record"], 1);
    const Finished done = kelvoctl({"decode", "--provenance", file});
    EXPECT_EQ(done.status, 1);
    EXPECT_NE(done.errors.find("--json"), std::string::npos) << done.errors;
}

TEST_F(DecodeCommand, TextHasTheLogBeforeTheTree) {
    const Finished done = kelvoctl({"decode", "--log", capture(Technology::LTE, {servingCell(301)})});
    const std::size_t line = done.output.find("[4] LTE Serving Cell Info\n");
    const std::size_t tree = done.output.find("\nServing Cell Info\n");
    ASSERT_NE(line, std::string::npos);
    ASSERT_NE(tree, std::string::npos);
    EXPECT_LT(line, tree);
    EXPECT_EQ(done.output.find("\n[", tree), std::string::npos);
}

TEST_F(DecodeCommand, TellsOfAnInvalidLogTypeInTheLog) {
    Bytes message = servingCell(1);
    message[0] = 254;
    const auto logged = json({"decode", "--json", "--log", capture(Technology::LTE, {message})});
    const auto wanted = nlohmann::ordered_json::array({3, "Invalid log type: fe. Dropping."});
    EXPECT_EQ(std::count(logged["log"].begin(), logged["log"].end(), wanted), 1);
}

TEST_F(DecodeCommand, ACaptureWithoutMessagesHasNoDisplay) {
    const std::string file = capture(Technology::LTE, {});
    const auto plain = json({"decode", "--json", file});
    EXPECT_EQ(plain["messages"], 0);
    EXPECT_TRUE(plain["display"].is_null());
    EXPECT_EQ(kelvoctl({"decode", file}).output, "Kelvo  (unknown)\n");
}

TEST_F(DecodeCommand, TheNamedTechnologyOverridesTheLinkType) {
    const std::string file = capture(Technology::CDMA, {servingCell(301)});
    const auto decoded = json({"decode", "--technology", "lte", "--json", file});
    EXPECT_EQ(decoded["technology"], "LTE");
    EXPECT_EQ(decoded["display"]["Serving Cell Info"]["Physical Cell ID"], "301");
}

TEST_F(DecodeCommand, RefusesAnotherLinkTypeUnlessATechnologyIsNamed) {
    std::string bytes = contentsOf(capture(Technology::LTE, {servingCell(301)}));
    bytes[20] = 1;
    const std::string file = directory.write("ethernet.pcap", bytesOf(bytes));
    expectFailure(kelvoctl({"decode", file}),
                  file + " has a link type that names no technology; --technology names one");
    EXPECT_EQ(servingSection({"decode", "--technology", "lte", "--json", file})["Physical Cell ID"], "301");
}

TEST_F(DecodeCommand, SaysInOneLineWhyAFileCannotBeRead) {
    expectFailure(kelvoctl({"decode", path("none.pcap")}),
                  path("none.pcap") + " cannot be opened: No such file or directory");
    const std::string text = directory.write("text", bytesOf("no capture at all"));
    expectFailure(kelvoctl({"decode", text}), text + " is not a pcap file: unknown file format");
}

TEST_F(DecodeCommand, ShowsTheGoodPartOfATruncatedCaptureAndTellsWhereItBreaksOff) {
    std::string bytes = contentsOf(capture(Technology::LTE, {servingCell(1), servingCell(2), servingCell(3)}));
    bytes.resize(bytes.size() - 5);
    const std::string file = directory.write("cut.pcap", bytesOf(bytes));
    const Finished done = kelvoctl({"decode", "--json", "--save", path("out.kelvo"), file});
    EXPECT_EQ(done.status, 1);
    const auto shown = nlohmann::ordered_json::parse(done.output, nullptr, false);
    ASSERT_FALSE(shown.is_discarded()) << done.output;
    EXPECT_EQ(shown["messages"], 2);
    EXPECT_EQ(shown["display"]["Serving Cell Info"]["Physical Cell ID"], "2");
    EXPECT_EQ(done.errors.find("kelvoctl: " + file + " cannot be read at packet 3: "), 0U);
    EXPECT_EQ(std::count(done.errors.begin(), done.errors.end(), '\n'), 1);
    EXPECT_TRUE(std::filesystem::exists(path("out.kelvo")));
}

TEST_F(DecodeCommand, ShowsNothingOfACaptureWithoutAGoodPacket) {
    std::string bytes = contentsOf(capture(Technology::LTE, {servingCell(1)}));
    bytes.pop_back();
    const std::string file = directory.write("cut.pcap", bytesOf(bytes));
    const Finished done = kelvoctl({"decode", file});
    EXPECT_EQ(done.status, 1);
    EXPECT_EQ(done.output, "");
    EXPECT_EQ(done.errors.find("kelvoctl: " + file + " cannot be read at packet 1: "), 0U);
}

TEST_F(DecodeCommand, WarnsWhenNoRecordIsOfTheFamily) {
    const std::string file = capture(Technology::LTE, std::vector<Bytes>(1498, test::Record(0x1234, 20).bytes()));
    const Finished done = kelvoctl({"decode", file});
    EXPECT_EQ(done.status, 0);
    EXPECT_NE(done.output.find("Serving Cell Info\n"), std::string::npos);
    EXPECT_EQ(done.errors, "kelvoctl: " + file + ": none of 1,498 records is of this family\n");
}

TEST_F(DecodeCommand, WarnsWhenTheNamedTechnologyIsNotTheLinkTypes) {
    const auto errors = [this](std::vector<Bytes> messages, const char* technology) {
        const Finished done = kelvoctl({"decode", "--technology", technology, capture(Technology::LTE, messages)});
        EXPECT_EQ(done.status, 0);
        return done.errors;
    };
    const std::string start = "kelvoctl: " + path("in.pcap") + ": ";
    EXPECT_EQ(errors({servingCell(1)}, "lte"), "");
    EXPECT_EQ(errors({}, "gsm"), "");
    EXPECT_EQ(errors({servingCell(1)}, "gsm"),
              start + "none of 1 record is of this family; the link type says LTE, not GSM\n");
    const Bytes gsm = test::Record(0x5134, 30).bytes();
    const Bytes ofNoKind = {2, 30, 0, 0x34, 0x51, 0, 0, 0, 0, 0, 0, 0, 0, 0};  // log type 2: nobody takes it
    EXPECT_EQ(errors({servingCell(1), gsm, ofNoKind}, "gsm"),
              start + "1 of 3 records is of this family; the link type says LTE, not GSM\n");
}

TEST_F(DecodeCommand, TellsWhichRecordEndsTheProgramAndWhy) {
    const auto message = [](std::string_view text) { return Bytes(text.begin(), text.end()); };
    const std::string file = capture(Technology::IFX, {message("<plist><string>fine</string></plist>"),
                                                       message("<plist><array><string/><true/></array></plist>")});
    const Finished done = kelvoctl({"decode", "--json", "--log", file});
    EXPECT_EQ(done.status, 1);
    EXPECT_EQ(done.output, "");
    EXPECT_EQ(done.errors.find("kelvoctl: packet 2 of " + file + " ends the program: "), 0U);
    EXPECT_NE(done.errors.find("Unknown object of type"), std::string::npos);
    EXPECT_EQ(std::count(done.errors.begin(), done.errors.end(), '\n'), 1);
}

TEST_F(DecodeCommand, RefusesWhatItDoesNotKnow) {
    const std::string file = capture(Technology::LTE, {});
    expectFailure(kelvoctl({"decode", "--technology", "5g", file}),
                  "unknown technology 5g: there are ifx, gsm, cdma, lte and utran");
    expectFailure(kelvoctl({"decode", "--fast", file}),
                  "The following argument was not expected: --fast (kelvoctl --help tells what there is)");
    expectFailure(kelvoctl({"decode"}), "FILE is required (kelvoctl --help tells what there is)");
    for (const char* count : {"0", "1.5", "many", "-1"}) {
        expectFailure(kelvoctl({"decode", "--refresh-every", count, file}),
                      std::string("--refresh-every: ") + count +
                          " is not a whole number from 1 (kelvoctl --help tells what there is)");
    }
}

TEST_F(DecodeCommand, RebuildsAtTheEndOnlyUnlessAsked) {
    const std::string file = capture(Technology::LTE, {servingCell(1), servingCell(2), servingCell(3), servingCell(4)});
    const auto entries = [&](std::vector<std::string> options) {
        options.insert(options.begin(), {"decode", "--save", path("out.kelvo"), "--force", file});
        EXPECT_EQ(kelvoctl(options).status, 0);
        const std::string bytes = contentsOf(path("out.kelvo"));
        return (*readPropertyList(bytesOf(bytes))->dictionary())["Data"].array()->size() - 1;  // less the DLF
    };
    EXPECT_EQ(entries({}), 1U);
    EXPECT_EQ(entries({"--refresh-every", "3"}), 2U);
    EXPECT_EQ(entries({"--refresh-every", "2"}), 3U);
    EXPECT_EQ(entries({"--refresh-every", "1"}), 5U);
}

TEST_F(DecodeCommand, SavesTheHistoryAndTheDlfWithAnEmptyDescription) {
    const Bytes message = servingCell(301);
    EXPECT_EQ(kelvoctl({"decode", "--save", path("out.kelvo"), capture(Technology::LTE, {message})}).status, 0);
    const std::string bytes = contentsOf(path("out.kelvo"));
    EXPECT_EQ(bytes.find("<?xml"), 0U);
    const auto file = readPropertyList(bytesOf(bytes));
    ASSERT_TRUE(file);
    const Dictionary& snapshot = *file->dictionary();
    EXPECT_EQ(snapshot["Description"], Value(""));
    EXPECT_EQ(snapshot["Timestamp"].string()->substr(19), " +0000");
    const Array& data = *snapshot["Data"].array();
    ASSERT_EQ(data.size(), 2U);
    EXPECT_EQ((*data[0].dictionary())["DisplayState"], Value(message));
    EXPECT_EQ((*data[1].dictionary())["Description"], Value("DLF binary (198 bytes)"));  // 161 + 38 - 1
    const Bytes& dlf = *(*data[1].dictionary())["DLF"].data();
    EXPECT_EQ(std::string(dlf.begin() + 16, dlf.begin() + 22), "Kelvo ");  // and the version that the window would name
}

TEST_F(DecodeCommand, SaysWhyASnapshotCannotBeSaved) {
    const Finished done = kelvoctl({"decode", "--save", path("none/out"), capture(Technology::LTE, {servingCell(1)})});
    expectFailure(done, path("none/out") + " cannot be written: No such file or directory");
}

TEST_F(DecodeCommand, ReplacesNoSnapshotUnlessForcedAndNeverTheCapture) {
    const std::string file = capture(Technology::LTE, {servingCell(1)});
    const std::string before = contentsOf(file);
    const std::string earlier = directory.write("out.kelvo", bytesOf("earlier"));
    expectFailure(kelvoctl({"decode", "--save", earlier, file}), earlier + " exists already; --force replaces it");
    EXPECT_EQ(contentsOf(earlier), "earlier");
    EXPECT_EQ(kelvoctl({"decode", "--save", earlier, "--force", file}).status, 0);
    EXPECT_EQ(contentsOf(earlier).find("<?xml"), 0U);

    std::filesystem::create_hard_link(file, path("again.pcap"));
    expectFailure(kelvoctl({"decode", "--save", path("again.pcap"), "--force", file}),
                  path("again.pcap") + " is the file being read");
    EXPECT_EQ(contentsOf(file), before);
    expectFailure(kelvoctl({"decode", "--force", file}),
                  "--force requires --save (kelvoctl --help tells what there is)");
}

TEST_F(DecodeCommand, PrintsTheStartCommand) {
    const Finished done = kelvoctl({"start-command", "--technology", "lte"});
    EXPECT_EQ(done.status, 0);
    const auto command = readPropertyList(bytesOf(done.output));
    ASSERT_TRUE(command);
    EXPECT_EQ((*command->dictionary())["SetState"], Value("Streaming"));
    const Array& codes = *(*command->dictionary())["SetOskraLogCodes"].array();
    EXPECT_EQ(std::count(codes.begin(), codes.end(), Value(0xB0C2)), 1);
    EXPECT_TRUE((*command->dictionary())["SetPlExtraCodes"].array());
}

TEST_F(DecodeCommand, HelpTellsOfEveryCommandOnStandardOutput) {
    const Finished done = kelvoctl({"--help"});
    EXPECT_EQ(done.status, 0);
    for (const char* command : {"decode", "watch", "snapshot", "start-command"}) {
        EXPECT_NE(done.output.find(command), std::string::npos) << command;
        EXPECT_NE(kelvoctl({command, "--help"}).output.find("Example"), std::string::npos) << command;
    }
}

}  // namespace
}  // namespace kelvo
