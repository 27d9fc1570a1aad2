#include "tools/inputs/Input.h"

#include <sys/stat.h>
#include <zlib.h>

#include <thread>

#include "platform/encodings/PropertyList.h"
#include "tests/telephony/recordings/Wire.h"
#include "tests/tools/KelvoctlTest.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using namespace std::string_literals;
using test::contentsOf;
using test::expectFailure;
using test::kTicks;
using test::plainFrame;
using test::plainRecord;
using test::recordBodyOf;
using test::servingCell;
using test::operator+=;

constexpr CaptureTime kStart{std::chrono::sys_days(std::chrono::year(2023) / 12 / 6) + 4h + 4min + 26s};  // kTicks

// A serving cell in a layout of newer modems: PCI 73.
Bytes newServingCell() {
    Bytes payload(29);
    payload[0] = 3;
    payload[1] = 73;
    payload[11] = 75;
    payload[12] = 50;
    return payload;
}

struct InputTest : test::KelvoctlTest {
    struct Read {
        std::vector<Bytes> records{};
        std::vector<CaptureTime> times{};
        std::string breakOff{};  ///< empty for an input that ends as it should
        std::vector<std::string> leftOut{};
    };
    Read readAll(Input& input) {
        Read read;
        while (const auto record = input.next()) {
            read.records.emplace_back(record->bytes.begin(), record->bytes.end());
            read.times.push_back(record->time);
            EXPECT_EQ(input.count(), read.records.size());
        }
        if (input.breakOff()) read.breakOff = input.breakOff()->reason;
        EXPECT_FALSE(input.next());  // nothing comes after the end
        read.leftOut = input.leftOut();
        return read;
    }
    Read readAll(const std::string& file, std::optional<Technology> technology = {}) {
        auto input = Input::open(file, technology);
        if (!input) return {.breakOff = "not opened: " + input.error().reason};
        return readAll(*input);
    }
    std::string packed(const std::string& file, const std::string& name) {
        const std::string bytes = contentsOf(file);
        const gzFile to = gzopen(path(name).c_str(), "wb");
        gzwrite(to, bytes.data(), static_cast<unsigned>(bytes.size()));
        gzclose(to);
        return path(name);
    }
    std::string cut(const std::string& file, const std::string& name, std::size_t lessBytes) {
        const std::string bytes = contentsOf(file);
        std::ofstream(path(name), std::ios::binary) << bytes.substr(0, bytes.size() - lessBytes);
        return path(name);
    }
};

TEST_F(InputTest, GivesACapturesRecordsWithTheirTimesAndItsTechnology) {
    auto input = Input::open(capture(Technology::LTE, {servingCell(1), servingCell(2)}));
    ASSERT_TRUE(input) << input.error().reason;
    EXPECT_EQ(input->technology(), Technology::LTE);
    EXPECT_EQ(input->technologyTold(), Technology::LTE);
    EXPECT_EQ(input->kind(), RecordingKind::Capture);
    EXPECT_EQ(input->name(), path("in.pcap"));
    const Read read = readAll(*input);
    EXPECT_EQ(read.records, (std::vector<Bytes>{servingCell(1), servingCell(2)}));
    EXPECT_EQ(read.times, (std::vector<CaptureTime>{CaptureTime(0s), CaptureTime(1s)}));
    EXPECT_EQ(read.breakOff, "");
    EXPECT_TRUE(read.leftOut.empty());
}

TEST_F(InputTest, TakesTheTechnologyThatIsChosen) {
    auto input = Input::open(capture(Technology::LTE, {servingCell(1)}), Technology::GSM);
    ASSERT_TRUE(input);
    EXPECT_EQ(input->technology(), Technology::GSM);
    EXPECT_EQ(input->technologyTold(), Technology::LTE);
    EXPECT_EQ(readAll(*input).records.size(), 1U);
}

TEST_F(InputTest, GivesWhatIsGoodOfACaptureThatBreaksOffAndSaysWhere) {
    const std::string whole = capture(Technology::LTE, {servingCell(1), servingCell(2)});
    const std::string file = cut(whole, "cut.pcap", 4);
    const Read read = readAll(file);
    EXPECT_EQ(read.records, std::vector<Bytes>{servingCell(1)});
    EXPECT_EQ(read.breakOff, file +
                                 " cannot be read at packet 2: truncated dump file; tried to read 38 captured bytes, "
                                 "only got 34");
}

TEST_F(InputTest, ReadsWhatIsPackedAndSaysWhereThatBreaksOff) {
    const std::string plain = capture(Technology::LTE, {servingCell(1), servingCell(2)});
    const std::string file = packed(plain, "in.pcap.gz");
    EXPECT_EQ(readAll(file).records.size(), 2U);
    EXPECT_EQ(readAll(file).breakOff, "");
    const std::string broken = cut(file, "cut.gz", 12);
    EXPECT_NE(readAll(broken).breakOff, "");
    EXPECT_EQ(readAll(broken).breakOff.rfind(broken + " cannot be read at packet ", 0), 0U) << readAll(broken).breakOff;
}

TEST_F(InputTest, GivesFramesOfOtherToolsAsTheyAreShown) {
    Bytes frames;
    frames += plainFrame(recordBodyOf(plainRecord(0xB0C2, kTicks, newServingCell())));
    frames += plainFrame(recordBodyOf(plainRecord(0xB195, kTicks + 800, Bytes(40))));   // not one of Kelvo's
    frames += plainFrame(recordBodyOf(plainRecord(0xB0C2, kTicks + 1600, Bytes(31))));  // in no known layout
    frames += plainFrame(recordBodyOf(plainRecord(0xB0C2, kTicks + 2400, Bytes(25, 2))));
    const std::string file = directory.write("drive.frames", frames);
    auto input = Input::open(file);
    ASSERT_TRUE(input) << input.error().reason;
    EXPECT_EQ(input->technology(), Technology::LTE);
    EXPECT_EQ(input->kind(), RecordingKind::Frames);
    EXPECT_FALSE(input->technologyTold());
    const Read read = readAll(*input);
    ASSERT_EQ(read.records.size(), 2U);
    EXPECT_EQ(read.records[0].size(), 38U);  // the fixed layout
    EXPECT_EQ(read.records[0][14], 73);
    EXPECT_EQ(read.times, (std::vector<CaptureTime>{kStart, kStart + 3s}));
    EXPECT_EQ(read.breakOff, "");
    EXPECT_EQ(read.leftOut,
              std::vector<std::string>{file + ": 1 records are in layouts that cannot be shown; kelvoctl import "
                                              "--list tells which"});
}

TEST_F(InputTest, ReadsRecordsBackToBackAndSaysThatTheyBreakOff) {
    Bytes records;
    for (std::uint64_t i = 0; i < 8; ++i) records += plainRecord(0xB0C2, kTicks + 800 * i, Bytes(25, 2));
    const std::string file = cut(directory.write("drive.dlf", records), "cut.dlf", 5);
    const Read read = readAll(file);
    ASSERT_EQ(read.records.size(), 7U);
    EXPECT_EQ(read.times.back(), kStart + 6s);
    EXPECT_EQ(read.breakOff, file + " breaks off after record 7");
}

TEST_F(InputTest, RecordsBeforeTheClockWasSetHaveTheFirstTimeThatIsTold) {
    Bytes records;
    records += plainRecord(0xB0C2, 800, Bytes(25, 2));
    for (std::uint64_t i = 0; i < 4; ++i) records += plainRecord(0xB0C2, kTicks + 800 * i, Bytes(25, 2));
    const Read read = readAll(directory.write("drive.dlf", records));
    ASSERT_EQ(read.times.size(), 5U);
    EXPECT_EQ(read.times[0], kStart);
    EXPECT_EQ(read.times[4], kStart + 3s);
}

TEST_F(InputTest, GivesASnapshotsRecords) {
    kelvoctl({"decode", "--save", path("saved.kelvo"), capture(Technology::LTE, {servingCell(1), servingCell(2)})});
    auto input = Input::open(path("saved.kelvo"));
    ASSERT_TRUE(input) << input.error().reason;
    EXPECT_EQ(input->technology(), Technology::LTE);
    EXPECT_EQ(input->kind(), RecordingKind::Snapshot);
    const Read read = readAll(*input);
    EXPECT_EQ(read.records, (std::vector<Bytes>{servingCell(1), servingCell(2)}));
    ASSERT_EQ(read.times.size(), 2U);
    EXPECT_EQ(read.times[1] - read.times[0], 1s);  // two records spread over the two seconds of a refresh
}

TEST_F(InputTest, GivesACellMonitorsTreesOfASnapshot) {
    const Value tree = Dictionary::make({{"A", "1"}, {"B", "2"}});
    const Value entry = Dictionary::make({{"Date", "2011-03-04 09:15:00 +0000"}, {"DisplayState", tree}});
    const auto file = writeXmlPropertyList(
        Dictionary::make({{"Timestamp", "2011-03-04 09:15:02 +0000"}, {"Data", Array::make({entry})}}));
    auto input = Input::open(directory.write("tree.kelvo", *file));
    ASSERT_TRUE(input) << input.error().reason;
    EXPECT_EQ(input->technology(), Technology::IFX);
    const Read read = readAll(*input);
    ASSERT_EQ(read.records.size(), 1U);
    EXPECT_EQ(*readPropertyList(read.records[0]), tree);
}

TEST_F(InputTest, ReadsAPipe) {
    const std::string file = capture(Technology::LTE, {servingCell(1), servingCell(2)});
    ASSERT_EQ(::mkfifo(path("pipe").c_str(), 0600), 0);
    std::thread writer([&] { std::ofstream(path("pipe"), std::ios::binary) << contentsOf(file); });
    EXPECT_EQ(readAll(path("pipe")).records.size(), 2U);
    writer.join();
}

TEST_F(InputTest, RefusesWhatHoldsNoRecords) {
    const auto reasonOf = [](const std::string& file) {
        const auto input = Input::open(file);
        return input ? "opened" : input.error().reason;
    };
    const auto file = [this](const std::string& name, const std::string& text) {
        return directory.write(name, Bytes(text.begin(), text.end()));
    };
    EXPECT_EQ(reasonOf(path("missing")), path("missing") + " cannot be read: No such file or directory");
    EXPECT_EQ(reasonOf(directory.path().string()), directory.path().string() + " cannot be read: Is a directory");
    EXPECT_EQ(reasonOf(file("empty", "")), path("empty") + " is empty");
    EXPECT_EQ(reasonOf(file("text", "no capture at all")), path("text") + " holds no diagnostic records");
    EXPECT_EQ(reasonOf(file("new.pcapng", std::string("\x0A\x0D\x0D\x0A\x1C\0\0\0", 8))),
              path("new.pcapng") + " is a pcapng file; captures are classic pcap files (editcap -F pcap converts it)");
    EXPECT_EQ(reasonOf(file("list", "<?xml version=\"1.0\"?><plist version=\"1.0\"><dict/></plist>")),
              path("list") + " is not a snapshot: it has neither \"Timestamp\" nor \"Data\"");
    const std::string foreign = "\xD4\xC3\xB2\xA1\x02\0\x04"s + std::string(9, '\0') + "\xFF\xFF\0\0\x01\0\0\0"s;
    EXPECT_EQ(reasonOf(file("ethernet.pcap", foreign)),
              path("ethernet.pcap") + " has a link type that names no technology; --technology names one");
}

TEST_F(InputTest, CommandsReadACaptureFromStandardInput) {
    const std::string file = capture(Technology::LTE, {servingCell(1), servingCell(2)});
    EXPECT_EQ(kelvoctl({"decode", "-"}, file).output, kelvoctl({"decode", file}).output);
    EXPECT_EQ(kelvoctl({"decode", "--overview", "-"}, file).output, kelvoctl({"decode", "--overview", file}).output);
    const std::string events = kelvoctl({"events", file}).output;
    EXPECT_EQ(kelvoctl({"events", "-"}, file).output, events);
    expectFailure(kelvoctl({"events", "-"}), "standard input is empty");
    expectFailure(kelvoctl({"decode", "-", "--save", file, "--force"}, file), file + " is the file being read");
    const std::string text = directory.write("text", Bytes(30, 'x'));
    expectFailure(kelvoctl({"decode", "-"}, text), "standard input is not a pcap file: unknown file format");
}

}  // namespace
}  // namespace kelvo
