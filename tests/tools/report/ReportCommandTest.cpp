#include <filesystem>
#include <fstream>

#include "tests/tools/KelvoctlTest.h"

namespace kelvo {
namespace {

using test::contentsOf;
using test::expectFailure;
using test::Finished;
using test::Record;

/// 0xB179: EARFCN 5780, RSRP -140 + raw / 4 dBm, RSRQ -10 dB, no cells around.
Bytes connected(std::uint16_t physicalCellId, std::uint16_t rsrp) {
    return Record(0xB179, 29).u16(17, 5780).u16(19, physicalCellId).u16(23, rsrp).u16(25, 80).bytes();
}

/// 0xB180: EARFCN 5780, one cell around; RSRP -140 + raw / 2 dBm.
Bytes heard(std::uint32_t physicalCellId, std::uint32_t rsrp) {
    return Record(0xB180, 41).u16(17, 5780).u32(21, physicalCellId | rsrp << 17).u32(25, 20U << 9).bytes();
}

/// A cell monitor's tree.
Bytes tree(const std::string& inside) {
    const std::string text =
        "<?xml version=\"1.0\" encoding=\"UTF-8\"?><plist version=\"1.0\"><dict><key>Serving</key><dict>" + inside +
        "</dict></dict></plist>";
    return {text.begin(), text.end()};
}

struct ReportCommand : test::KelvoctlTest {
    struct At {
        int second;
        Bytes message;
    };
    std::string captureOf(const std::string& name, const std::vector<At>& messages,
                          Technology technology = Technology::LTE) {
        CaptureWriter writer = test::captureAt(path(name), technology);
        for (const auto& [second, message] : messages) {
            EXPECT_TRUE(writer.append(CaptureTime(std::chrono::seconds(second)), message));
        }
        return path(name);
    }
    /// Two cells in ten seconds, the second one from the fourth on.
    std::string drive() {
        return captureOf("drive.pcap", {{0, connected(185, 120)},
                                        {1, connected(185, 160)},
                                        {2, connected(185, 200)},
                                        {4, connected(84, 240)},
                                        {10, connected(84, 240)}});
    }
    std::string report(std::vector<std::string> files, std::vector<std::string> more = {}) {
        std::vector<std::string> arguments{"report", "-o", path("out.html"), "--force"};
        arguments.insert(arguments.end(), files.begin(), files.end());
        arguments.insert(arguments.end(), more.begin(), more.end());
        const Finished done = kelvoctl(arguments);
        EXPECT_EQ(done.status, 0) << done.errors;
        return contentsOf(path("out.html"));
    }
    /// What the page's script draws.
    static nlohmann::json dataOf(const std::string& page) {
        const std::string begin = "<script type=\"application/json\" id=\"data\">";
        const std::size_t from = page.find(begin);
        if (from == page.npos) return {};
        const std::size_t to = page.find("</script>", from);
        return nlohmann::json::parse(page.substr(from + begin.size(), to - from - begin.size()), nullptr, false);
    }
};

/// What comes before the scripts.
std::string markupOf(const std::string& page) { return page.substr(0, page.find("<script>")); }

void expectHas(const std::string& page, const std::string& text) {
    EXPECT_NE(page.find(text), page.npos) << "the page lacks " << text;
}

void expectLacks(const std::string& page, const std::string& text) {
    EXPECT_EQ(page.find(text), page.npos) << "the page has " << text;
}

TEST_F(ReportCommand, CountsLevelsAndTheTimeOnEachCell) {
    const std::string page = report({drive()});
    expectHas(page, "In <b>10 s</b> the phone was on <b>LTE</b>");
    expectHas(page,
              "<b>2 cells</b> served it, with 1 handover and 0 reselections; EARFCN 5780, PCI 84 served longest, 60 %");
    expectHas(page, "<b>60 %</b> of them were good or better, 20 % poor");
    expectHas(page,
              "<th scope=\"row\">RSRP</th><td class=\"n\" data-k=\"-110\">-110 dBm</td>"
              "<td class=\"n\" data-k=\"-108\">-108 dBm</td><td class=\"n\" data-k=\"-90\">-90 dBm</td>"
              "<td class=\"n\" data-k=\"-80\">-80 dBm</td><td class=\"n\" data-k=\"-80\">-80 dBm</td>"
              "<td class=\"n\" data-k=\"5\">5</td>");
    // Band 17, six of ten seconds, once, the median of two readings.
    expectHas(page,
              "<th scope=\"row\">EARFCN 5780, PCI 84</th><td>17</td><td class=\"n\" data-k=\"6000000\">6.0 s</td>"
              "<td class=\"n\" data-k=\"0.600000\">60 %</td><td class=\"n\" data-k=\"1\">1</td>"
              "<td class=\"n\" data-k=\"-80\">-80</td>");
    expectHas(page,
              "<th scope=\"row\">EARFCN 5780, PCI 185</th><td>17</td><td class=\"n\" data-k=\"4000000\">4.0 s</td>"
              "<td class=\"n\" data-k=\"0.400000\">40 %</td><td class=\"n\" data-k=\"1\">1</td>"
              "<td class=\"n\" data-k=\"-100\">-100</td>");
    expectHas(page, "Every record was read.");
    expectHas(page, "The lines show every reading.");
}

TEST_F(ReportCommand, DrawsTheReadingsAndMarksWhereTheCellChanged) {
    const auto data = dataOf(report({drive()}));
    EXPECT_EQ(data["axis"], "clock");
    EXPECT_EQ(data["length"], 10'000);
    ASSERT_EQ(data["charts"].size(), 2U);
    EXPECT_EQ(data["charts"][0]["title"], "Level: RSRP");
    EXPECT_EQ(data["charts"][0]["lines"][0]["x"], nlohmann::json({0, 1000, 1000, 2000, 6000}));
    EXPECT_EQ(data["charts"][0]["lines"][0]["y"], nlohmann::json({-110, -100, -90, -80, -80}));
    EXPECT_EQ(data["charts"][1]["title"], "Quality: RSRQ");
    EXPECT_EQ(data["drives"][0]["marks"]["x"], nlohmann::json({4000}));
    EXPECT_EQ(data["drives"][0]["marks"]["kinds"], "h");
    EXPECT_EQ(data["drives"][0]["stretches"], nlohmann::json({{0, 0}}));
}

TEST_F(ReportCommand, TellsOfTheCellsAroundAndOfTheBestOfThem) {
    const std::string page = report({captureOf(
        "around.pcap", {{0, connected(185, 160)}, {1, heard(301, 60)}, {2, heard(302, 90)}, {3, heard(301, 70)}})});
    // -110 and -105 dBm, never above the serving cell's -100; -95 dBm once.
    expectHas(page,
              "<th scope=\"row\">EARFCN 5780, PCI 301</th><td class=\"n\" data-k=\"2\">2</td>"
              "<td class=\"n\" data-k=\"0\">0</td><td class=\"n\" data-k=\"-107.5\">-107.5</td>"
              "<td class=\"n\" data-k=\"-105\">-105</td>");
    expectHas(page,
              "<th scope=\"row\">EARFCN 5780, PCI 302</th><td class=\"n\" data-k=\"1\">1</td>"
              "<td class=\"n\" data-k=\"1\">1</td><td class=\"n\" data-k=\"-95\">-95</td>");
    const auto lines = dataOf(page)["charts"][0]["lines"];
    ASSERT_EQ(lines.size(), 2U);
    EXPECT_EQ(lines[1]["name"], "best neighbor");
    EXPECT_EQ(lines[1]["y"], nlohmann::json({-110, -95, -95}));
}

TEST_F(ReportCommand, LeavesPausesOut) {
    const std::string page = report(
        {captureOf("pause.pcap", {{0, connected(185, 120)}, {4, connected(185, 120)}, {4000, connected(185, 120)}})});
    expectHas(page, "1970-01-01 00:00:00 to 01:06:40 UTC, 1 pause left out");
    expectHas(page, "In <b>4.0 s</b>");
    const auto data = dataOf(page);
    EXPECT_EQ(data["drives"][0]["stretches"], nlohmann::json({{0, 0}, {4000, 4'000'000}}));
    EXPECT_EQ(data["charts"][0]["lines"][0]["y"], nlohmann::json({-110, -110, nullptr, -110}));
}

TEST_F(ReportCommand, WithoutTimesItGoesByRecords) {
    const std::string page = report(
        {captureOf("still.pcap", {{7, connected(185, 120)}, {7, connected(185, 160)}, {7, connected(84, 200)}})});
    expectHas(page, "without times");
    expectHas(page, "In <b>3 records</b> the phone was on <b>LTE</b>");
    expectHas(
        page,
        "<th scope=\"row\">EARFCN 5780, PCI 185</th><td>17</td><td class=\"n\" data-k=\"2000000\">2 records</td>");
    expectHas(page, "The records bear no times: everything is told by their number.");
    EXPECT_EQ(dataOf(page)["axis"], "records");
    EXPECT_EQ(dataOf(page)["charts"][0]["lines"][0]["x"], nlohmann::json({0, 1000, 1000}));
}

TEST_F(ReportCommand, OfAnEmptyCaptureItSaysSo) {
    const std::string page = report({captureOf("empty.pcap", {})});
    expectHas(page, "The file holds no record.");
    EXPECT_EQ(dataOf(page)["charts"].size(), 0U);
}

TEST_F(ReportCommand, ComparesSeveralFiles) {
    const std::string other = captureOf("other.pcap", {{100, connected(185, 160)}, {105, connected(185, 160)}});
    const std::string page = report({drive(), other}, {"--title", "Before & after"});
    expectHas(page, "<h1>Before &amp; after</h1>");
    expectHas(page, "RSRP is <b>10 dB lower</b>, RSRQ is the same");
    expectHas(page, "The cell changed 0 times in B, 1 time in A.");
    expectHas(page,
              "<th scope=\"row\">RSRP, median</th><td class=\"n\" data-k=\"-90\">-90 dBm</td>"
              "<td class=\"n\" data-k=\"-100\">-100 dBm</td><td class=\"n\" data-k=\"-10\">-10 dB</td>");
    expectHas(page,
              "<th scope=\"row\">Length</th><td class=\"n\" data-k=\"10\">10 s</td>"
              "<td class=\"n\" data-k=\"5\">5.0 s</td><td class=\"n\" data-k=\"-5\">-5.0 s</td>");
    expectHas(page,
              "<th scope=\"row\">EARFCN 5780, PCI 84</th><td class=\"n\" data-k=\"6000000\">6.0 s</td><td "
              "class=\"n\">–</td>");
    const auto data = dataOf(page);
    EXPECT_EQ(data["axis"], "elapsed");
    ASSERT_EQ(data["charts"][0]["lines"].size(), 2U);
    EXPECT_EQ(data["charts"][0]["lines"][1]["name"], "B");
    EXPECT_EQ(data["charts"][0]["lines"][1]["x"], nlohmann::json({0, 5000}));
    EXPECT_EQ(kelvoctl({"report", "-o", path("many.html"), other, other, other, other, other, other, other}).status, 1);
}

TEST_F(ReportCommand, TextsFromTheModemStayTexts) {
    const std::string hostile =
        "&lt;/script&gt;&lt;script&gt;alert(1)&lt;/script&gt;&lt;!--\"'&amp;\xE2\x80\xA8{{data}}";
    const std::string page = report({captureOf(
        "hostile.pcap",
        {{0, tree("<key>Technology</key><string>" + hostile +
                  "</string><key>MCC</key><string>&lt;b&gt;</string>"
                  "<key>MNC</key><string>&lt;img src=x&gt;</string><key>RSSI</key><string>-71 &lt;i&gt;</string>")},
         {1, tree("<key>Technology</key><string>GSM</string>")}},
        Technology::IFX)});
    expectLacks(page, "<script>alert(1)");
    expectLacks(markupOf(page), "<img");
    expectLacks(markupOf(page), "<!--");
    expectLacks(markupOf(page), "<i>");
    expectLacks(page, "\xE2\x80\xA8");
    expectHas(page, "&lt;/script&gt;&lt;script&gt;alert(1)&lt;/script&gt;&lt;!--&quot;&#39;&amp;");
    const auto data = dataOf(page);
    ASSERT_FALSE(data.is_discarded());
    EXPECT_EQ(data["drives"][0]["lanes"][0]["texts"][0],
              "</script><script>alert(1)</script><!--\"'&\xEF\xBF\xBD{{data}}");
}

TEST_F(ReportCommand, TheNameOfAFileIsATextToo) {
    const std::string page = report({captureOf("a<b>\xFF.pcap", {{0, connected(185, 120)}})});
    expectHas(page, "<h1>a&lt;b&gt;\xEF\xBF\xBD.pcap</h1>");
}

TEST_F(ReportCommand, SaysWhichRecordsItCouldNotRead) {
    const std::string page = report({captureOf(
        "odd.pcap", {{0, connected(185, 120)}, {1, Record(0xB179, 28).bytes()}, {2, Record(0x1234, 40).bytes()}})});
    expectHas(page,
              "<th scope=\"row\" data-k=\"4660\">0x1234</th><td>–</td><td class=\"n\" data-k=\"1\">1</td>"
              "<td class=\"n\" data-k=\"1\">1</td><td>no screen of this technology takes it</td>");
    expectHas(page,
              "data-k=\"1\">1</td><td class=\"n\" data-k=\"2\">2</td><td>too short, of another layout, or with nothing "
              "to show</td>");
}

TEST_F(ReportCommand, OfACutCaptureItTellsWhatThereIsAndWhereItEnds) {
    const std::string file = drive();
    std::filesystem::resize_file(file, std::filesystem::file_size(file) - 5);
    const Finished done = kelvoctl({"report", file, "-o", path("out.html")});
    EXPECT_EQ(done.status, 1);
    EXPECT_NE(done.errors.find("packet 5"), std::string::npos) << done.errors;
    const std::string page = contentsOf(path("out.html"));
    expectHas(page, "4 records");
    expectHas(page, "packet 5");
    expectLacks(page, directory.file(""));  // where it lay is nobody's business
}

TEST_F(ReportCommand, ReplacesNoFileAndNeverTheOneItReads) {
    const std::string file = drive();
    std::ofstream(path("there.html")) << "mine";
    EXPECT_EQ(kelvoctl({"report", file, "-o", path("there.html")}).status, 1);
    EXPECT_EQ(contentsOf(path("there.html")), "mine");
    EXPECT_EQ(kelvoctl({"report", file, "-o", file, "--force"}).status, 1);
    EXPECT_EQ(kelvoctl({"report", path("missing"), "-o", path("new.html")}).status, 1);
    EXPECT_FALSE(std::filesystem::exists(path("new.html")));
    EXPECT_EQ(kelvoctl({"report", file}).status, 1);
}

TEST_F(ReportCommand, ReadsACaptureFromStandardInput) {
    const Finished done = kelvoctl({"report", "-", "-o", path("out.html")}, drive());
    EXPECT_EQ(done.status, 0) << done.errors;
    expectHas(contentsOf(path("out.html")), "<h1>standard input</h1>");
}

TEST_F(ReportCommand, SharedItTellsWhatItDidAndOfNobody) {
    // One cell, one area: neither is its own pseudonym.
    const std::string file =
        captureOf("262011234567890.pcap",
                  {{1000, test::servingCell(185)}, {1001, connected(185, 120)}, {1003, connected(185, 200)}});
    const std::string open = report({file});
    for (const char* told : {"PCI 185", "TAC 4566", "262011234567890", "1970-01-01 00:16:40"}) expectHas(open, told);

    const std::string shared = report({file}, {"--share", "--shift-times"});
    for (const char* secret : {"PCI 185", "TAC 4566", "262011234567890", "1970-01-01", "00:16:40"})
        expectLacks(shared, secret);
    expectHas(shared, "2020-01-01 00:00:00 to 00:00:03 UTC");
    expectHas(shared, "cells, areas and networks have pseudonyms");
    const std::string levels = "<th scope=\"row\">RSRP</th><td class=\"n\" data-k=\"-110\">-110 dBm</td>";
    expectHas(open, levels);
    expectHas(shared, levels);

    const std::string kept = report({file}, {"--share", "--keep-cells"});
    expectHas(kept, "PCI 185");
    expectLacks(kept, "262011234567890");
    EXPECT_EQ(kelvoctl({"report", file, "-o", path("x.html"), "--keep-cells"}).status, 1);
}

TEST_F(ReportCommand, SharedItHidesAccessPointsOnRequest) {
    const std::string file = KELVO_TEST_CAPTURES "/lte-idle.pcap";
    expectHas(report({file}, {"--share"}), "internet");
    expectLacks(report({file}, {"--share", "--hide-apns"}), "internet");
}

TEST_F(ReportCommand, ThePageNeedsNothingElse) {
    const std::string page = report({drive()});
    expectHas(page, "default-src 'none'");
    expectHas(page, "dygraphs is MIT-licenced");
    expectHas(page, "THE SOFTWARE IS PROVIDED");
    expectHas(page, "Dygraph=");
    expectLacks(page, "sourceMappingURL");
    expectLacks(markupOf(page), "src=");
    expectLacks(markupOf(page), "@import");
    expectLacks(markupOf(page), "http:");
    expectLacks(markupOf(page), "https:");
    EXPECT_LT(page.size(), 400'000U);
}

}  // namespace
}  // namespace kelvo
