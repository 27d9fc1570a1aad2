#include <zlib.h>

#include "tests/telephony/recordings/Wire.h"
#include "tests/tools/KelvoctlTest.h"

namespace kelvo {
namespace {

using test::contentsOf;
using test::expectFailure;
using test::Finished;
using test::KelvoctlTest;
using test::kTicks;
using test::plainFrame;
using test::plainRecord;
using test::recordBodyOf;
using test::operator+=;

/// A payload whose bytes are zero but for those given: offset and value.
Bytes payload(std::size_t size, std::initializer_list<std::pair<std::size_t, int>> bytes) {
    Bytes payload(size);
    for (const auto& [at, value] : bytes) payload[at] = static_cast<std::uint8_t>(value);
    return payload;
}

// The serving cell as newer modems word it: PCI 73, channels 1825 and 19825, 75 and 50 resource blocks, band 3.
const Bytes kNewServingCell = payload(
    29, {{0, 3}, {1, 73}, {3, 0x21}, {4, 0x07}, {7, 0x71}, {8, 0x4D}, {11, 75}, {12, 50}, {13, 77}, {17, 9}, {19, 3}});

struct ImportCommand : KelvoctlTest {
    std::string frames(const std::string& name, const std::vector<Bytes>& records) {
        Bytes bytes;
        for (const Bytes& record : records) bytes += plainFrame(recordBodyOf(record));
        return directory.write(name, bytes);
    }
    std::string out() { return path("out.pcap"); }
    /// The times, in seconds after the first, and codes of a capture's packets.
    std::string packetsOf(const std::string& file) {
        auto reader = CaptureReader::open(file);
        if (!reader) return reader.error().reason;
        std::string text;
        std::optional<CaptureTime> first;
        for (;;) {
            const auto packet = reader->next();
            if (!packet) return packet.error().reason;
            if (!*packet) return text;
            if (!first) first = (*packet)->time;
            char line[32];
            std::snprintf(line, sizeof line, "%s%lld:%x", text.empty() ? "" : " ",
                          static_cast<long long>(((*packet)->time - *first) / std::chrono::seconds(1)),
                          (*packet)->bytes[3] | (*packet)->bytes[4] << 8);
            text += line;
        }
    }
};

TEST_F(ImportCommand, TurnsAStreamOfFramesIntoACapture) {
    const std::string in =
        frames("drive.frames", {plainRecord(0xB0C2, kTicks, kNewServingCell), plainRecord(0xB195, kTicks, Bytes(40)),
                                plainRecord(0xB0C2, kTicks + 800, Bytes(25, 2))});
    const Finished done = kelvoctl({"import", in, "-o", out()});
    EXPECT_EQ(done.status, 0) << done.errors;
    EXPECT_EQ(done.errors, "");
    EXPECT_EQ(done.output, "2 LTE records written to " + out() + ": 1 passed, 1 adapted; 0 refused, 1 of others\n");
    EXPECT_EQ(packetsOf(out()), "0:b0c2 1:b0c2");
}

TEST_F(ImportCommand, ShowsNewerLayoutsOnTheScreens) {
    const std::string in = frames("drive.frames", {plainRecord(0xB0C2, kTicks, kNewServingCell)});
    kelvoctl({"import", in, "-o", out()});
    const auto shown = json({"decode", "--json", out()})["display"]["Serving Cell Info"];
    EXPECT_EQ(shown["Physical Cell ID"], "73");
    EXPECT_EQ(shown["Download Frequency"], "1825");
    EXPECT_EQ(shown["Upload Frequency"], "19825");
    EXPECT_EQ(shown["Download Bandwidth"], "15 MHz");
    EXPECT_EQ(shown["Upload Bandwidth"], "10 MHz");
    EXPECT_EQ(shown["Cell Identity"], "77");
    EXPECT_EQ(shown["Freq Band Indicator"], "3");
}

TEST_F(ImportCommand, MergesFilesByTimeAndGivesTheSameTwice) {
    const std::string one =
        frames("one", {plainRecord(0xB0C2, kTicks, Bytes(25, 2)), plainRecord(0xB0C2, kTicks + 4 * 800, Bytes(25, 2))});
    Bytes dlf = plainRecord(0xB0C1, kTicks + 2 * 800, payload(9, {{0, 1}}));
    dlf += plainRecord(0xB0C1, kTicks + 6 * 800, payload(9, {{0, 1}}));
    const std::string two = directory.write("two", dlf);
    EXPECT_EQ(kelvoctl({"import", one, two, "-o", out()}).status, 0);
    EXPECT_EQ(packetsOf(out()), "0:b0c2 2:b0c1 4:b0c2 6:b0c1");
    EXPECT_EQ(kelvoctl({"import", one, two, "-o", path("again.pcap")}).status, 0);
    EXPECT_EQ(contentsOf(out()), contentsOf(path("again.pcap")));
}

TEST_F(ImportCommand, TakesTheTimeBeforeWhereAClockWasNotSet) {
    const std::string in =
        frames("drive",
               {plainRecord(0xB0C2, 800, Bytes(25, 2)), plainRecord(0xB0C2, kTicks, Bytes(25, 2)),
                plainRecord(0xB0C1, 1600, payload(9, {{0, 1}})), plainRecord(0xB0C2, kTicks + 3 * 800, Bytes(25, 2))});
    EXPECT_EQ(kelvoctl({"import", in, "-o", out()}).status, 0);
    EXPECT_EQ(packetsOf(out()), "0:b0c2 0:b0c2 0:b0c1 3:b0c2");
}

TEST_F(ImportCommand, TakesTheTechnologyWithMostRecordsOrTheOneAskedFor) {
    const std::string in =
        frames("drive", {plainRecord(0xB0C2, kTicks, Bytes(25, 2)), plainRecord(0x7131, kTicks + 800, Bytes(3, 1)),
                         plainRecord(0x7130, kTicks + 1600, Bytes(3, 1))});
    EXPECT_EQ(kelvoctl({"import", in, "-o", out()}).status, 0);
    EXPECT_EQ(packetsOf(out()), "0:7131 1:7130");
    EXPECT_EQ(kelvoctl({"import", in, "-o", path("lte.pcap"), "--technology", "lte"}).status, 0);
    EXPECT_EQ(packetsOf(path("lte.pcap")), "0:b0c2");
    expectFailure(kelvoctl({"import", in, "-o", path("cdma.pcap"), "--technology", "cdma"}),
                  "there is no CDMA record that was asked for; --list tells what there is");
    EXPECT_FALSE(std::filesystem::exists(path("cdma.pcap")));
}

TEST_F(ImportCommand, TakesTheTimesAskedFor) {
    const std::string in = frames(
        "drive", {plainRecord(0xB0C2, kTicks, Bytes(25, 2)),  // 2023-12-06 04:04:26
                  plainRecord(0xB0C2, kTicks + 800, Bytes(25, 2)), plainRecord(0xB0C2, kTicks + 1600, Bytes(25, 2))});
    EXPECT_EQ(
        kelvoctl({"import", in, "-o", out(), "--from", "2023-12-06T04:04:27Z", "--to", "2023-12-06T04:04:28Z"}).output,
        "1 LTE records written to " + out() + ": 1 passed, 0 adapted; 0 refused, 2 of others\n");
    EXPECT_EQ(kelvoctl({"import", in, "-o", path("day.pcap"), "--from", "2023-12-06", "--to", "2023-12-07"}).status, 0);
    EXPECT_EQ(packetsOf(path("day.pcap")), "0:b0c2 1:b0c2 2:b0c2");
    // As the list tells them: the first record is as late as 26 s, not later.
    EXPECT_EQ(kelvoctl({"import", in, "-o", path("late.pcap"), "--from", "2023-12-06T04:04:26.001Z"}).status, 0);
    EXPECT_EQ(packetsOf(path("late.pcap")), "0:b0c2 1:b0c2");
    EXPECT_EQ(kelvoctl({"import", in, "-o", path("all.pcap"), "--from", "0001-01-01", "--to", "9999-12-31"}).status, 0);
    for (const char* text : {"yesterday", "2023-12-06T04:04:26.Z", "2023-12-06T04:04:26.1", "2023-12-06T04:04:26x1Z"}) {
        const Finished wrong = kelvoctl({"import", in, "-o", path("x"), "--from", text});
        EXPECT_EQ(wrong.status, 1);
        EXPECT_NE(wrong.errors.find(std::string(text) + " is not a time such as 2014-08-29T20:51:07Z"),
                  std::string::npos);
    }
}

TEST_F(ImportCommand, TakesOneSim) {
    const auto wrapped = [](int subscription, const Bytes& record) {
        Bytes body = {0x98, 1, 0, 0, static_cast<std::uint8_t>(subscription), 0, 0, 0};
        body += recordBodyOf(record);
        return plainFrame(body);
    };
    Bytes bytes = wrapped(2, plainRecord(0xB0C2, kTicks, Bytes(25, 2)));
    bytes += wrapped(1, plainRecord(0xB0C1, kTicks + 800, payload(9, {{0, 1}})));
    const std::string in = directory.write("drive", bytes);
    EXPECT_EQ(kelvoctl({"import", in, "-o", out()}).status, 0);
    EXPECT_EQ(packetsOf(out()), "0:b0c2");
    EXPECT_EQ(kelvoctl({"import", in, "-o", path("one.pcap"), "--subscription", "1"}).status, 0);
    EXPECT_EQ(packetsOf(path("one.pcap")), "0:b0c1");
}

TEST_F(ImportCommand, TellsOfDamageAndGoesOn) {
    Bytes bytes = plainFrame(recordBodyOf(plainRecord(0xB0C2, kTicks, Bytes(25, 2))));
    Bytes flipped = bytes;
    flipped[10] ^= 1;
    bytes += flipped;
    bytes += plainFrame(recordBodyOf(plainRecord(0xB0C2, kTicks + 800, Bytes(25, 2))));
    const std::string in = directory.write("drive", bytes);
    const Finished done = kelvoctl({"import", in, "-o", out()});
    EXPECT_EQ(done.status, 0);
    EXPECT_EQ(done.errors, "kelvoctl: " + in + ": 1 damaged frames left out\n");
    EXPECT_EQ(packetsOf(out()), "0:b0c2 1:b0c2");
}

TEST_F(ImportCommand, ReadsWhatIsPackedWithGzip) {
    const std::string plain = capture(Technology::LTE, {test::servingCell(301), test::servingCell(302)});
    const std::string bytes = contentsOf(plain);
    const gzFile packed = gzopen(path("in.pcap.gz").c_str(), "wb");
    gzwrite(packed, bytes.data(), static_cast<unsigned>(bytes.size()));
    gzclose(packed);
    EXPECT_EQ(kelvoctl({"import", path("in.pcap.gz"), "-o", out()}).status, 1);  // 25 bytes of version 0: not known
    EXPECT_NE(kelvoctl({"import", "--list", path("in.pcap.gz")}).output.find("refused: not known"), std::string::npos);
}

TEST_F(ImportCommand, SaysWhatIsNoRecording) {
    const std::string noise = directory.write("noise", Bytes(5000, 0x42));
    expectFailure(kelvoctl({"import", noise, "-o", out()}), noise + " holds no diagnostic records");
    expectFailure(kelvoctl({"import", "--list", noise}), noise + " holds no diagnostic records");
    expectFailure(kelvoctl({"import", path("none"), "-o", out()}),
                  path("none") + " cannot be read: No such file or directory");
    expectFailure(kelvoctl({"import", noise}), "-o OUT.pcap or --list says what to do");
    EXPECT_FALSE(std::filesystem::exists(out()));
}

TEST_F(ImportCommand, ReplacesNoFileAndNeverTheOneItReads) {
    const std::string in = frames("drive", {plainRecord(0xB0C2, kTicks, Bytes(25, 2))});
    const std::string before = contentsOf(in);
    EXPECT_EQ(kelvoctl({"import", in, "-o", in, "--force"}).status, 1);
    EXPECT_EQ(contentsOf(in), before);
    directory.write("out.pcap", Bytes{1, 2, 3});
    EXPECT_EQ(kelvoctl({"import", in, "-o", out()}).status, 1);
    EXPECT_EQ(contentsOf(out()), "\x01\x02\x03");
    EXPECT_EQ(kelvoctl({"import", in, "-o", out(), "--force"}).status, 0);
    EXPECT_EQ(packetsOf(out()), "0:b0c2");
}

TEST_F(ImportCommand, ListsEveryCodeVersionAndLength) {
    const std::string in = frames(
        "drive", {plainRecord(0xB0C2, kTicks, kNewServingCell), plainRecord(0xB0C2, kTicks + 800, kNewServingCell),
                  plainRecord(0xB0C2, kTicks, payload(33, {{0, 4}})), plainRecord(0xB195, kTicks, Bytes(40))});
    const auto listed = json({"import", "--list", "--json", in});
    ASSERT_EQ(listed["records"].size(), 3U);
    const auto expected = nlohmann::ordered_json::parse(R"([
        {"code": "0xb0c2", "name": "LTE serving cell, identity", "version": 3, "bytes": 29, "records": 2,
         "first": "2023-12-06T04:04:26.000Z", "last": "2023-12-06T04:04:27.000Z", "becomes": "adapted"},
        {"code": "0xb0c2", "name": "LTE serving cell, identity", "version": 4, "bytes": 33, "records": 1,
         "first": "2023-12-06T04:04:26.000Z", "last": "2023-12-06T04:04:26.000Z", "becomes": "refused",
         "reason": "not known"},
        {"code": "0xb195", "name": "", "bytes": 40, "records": 1, "first": "2023-12-06T04:04:26.000Z",
         "last": "2023-12-06T04:04:26.000Z", "becomes": "not ours"}])");
    EXPECT_EQ(listed["records"], expected);
    EXPECT_EQ(listed["screens"]["LTE"]["partly"], nlohmann::ordered_json::array({"Serving Cell Info"}));
    EXPECT_TRUE(listed["screens"]["LTE"]["filled"].empty());

    const Finished text = kelvoctl({"import", "--list", in});
    EXPECT_NE(text.output.find("0xb0c2    3                   29         2  2023-12-06T04:04:26.000Z"),
              std::string::npos)
        << text.output;
    EXPECT_NE(text.output.find("LTE screens in part: Serving Cell Info\n"), std::string::npos) << text.output;
}

TEST_F(ImportCommand, ListsNoMoreThanTenThousandKinds) {
    Bytes records;  // as in a DLF file, each a kind of its own: 0x5000, 0x5001 and so on
    for (int i = 0; i < 10'050; ++i) {
        Bytes record = plainRecord(0, kTicks, {});
        record[2] = static_cast<std::uint8_t>(i);
        record[3] = static_cast<std::uint8_t>(0x50 + (i >> 8));
        records += record;
    }
    records += plainRecord(0xB0C2, kTicks, kNewServingCell);
    const std::string in = directory.write("kinds", records);
    const std::string listed = kelvoctl({"import", "--list", in}).output;
    EXPECT_NE(listed.find("\n51 records of further kinds\n\nLTE screens in part: Serving Cell Info\n"),
              std::string::npos);
    EXPECT_EQ(std::ranges::count(listed.substr(0, listed.find("51 records")), '\n'), 10'001);  // and the heading
    // Too short are the twelve GSM codes, their twins of two SIMs, 0x51FC and 0x5BFC, 0x7130 to 0x7132, 0x7135, 0x7150.
    EXPECT_EQ(kelvoctl({"import", in, "-o", out()}).output,
              "1 LTE records written to " + out() + ": 0 passed, 1 adapted; 31 refused, 10019 of others\n");
}

TEST_F(ImportCommand, IsNamedWhereACaptureWasExpected) {
    const std::string in = frames("drive", {plainRecord(0xB0C2, kTicks, kNewServingCell)});
    expectFailure(kelvoctl({"decode", in}),
                  in + ": this is a stream of diagnostic frames; kelvoctl import makes a capture of it");
}

}  // namespace
}  // namespace kelvo
