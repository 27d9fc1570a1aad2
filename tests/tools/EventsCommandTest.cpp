#include <fstream>

#include "tests/tools/KelvoctlTest.h"

namespace kelvo {
namespace {

using test::expectFailure;
using test::Finished;
using test::KelvoctlTest;
using test::Record;
using test::servingCell;

using EventsCommand = KelvoctlTest;

/// 0xB179: EARFCN 5780, RSRP -140 + raw / 4 dBm, no cells around.
Bytes connected(std::uint16_t physicalCellId, std::uint16_t rsrp) {
    return Record(0xB179, 29).u16(17, 5780).u16(19, physicalCellId).u16(23, rsrp).u16(25, 80).bytes();
}

/// 0xB180: EARFCN 5780, one cell around; RSRP -140 + raw / 2 dBm.
Bytes heard(std::uint32_t physicalCellId, std::uint32_t rsrp) {
    return Record(0xB180, 41).u16(17, 5780).u32(21, physicalCellId | rsrp << 17).u32(25, 20U << 9).bytes();
}

TEST_F(EventsCommand, TellsWhatHappenedWithTheRecordsTimes) {
    const std::string file = capture(Technology::LTE, {connected(185, 122), connected(185, 100), connected(84, 160)});
    const Finished done = kelvoctl({"events", file});
    EXPECT_EQ(done.status, 0);
    EXPECT_EQ(done.errors, "");
    EXPECT_EQ(done.output,
              "1970-01-01T00:00:00.000Z  cell found  EARFCN 5780, PCI 185 (-109.50 dBm)\n"
              "1970-01-01T00:00:02.000Z  handover  EARFCN 5780, PCI 185 -> EARFCN 5780, PCI 84 (-115.00 dBm -> -100.00 "
              "dBm)\n");
}

TEST_F(EventsCommand, AsJsonLinesAndAsCommaSeparatedValues) {
    const std::string file = capture(Technology::LTE, {connected(185, 122)});
    const Finished json = kelvoctl({"events", "--json", file});
    EXPECT_EQ(json.output,
              R"js({"time":"1970-01-01T00:00:00.000Z","event":"cell found","to":"EARFCN 5780, PCI 185",)js"
              R"js("levelAfter":"-109.50 dBm","record":1,"values":{"Cell":{"after":"EARFCN 5780, PCI 185"},)js"
              R"js("RSRP":{"after":"-109.50 dBm"},"RSRQ":{"after":"-10.00 dB"},"Radio":{"after":"LTE"},)js"
              R"js("State":{"after":"connected"},"Band":{"after":"17 (739.0 MHz down, 709.0 MHz up)"}}})js"
              "\n");
    const Finished csv = kelvoctl({"events", "--csv", file});
    EXPECT_EQ(
        csv.output,
        "\"time\",\"event\",\"from\",\"to\",\"level before\",\"level after\",\"record\",\"file\"\r\n"
        "\"1970-01-01T00:00:00.000Z\",\"cell found\",\"\",\"EARFCN 5780, PCI 185\",\"\",\"-109.50 dBm\",\"1\",\"" +
            file + "\"\r\n");
    EXPECT_EQ(kelvoctl({"events", "--csv", "--json", file}).status, 1);
}

TEST_F(EventsCommand, OfNoCaptureItSaysWhatItIs) {
    std::ofstream(path("text")) << "no capture at all";
    EXPECT_EQ(kelvoctl({"events", path("text")}).status, 1);
    expectFailure(kelvoctl({"events", path("missing")}),
                  path("missing") + " cannot be opened: No such file or directory");
}

TEST_F(EventsCommand, TheOverviewShowsTheCellsThatWereHeard) {
    const std::string file =
        capture(Technology::LTE, {connected(185, 122), heard(301, 60), heard(302, 70), servingCell(185)});
    const Finished done = kelvoctl({"decode", "--overview", file});
    EXPECT_EQ(done.status, 0);
    EXPECT_EQ(done.output,
              "LTE, connected\n"
              "  Cell           EARFCN 5780, PCI 185\n"
              "  RSRP           -109.50 dBm, poor, 3 s ago\n"
              "  RSRQ           -10.00 dB, excellent, 3 s ago\n"
              "  Area           TAC 4566\n"
              "  Cell identity  77 (eNB 0, sector 77)\n"
              "  Band           17 (739.0 MHz down, 709.0 MHz up)\n"
              "  Bandwidth      10 MHz down, 5 MHz up\n"
              "Cells around\n"
              "  Cell                  Level        Quality    To serving  Heard\n"
              "  EARFCN 5780, PCI 302  -105.00 dBm  -25.00 dB  +4.50 dB    1 s ago\n"
              "  EARFCN 5780, PCI 301  -110.00 dBm  -25.00 dB  -0.50 dB    2 s ago\n"
              "What happened\n"
              "  1970-01-01T00:00:00.000Z  cell found  EARFCN 5780, PCI 185 (-109.50 dBm)\n");

    const auto shown = json({"decode", "--overview", "--json", file});
    EXPECT_EQ(shown["serving"]["cell"], "EARFCN 5780, PCI 185");
    EXPECT_EQ(shown["serving"]["level"]["number"], -109.5);
    EXPECT_EQ(shown["serving"]["level"]["record"], 1);
    EXPECT_EQ(shown["serving"]["age"], 3.0);
    EXPECT_EQ(shown["serving"]["qualityAge"], 3.0);
    EXPECT_EQ(shown["cells"][0]["cell"], "EARFCN 5780, PCI 302");
    EXPECT_EQ(shown["cells"][0]["age"], 1.0);
    EXPECT_EQ(shown["cells"][0]["lost"], false);
    EXPECT_EQ(shown["events"].size(), 1U);
}

TEST_F(EventsCommand, WhereTimesGoBackNothingIsYoungerThanNow) {
    {
        CaptureWriter writer = test::captureAt(path("back.pcap"), Technology::LTE);
        ASSERT_TRUE(writer.append(CaptureTime(std::chrono::seconds(60)), connected(185, 122)));
        ASSERT_TRUE(writer.append(CaptureTime(std::chrono::seconds(10)), servingCell(185)));
    }
    const Finished done = kelvoctl({"decode", "--overview", path("back.pcap")});
    EXPECT_NE(done.output.find("RSRP           -109.50 dBm, poor, 0 s ago\n"), std::string::npos) << done.output;
    EXPECT_EQ(json({"decode", "--overview", "--json", path("back.pcap")})["serving"]["age"], 0.0);
}

/// 0xB0C2: the cell that serves.
Bytes broadcast(std::uint16_t channel, std::uint16_t physicalCellId, std::uint16_t area) {
    return Record(0xB0C2, 38).u16(14, physicalCellId).u16(16, channel).u16(18, channel + 18000).u16(26, area).bytes();
}

/// What a phone with two carriers sent on a network in 2016: one is measured every 40 ms, the other every 160 ms, each
/// as if it served; later it went to another cell.
TEST_F(EventsCommand, OfAPhoneWithTwoCarriersOneServes) {
    using namespace std::chrono_literals;
    const auto measured = [](std::uint16_t channel, std::uint16_t physicalCellId, std::uint16_t rsrp) {
        return Record(0xB179, 29).u16(17, channel).u16(19, physicalCellId).u16(23, rsrp).u16(25, 80).bytes();
    };
    {
        CaptureWriter writer = test::captureAt(path("two.pcap"), Technology::LTE);
        CaptureTime at(1453002041s);
        const auto send = [&](const Bytes& message, std::chrono::milliseconds after) {
            at += after;
            ASSERT_TRUE(writer.append(at, message));
        };
        for (int turn = 0; turn < 5; ++turn) {
            send(measured(5780, 185, 122), 40ms);
            send(measured(700, 185, 132), 36ms);
            send(measured(5780, 185, 122), 44ms);
            send(measured(5780, 185, 122), 40ms);
        }
        send(broadcast(5780, 185, 21512), 95s);
        send(measured(700, 185, 132), 100ms);
        send(broadcast(2075, 42, 21512), 60s);
        send(measured(2075, 42, 117), 40ms);
    }
    EXPECT_EQ(kelvoctl({"events", path("two.pcap")}).output,
              "2016-01-17T03:40:41.040Z  cell found  EARFCN 5780, PCI 185 (-109.50 dBm)\n"
              "2016-01-17T03:43:16.900Z  reselection  EARFCN 5780, PCI 185 -> EARFCN 2075, PCI 42 (-110.75 dBm)\n"
              "2016-01-17T03:43:16.900Z  band change  17 -> 4\n");
}

}  // namespace
}  // namespace kelvo
