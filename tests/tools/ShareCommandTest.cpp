#include "tests/tools/SharedFiles.h"

namespace kelvo {
namespace {

using namespace test;
using Json = nlohmann::ordered_json;

struct ShareCommand : SharedFiles {};

TEST_F(ShareCommand, MakesAStreamThatImportsAsTheOriginalDoes) {
    const std::string in = frames(lteMessages());
    share(in);
    const Finished before = kelvoctl({"import", in, "-o", path("before.pcap")});
    const Finished after = kelvoctl({"import", out(), "-o", path("after.pcap")});
    EXPECT_EQ(before.status, 0) << before.errors;
    EXPECT_EQ(after.status, 0) << after.errors;
    const Json one = json({"decode", "--json", path("before.pcap")});
    const Json other = json({"decode", "--json", path("after.pcap")});
    EXPECT_EQ(one["display"]["Serving Cell Info"]["Download Frequency"], "1300");
    EXPECT_EQ(one["display"]["Serving Cell Measurements"], [&] {
        Json shared = other["display"]["Serving Cell Measurements"];
        EXPECT_NE(shared["Physical Cell ID"], "301");
        shared["Physical Cell ID"] = "301";
        return shared;
    }());
}

TEST_F(ShareCommand, KeepsTheSubscriptionOfAFrame) {
    const Bytes message = lteMessages().front();
    Bytes body = {0x98, 1, 0, 0, 2, 0, 0, 0};
    body += recordBodyOf(Bytes(message.begin() + 1, message.end()));
    share(directory.write("in.frames", plainFrame(body)));
    EXPECT_EQ(kelvoctl({"import", out(), "-o", path("a.pcap"), "--subscription", "2"}).status, 0);
    EXPECT_EQ(kelvoctl({"import", out(), "-o", path("b.pcap"), "--subscription", "1"}).status, 1);
}

TEST_F(ShareCommand, MakesASnapshotWhoseScreensAndRecordsAgree) {
    const Value display = Dictionary::make(
        {{"Serving Cell Info", Dictionary::make({{"Cell Identity", "26385441"}, {"UARFCN", "1300"}})}});
    share(snapshot({lteMessages().front()}, display));
    const Json shown = json({"snapshot", out(), "--entry", "1", "--json"});
    EXPECT_EQ(kelvoctl({"snapshot", out(), "--capture", path("c.pcap"), "--technology", "lte"}).status, 0);
    const Json decoded = json({"decode", "--json", path("c.pcap")});
    EXPECT_EQ(shown["Serving Cell Info"]["Cell Identity"], decoded["display"]["Serving Cell Info"]["Cell Identity"]);
    EXPECT_NE(shown["Serving Cell Info"]["Cell Identity"], "26385441");
    EXPECT_EQ(shown["Serving Cell Info"]["UARFCN"], "1300");
    EXPECT_EQ(kelvoctl({"snapshot", out(), "--dlf", path("d.dlf")}).output,
              "198 bytes written to " + path("d.dlf") + "\n");  // 161 and a record of 37
    EXPECT_EQ(kelvoctl({"import", path("d.dlf"), "-o", path("d.pcap")}).status, 0);
    EXPECT_EQ(json({"decode", "--json", path("d.pcap")})["display"], decoded["display"]);
}

TEST_F(ShareCommand, ShowsACellMonitorsSnapshotAsItsTreeIs) {
    const Value tree = *readPropertyList(cellMonitorTree());
    const Value entry = Dictionary::make({{"DisplayState", tree}, {"Display", Dictionary::make({{"Serving", "x"}})}});
    const Value all = Dictionary::make({{"Data", Array::make({entry})}});
    share(directory.write("in.kelvo", *writeXmlPropertyList(all)));
    const Json shown = json({"snapshot", out(), "--entry", "1", "--json"});
    EXPECT_EQ(shown["Serving"]["RSSI"], "-71 dBm");
    EXPECT_EQ(shown["Serving"].size(), 7U);
}

TEST_F(ShareCommand, GivesEveryCopyItsOwnPseudonyms) {
    const std::string in = capture(Technology::LTE, lteMessages());
    EXPECT_EQ(kelvoctl({"share", in, "-o", path("a")}).status, 0);
    EXPECT_EQ(kelvoctl({"share", in, "-o", path("b")}).status, 0);
    EXPECT_NE(contentsOf(path("a")), contentsOf(path("b")));
    share(in);
    const std::string once = contentsOf(out());
    share(in);
    EXPECT_EQ(contentsOf(out()), once);
}

TEST_F(ShareCommand, TellsWhatItReplacedRemovedAndKept) {
    const Finished done = share(frames(lteMessages()), {"--shift-times"});
    EXPECT_EQ(done.errors, "");
    EXPECT_EQ(done.output, "2 of 6 records written to " + out() + R"(
Replaced:
        1  Cell Identity (cell)
        1  Mobile Country Code (country)
        1  Mobile Network Code (network)
        2  Physical Cell ID (cell's code)
        1  Tracking Area Code (area)
Removed:
        1  damaged frame
        4  record of a code that Kelvo does not know
        1  text of the modem
Kept: levels, states, channels
)");
}

TEST_F(ShareCommand, TellsWhatItReplacedAndRemovedOfThePhonesRecords) {
    EXPECT_EQ(share(capture(Technology::GSM, {simFiles().bytes(), contexts().bytes()})).output,
              "2 of 2 records written to " + out() + R"(
Replaced:
        1  APN (access point)
        1  EF-3GPP MAIL BOX DIALING NUMBER (telephone number)
        1  EF-ACTING HPLMN (networks)
        1  EF-FPLMN (networks)
        1  EF-GPRS/PS-LOCI (temporary identity and area)
        1  EF-ICCID (SIM number)
        1  EF-LOCI (temporary identity and area)
        1  EF-MSISDN (telephone number)
        1  EF-OPERATOR PLMN LIST (networks and areas)
        1  EF-OPLMNAcT (networks)
        1  EF-PLMN NETWORK NAME (network's name)
        2  PDP Address (address)
Removed:
        2  entry of a phone's record under a name that Kelvo does not know
        1  value in a form that Kelvo does not know
Kept: levels, states, channels, times (--shift-times)
)");
}

TEST_F(ShareCommand, KeepsCellsOnRequest) {
    const Finished done = share(capture(Technology::LTE, lteMessages()), {"--keep-cells"});
    const Json shown = json({"decode", "--json", out()})["display"]["Serving Cell Info"];
    EXPECT_EQ(shown["Cell Identity"], "26385441");
    EXPECT_EQ(shown["Tracking Area Code"], "45663");
    EXPECT_NE(done.output.find("Kept: levels, states, channels, cells, areas and networks, times (--shift-times)\n"),
              std::string::npos)
        << done.output;
    EXPECT_EQ(share(path("in.pcap"), {"--keep-cells", "--hide-cells"}).status, 1);
}

TEST_F(ShareCommand, ShiftsTimesOnRequestAndKeepsTheirIntervals) {
    auto times = [&](const std::string& file) {
        std::vector<std::int64_t> seconds;
        auto reader = CaptureReader::open(file);
        for (auto packet = reader->next(); packet && *packet; packet = reader->next()) {
            seconds.push_back(std::chrono::floor<std::chrono::seconds>((*packet)->time).time_since_epoch().count());
        }
        return seconds;
    };
    share(capture(Technology::CDMA, cdmaMessages()));
    EXPECT_EQ(times(out()), (std::vector<std::int64_t>{0, 1, 2}));
    share(path("in.pcap"), {"--shift-times"});
    EXPECT_EQ(times(out()), (std::vector<std::int64_t>{1'577'836'800, 1'577'836'801, 1'577'836'802}));
}

TEST_F(ShareCommand, ShiftsTheTimesOfASnapshotAndHidesItsZone) {
    share(snapshot({lteMessages().front()}, Dictionary::make({})), {"--shift-times"});
    const std::string listed = kelvoctl({"snapshot", out()}).output;
    EXPECT_NE(listed.find("Timestamp    2020-01-01 00:00:00 +0000"), std::string::npos) << listed;
    EXPECT_NE(listed.find("Snapshot (2020-01-01 00:00:00 +0000)"), std::string::npos) << listed;
}

TEST_F(ShareCommand, HidesTheZoneOfASnapshotWithItsCells) {
    const std::string in = snapshot({lteMessages().front()}, Dictionary::make({}));
    share(in);
    EXPECT_NE(kelvoctl({"snapshot", out()}).output.find("Snapshot (2023-11-04 08:15:02 +0000)"), std::string::npos);
    share(in, {"--keep-cells"});
    EXPECT_NE(kelvoctl({"snapshot", out()}).output.find("Snapshot (2023-11-04 09:15:02 +0100)"), std::string::npos);
}

TEST_F(ShareCommand, RemovesADateThatNoClockShows) {
    const Value all = Dictionary::make({{"Timestamp", "4022-02-28 08:15:02 +0000"}, {"Data", Array::make({})}});
    const Finished done = share(directory.write("in.kelvo", *writeXmlPropertyList(all)), {"--shift-times"});
    EXPECT_EQ(done.status, 0) << done.errors;
    EXPECT_NE(done.output.find("        1  entry of a snapshot that Kelvo does not know\n"), std::string::npos);
    EXPECT_EQ(contentsOf(out()).find("4022"), std::string::npos);
}

TEST_F(ShareCommand, CopiesWhatIsGoodAndTellsWhereItStopped) {
    const std::string in = capture(Technology::LTE, lteMessages());
    const std::string whole = contentsOf(in);
    directory.write("cut.pcap", bytesOf(whole.substr(0, whole.size() - 5)));
    const Finished done = share(path("cut.pcap"));
    EXPECT_EQ(done.status, 1);
    EXPECT_TRUE(done.output.starts_with("4 of 5 records written to ")) << done.output;
    EXPECT_TRUE(done.errors.starts_with("kelvoctl: " + path("cut.pcap"))) << done.errors;
    EXPECT_EQ(std::count(done.errors.begin(), done.errors.end(), '\n'), 1);
    EXPECT_EQ(json({"decode", "--json", out()})["messages"], 4);
}

TEST_F(ShareCommand, ReplacesNoFileUnlessForcedAndNeverTheOneBeingRead) {
    const std::string in = capture(Technology::LTE, lteMessages());
    const std::string before = contentsOf(in);
    directory.write("there", bytesOf("mine"));
    EXPECT_EQ(kelvoctl({"share", in, "-o", path("there")}).status, 1);
    EXPECT_EQ(contentsOf(path("there")), "mine");
    EXPECT_EQ(kelvoctl({"share", in, "-o", in, "--force"}).status, 1);
    EXPECT_EQ(contentsOf(in), before);
    EXPECT_EQ(kelvoctl({"share", in, "-o", path("key"), "--key", path("key"), "--force"}).status, 1);
    EXPECT_EQ(contentsOf(path("key")), "a key of a test, long enough");
}

TEST_F(ShareCommand, SaysWhatItCannotShare) {
    directory.write("noise", bytesOf("no recording at all"));
    directory.write("list", bytesOf("{ Timestamp = \"2023-11-04 08:15:02 +0000\"; }"));
    EXPECT_EQ(share(path("list")).status, 0);
    EXPECT_EQ(share(path("list")).output.substr(0, 20), "0 of 0 records writt");
    std::filesystem::remove(out());
    expectFailure(share(path("noise")), path("noise") + " holds no diagnostic records");
    const std::string nothing = capture(Technology::LTE, {unknown()});
    expectFailure(share(nothing), nothing + " holds nothing that can be shared");
    EXPECT_FALSE(std::filesystem::exists(out()));
    directory.write("short", bytesOf("15 characters.."));
    expectFailure(kelvoctl({"share", nothing, "-o", out(), "--key", path("short")}),
                  path("short") + " is too short for a key: 16 bytes are the least");
    EXPECT_EQ(kelvoctl({"share", nothing}).status, 1);
}

}  // namespace
}  // namespace kelvo
