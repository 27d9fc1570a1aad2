#include "tools/export/Notation.h"

#include <gtest/gtest.h>

#include <limits>

#include "LogGenerator/Shown.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using namespace std::string_literals;

const std::vector<std::string> kOne = {"drive.pcap"};
const std::vector<std::string> kTwo = {"one, two.pcap", "say \"three\".pcap"};

const Moment kMoment{.time = CaptureTime(std::chrono::sys_days(std::chrono::year(2026) / 3 / 2) + 9h + 250ms),
                     .technology = Technology::LTE,
                     .code = 0xB17F,
                     .record = 4711,
                     .input = 0};

/// The whole row.
std::string row(const Notation& notation, const Moment& moment, const std::string& path, const std::string& text,
                const std::optional<Measurement>& measurement) {
    std::string out;
    MomentText time;
    notation.appendStart(out, moment, time.of(moment.time));
    notation.appendSeries(out, {.technology = moment.technology, .path = path});
    notation.appendReading(out, text, measurement);
    notation.appendEnd(out, moment);
    return out;
}

const Measurement kLevel{.number = -95.25, .unit = "dBm"};

TEST(Notation, CsvQuotesTextsAndLeavesNumbersPlain) {
    const auto csv = csvNotation(kOne);
    EXPECT_EQ(csv->heading(), "time,technology,path,text,number,unit,code,record\r\n");
    EXPECT_EQ(row(*csv, kMoment, "/A/RSRP", "-95.25 dBm", kLevel),
              "2026-03-02T09:00:00.250000Z,LTE,\"/A/RSRP\",\"-95.25 dBm\",-95.25,dBm,0xb17f,4711\r\n");
    EXPECT_EQ(row(*csv, {.time = CaptureTime(1s), .technology = Technology::IFX, .record = 1}, "/A", "b", {}),
              "1970-01-01T00:00:01.000000Z,IFX,\"/A\",\"b\",,,,1\r\n");
}

TEST(Notation, CsvTellsTheFileWhereThereAreSeveral) {
    const auto csv = csvNotation(kTwo);
    EXPECT_EQ(csv->heading(), "time,technology,path,text,number,unit,code,record,file\r\n");
    Moment second = kMoment;
    second.input = 1;
    EXPECT_EQ(row(*csv, second, "/A", "b", {}),
              "2026-03-02T09:00:00.250000Z,LTE,\"/A\",\"b\",,,0xb17f,4711,\"say \"\"three\"\".pcap\"\r\n");
}

TEST(Notation, CsvHoldsHostileTexts) {
    std::string field;
    appendCsvField(field, "a \"b\", c\r\nd"s + '\0' + "e\xFF\x1B[2J");
    EXPECT_EQ(field, "\"a \"\"b\"\", c\r\nd\xEF\xBF\xBD"s + "e\xEF\xBF\xBD\x1B[2J\"");
}

TEST(Notation, JsonHasWhatApplies) {
    const auto json = jsonNotation(kOne);
    EXPECT_EQ(json->heading(), "");
    EXPECT_EQ(row(*json, kMoment, "/A/RSRP", "-95.25 dBm", kLevel),
              R"({"time":"2026-03-02T09:00:00.250000Z","technology":"LTE","path":"/A/RSRP","text":"-95.25 dBm",)"
              R"("number":-95.25,"unit":"dBm","code":"0xb17f","record":4711})"
              "\n");
    EXPECT_EQ(row(*json, {.technology = Technology::IFX, .record = 1}, "/A", "b", {}),
              R"({"time":"1970-01-01T00:00:00.000000Z","technology":"IFX","path":"/A","text":"b","record":1})"
              "\n");
    EXPECT_EQ(row(*json, kMoment, "/A", "7", Measurement{.number = 7, .unit = {}}),
              R"({"time":"2026-03-02T09:00:00.250000Z","technology":"LTE","path":"/A","text":"7","number":7,)"
              R"("code":"0xb17f","record":4711})"
              "\n");
}

TEST(Notation, JsonHoldsHostileTexts) {
    std::string text;
    appendJsonString(text, "\"\\\n"s + '\0' + "\xFF\x7F\xC2\x9B");
    EXPECT_EQ(text, "\"\\\"\\\\\\n\\u0000\xEF\xBF\xBD\\u007f\\u009b\"");
}

TEST(Notation, TheLineProtocolHasTagsFieldsAndNanoseconds) {
    const auto influx = influxNotation(kOne);
    EXPECT_EQ(row(*influx, kMoment, "/A/RSRP", "-95.25 dBm", kLevel),
              "reading,code=0xb17f,path=/A/RSRP,technology=LTE,unit=dBm "
              "text=\"-95.25 dBm\",number=-95.25,record=4711i 1772442000250000000\n");
    EXPECT_EQ(row(*influx, {.technology = Technology::IFX, .record = 1}, "/A", "b", {}),
              "reading,path=/A,technology=IFX text=\"b\",record=1i 0\n");
    EXPECT_EQ(row(*influxNotation(kTwo), kMoment, "/A", "b", {}),
              "reading,code=0xb17f,file=one\\,\\ two.pcap,path=/A,technology=LTE "
              "text=\"b\",record=4711i 1772442000250000000\n");
}

TEST(Notation, TheLineProtocolHoldsHostileTexts) {
    EXPECT_EQ(row(*influxNotation(kOne), {.technology = Technology::IFX, .record = 1}, "/a b,c=d\n\"\\",
                  "say \"x\"\\\n,= \xFF", {}),
              "reading,path=/a\\ b\\,c\\=d\xEF\xBF\xBD\"\xEF\xBF\xBD,technology=IFX "
              "text=\"say \\\"x\\\"\\\\\xEF\xBF\xBD,= \xEF\xBF\xBD\",record=1i 0\n");
}

TEST(Notation, NumbersAreAsShortAsTheyReadBackTheSame) {
    const auto text = [](double number) {
        std::string out;
        appendNumber(out, number);
        return out;
    };
    EXPECT_EQ(text(-95.25), "-95.25");
    EXPECT_EQ(text(12), "12");
    EXPECT_EQ(text(0.1), "0.1");
    EXPECT_EQ(text(27440385), "27440385");
    EXPECT_EQ(text(1e21), "1e+21");
}

TEST(Notation, WhatNoNotationCanWriteIsNoNumber) {
    static const class Infinite final : public Quantity {
        void print(std::string& text, std::int64_t) const override { text = "inf"; }
        std::optional<Measurement> measure(std::int64_t) const override {
            return Measurement{.number = std::numeric_limits<double>::infinity(), .unit = "dB"};
        }
    } kInfinite;
    Value value;
    value.set({.raw = 1, .quantity = &kInfinite});
    EXPECT_FALSE(measurementOf(value));
}

TEST(Notation, TimesHaveMicrosecondsAlsoBefore1970) {
    MomentText text;
    EXPECT_EQ(text.of(CaptureTime(1'234'567'891ns)), "1970-01-01T00:00:01.234567Z");
    EXPECT_EQ(text.of(CaptureTime(1'999'999'999ns)), "1970-01-01T00:00:01.999999Z");
    EXPECT_EQ(text.of(CaptureTime(2s)), "1970-01-01T00:00:02.000000Z");
    EXPECT_EQ(text.of(CaptureTime(-1us)), "1969-12-31T23:59:59.999999Z");
}

}  // namespace
}  // namespace kelvo
