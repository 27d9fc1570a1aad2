#include "LogGenerator/GSMUMTS/OSK_GSMLogGenerator.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

#include "LogGenerator/Factory.h"
#include "LogGenerator/GSMUMTS/OSK_GSMClassIndex.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "tests/support/CapturedOutput.h"
#include "tests/support/CellArray.h"
#include "tests/support/Record.h"
#include "tests/support/RecordingLog.h"

namespace kelvo {
namespace {

using test::cell;
using test::cellArray;
using test::payload;
using test::Record;

constexpr const char* kNoValue = "–";

std::set<std::int64_t> numbers(const Value& array) {
    std::set<std::int64_t> numbers;
    for (const Value& element : *array.array()) numbers.insert(element.number()->integer());
    EXPECT_EQ(numbers.size(), array.array()->size());  // no code twice
    return numbers;
}

/// Every part of `tree` that stands under `name`.
void find(const Value& tree, const std::string& name, std::vector<Value>& found) {
    if (!tree.dictionary()) return;
    for (const auto& [key, value] : *tree.dictionary()) {
        if (key == name) found.push_back(value);
        find(value, name, found);
    }
}

/// One record of every code, each with lists and files in it.
std::vector<Record> everyRecord() {
    std::vector<Record> records;
    for (LogCode code : {0x7130, 0x7131, 0x7132, 0x7135, 0x4125, 0x4127, 0x4157, 0x5134, 0x5137, 0x5076, 0x512c, 0x5072,
                         0x51f4, 0x51f5, 0x51f6, 0x51fb, 0x51fd}) {
        records.emplace_back(code, 43).u8(28, code == 0x5137 ? 1 : 0);
    }
    records.push_back(Record(0x4005, 25).u8(13, 1).u8(14, 1));
    records.push_back(Record(0x4031, 30).u8(14, 1).u16(20, 100));
    records.push_back(Record(0x4116, 25).u8(13, 1));
    records.push_back(Record(0x417a, 75).u8(15, 1));
    records.push_back(Record(0x4221, 189).u8(16, 1).u8(17, 1));
    records.push_back(Record(0x51f8, 17).u8(14, 1));
    records.push_back(Record(0x51ff, 19).u8(14, 1));
    records.push_back(Record(0x7150, 23).u8(16, 1));
    const Value number = 1;
    records.push_back(cellArray({
        cell("GSM", "Serving", {{"kPLCellMonitorCellId", number}, {"kPLCellMonitorARFCN", number}}),
        cell("UMTS", "Serving",
             {{"kPLCellMonitorCellId", number}, {"kPLCellMonitorUARFCN", number}, {"kPLCellMonitorSCN", number}}),
        cell("UMTS", "Neighbor"),
        cell("GSM", "Neighbor"),
    }));
    const DictionaryRef files = Dictionary::make();
    for (const char* file : {"ICCID", "MSISDN", "MBDN", "HPPLMN", "LOCI", "PSLOCI", "ACC", "AD", "FPLMN", "AHPLMN",
                             "RATMODE", "PNN", "OPL", "OPLMNAcT"}) {
        files->set("kSimFile_" + std::string(file), "content");
    }
    records.push_back(payload(0xff0000, files));
    records.push_back(payload(0xff0002, Array::make({"context"})));
    return records;
}

class OSK_GSM : public testing::Test {
protected:
    Value display() { return state["Display"]; }
    Value section(std::string_view name) {
        std::vector<Value> found;
        find(display(), std::string(name), found);
        return found.size() == 1 ? found.front() : Value();
    }
    std::string shown(const char* name, const char* key) {
        const Value& value = (*section(name).dictionary())[key];
        return value.string() != nullptr ? *value.string() : "(absent)";
    }
    std::ptrdiff_t logged(int level, std::string_view text) {
        return std::count(log.lines().begin(), log.lines().end(), test::RecordingLog::Line(level, std::string(text)));
    }

    const DirectoryResources resources{KELVO_RESOURCE_DIR};
    test::RecordingLog log;
    Environment::Scope environment{{.log = &log, .resources = &resources}};
    Dictionary state;
};

TEST_F(OSK_GSM, IsTheGeneratorOfTheGsmTechnology) {
    const auto generator = generatorFromTechnology("kPLLogChannelTechnology_Oskra_GSM");
    EXPECT_NE(dynamic_cast<OSK_GSMLogGenerator*>(generator.get()), nullptr);
}

TEST_F(OSK_GSM, SaysThatItIsCreatedAndDestructed) {
    { const OSK_GSMLogGenerator generator; }
    const auto& lines = log.lines();
    EXPECT_EQ(lines.front(), test::RecordingLog::Line(3, "Creating OSK_GSMLogGenerator object"));
    for (std::size_t fromEnd : {1, 2}) {  // its own line and that of every template generator
        EXPECT_EQ(lines[lines.size() - fromEnd].second.find("OSK_GSMLogGenerator is destructed 0x"), 0U);
        EXPECT_EQ(lines[lines.size() - fromEnd].first, 4);
    }
}

TEST_F(OSK_GSM, SaysOnStandardOutputThatItsSectionsGo) {
    const test::CapturedOutput output;
    {
        const Environment::Scope printing({.standardOutput = output.file()});
        const OSK_GSMLogGenerator generator;
    }
    EXPECT_EQ(output.text(), "Deallocing OSK_GSMClassIndex\nDeallocing ClassIndex\n");
}

TEST_F(OSK_GSM, AsksForTheCodesOfItsSectionsEachOnce) {
    OSK_GSMLogGenerator generator;
    const DictionaryRef command = generator.getStartCommand();
    EXPECT_EQ((*command)["SetState"], Value("Streaming"));
    EXPECT_EQ(numbers((*command)["SetOskraLogCodes"]),
              (std::set<std::int64_t>{0x4005, 0x4031, 0x4116, 0x4125, 0x4127, 0x4157, 0x417a, 0x4221, 0x5072,
                                      0x5076, 0x512c, 0x5134, 0x5137, 0x51f4, 0x51f5, 0x51f6, 0x51f8, 0x51fb,
                                      0x51fd, 0x51ff, 0x7130, 0x7131, 0x7132, 0x7135, 0x7150}));
    EXPECT_EQ(numbers((*command)["SetPlExtraCodes"]), (std::set<std::int64_t>{0, 1, 2}));
}

TEST_F(OSK_GSM, HasOnePlaceOnTheScreensForEverySection) {
    OSK_GSMLogGenerator generator;
    generator.generateLogUsingState(state);
    ASSERT_TRUE(display());
    const OSK_GSMClassIndex index;
    for (std::string_view name : index.getAllNames()) {
        EXPECT_EQ(logged(4, name), 1) << name;  // written when a section is bound
        EXPECT_TRUE(section(name)) << name;
    }
}

TEST_F(OSK_GSM, GroupsTheSectionsUnderNumberedTitles) {
    OSK_GSMLogGenerator generator;
    generator.generateLogUsingState(state);
    std::vector<std::string> keys;
    for (const auto& [key, value] : *display().dictionary()) keys.push_back(key);
    EXPECT_EQ(keys, (std::vector<std::string>{"_sorted", "01;Registration and Network", "02;UMTS Cells",
                                              "03;UMTS Radio", "04;GSM Cell and Neighbours", "05;GPRS",
                                              "06;SIM and Data Contexts", "07;Counters"}));
}

TEST_F(OSK_GSM, HasAPlaceOnTheScreensForEveryValue) {
    OSK_GSMLogGenerator generator;
    generator.generateLogUsingState(state);
    const Value before = display().copy();
    for (const Record& record : everyRecord()) generator.updateState(state, record.bytes());

    const OSK_GSMClassIndex index;
    for (std::string_view name : index.getAllNames()) {
        std::vector<Value> templatePart;
        find(before, std::string(name), templatePart);
        ASSERT_EQ(templatePart.size(), 1U);
        if (!section(name).dictionary()) continue;
        for (const auto& [key, value] : *section(name).dictionary()) {
            const bool comesAndGoes = name == "UMTS RR Info" && key == "UARFCN";
            EXPECT_EQ(templatePart.front().dictionary()->find(key) == nullptr, comesAndGoes) << name << ": " << key;
            EXPECT_NE(value, Value(kNoValue)) << name << ": " << key << " is never written";
        }
    }
}

TEST_F(OSK_GSM, FillsEveryListThatHasRecords) {
    OSK_GSMLogGenerator generator;
    for (const Record& record : everyRecord()) {
        if (record.code() != 0xff0001) generator.updateState(state, record.bytes());
    }
    for (const char* name :
         {"Active Set", "UMTS Set", "GSM Set", "Neighboring Cells", "Equivalent PLMN List", "PDP Context Info"}) {
        EXPECT_EQ(section(name).array()->size(), 1U) << name;
    }
    for (const char* name :
         {"Detected Set", "Monitored Set", "Virtual Active Set", "Non-Ranked UMTS Set", "Non-Ranked GSM Set"}) {
        EXPECT_TRUE(section(name).array()->empty()) << name;
    }
    for (const char* name : {"Coding Scheme", "Cell Change Counters", "UMTS RR Measurement"}) {
        EXPECT_EQ(section(name), Value(Dictionary::make())) << name;  // nothing that a record could fill
    }
}

TEST_F(OSK_GSM, OffersASearcherRecordToFourSectionsThatShowItEachInItsOwnPlace) {
    OSK_GSMLogGenerator generator;
    generator.generateLogUsingState(state);
    for (const char* name : {"Active Set", "Detected Set", "Monitored Set", "Virtual Active Set"}) {
        section(name).array()->append("row");
    }
    log.clear();
    generator.updateState(state, Record(0x417a, 75)
                                     .u16(13, static_cast<std::uint32_t>(-700))
                                     .u8(15, 1)
                                     .u16(23, 301)    // of the active set
                                     .u32(63, 90000)  // -8 dB
                                     .bytes());
    EXPECT_EQ(section("Active Set"),
              Value(Array::make({Dictionary::make(
                  {{"Scrambling Code", "301"}, {"RSCP", "-132 dB"}, {"Energy Per Chip", "-8 dB"}})})));
    for (const char* name : {"Detected Set", "Monitored Set", "Virtual Active Set"}) {
        EXPECT_EQ(section(name), Value(Array::make())) << name;
    }
    EXPECT_EQ(log.lines(), (std::vector<test::RecordingLog::Line>{
                               {4, "ActiveSet"}, {4, "DetectedSet"}, {4, "MonitoredSet"}, {4, "VirtualActiveSet"}}));
}

TEST_F(OSK_GSM, IgnoresARecordThatNoSectionSubscribedTo) {
    OSK_GSMLogGenerator generator;
    generator.generateLogUsingState(state);
    const Value before = display().copy();
    ASSERT_TRUE(before);
    log.clear();
    for (LogCode code : {0x4222, 0xff4221}) generator.updateState(state, Record(code, 40).bytes());
    EXPECT_EQ(display(), before);
    EXPECT_TRUE(log.lines().empty());
}

TEST_F(OSK_GSM, ShowsTheSameMeasurementInTwoWays) {
    OSK_GSMLogGenerator generator;
    generator.updateState(state, Record(0x5137, 29).u8(15, 60).u32(16, 65541).bytes());
    EXPECT_EQ(shown("GSM Serving Cell", "RSSI"), "60 dBm");
    EXPECT_EQ(shown("GSM Serving Cell", "C1 Value"), "5");
    EXPECT_EQ(shown("GSM RR Info", "Serving Rx Level"), "60");
    EXPECT_EQ(shown("GSM RR Info", "Rx Quality Full"), "65541");
}

TEST_F(OSK_GSM, GoesOnAfterADamagedSimRecord) {
    OSK_GSMLogGenerator generator;
    const Record damaged = Record(0xff0000, 13).text(13, "<plist><dict>");
    const Record after = Record(0x7130, 16).u8(13, 3);
    generator.updateState(state, damaged.bytes());
    generator.updateState(state, after.bytes());
    EXPECT_EQ(logged(3, "SIM File dictionary data could not be constructed"), 1);
    EXPECT_EQ(shown("Process PS", "MM State"), "GMM_REGISTERED");
    EXPECT_EQ(shown("SIM Info", "EF-ICCID"), kNoValue);

    generator.generateLogUsingState(state);
    Bytes both = damaged.bytes();
    both.insert(both.end(), after.bytes().begin(), after.bytes().end());
    EXPECT_EQ(state["DisplayState"], Value(both));
}

TEST_F(OSK_GSM, GoesOnFillingTheScreensThatItsPredecessorLeft) {
    { OSK_GSMLogGenerator().updateState(state, Record(0x7130, 16).u8(13, 3).bytes()); }
    OSK_GSMLogGenerator generator;
    generator.updateState(state, Record(0x7131, 16).u8(13, 19).bytes());
    EXPECT_EQ(shown("Process PS", "MM State"), "GMM_REGISTERED");
    EXPECT_EQ(shown("Process CS", "MM State"), "MM_IDLE");
}

}  // namespace
}  // namespace kelvo
