#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <map>
#include <set>

#include "LogGenerator/GSMUMTS/OSK_GSMClassIndex.h"
#include "LogGenerator/UnknownDataException.h"
#include "platform/system/Environment.h"
#include "tests/support/CellArray.h"
#include "tests/support/Record.h"
#include "tests/support/RecordingLog.h"

namespace kelvo {
namespace {

using test::cell;
using test::cellArray;
using test::payload;
using test::Record;

const std::map<LogCode, std::size_t> kMinimumSizes = {
    {0x4005, 15}, {0x4031, 16}, {0x4116, 16}, {0x4125, 14}, {0x4127, 29}, {0x4157, 19}, {0x417a, 16},
    {0x4221, 18}, {0x5072, 20}, {0x5076, 17}, {0x512c, 17}, {0x5134, 26}, {0x5137, 29}, {0x51f4, 15},
    {0x51f5, 18}, {0x51f6, 24}, {0x51f8, 15}, {0x51fb, 34}, {0x51fd, 35}, {0x51ff, 15}, {0x7130, 16},
    {0x7131, 16}, {0x7132, 16}, {0x7135, 32}, {0x7150, 17},
};

const std::set<std::string_view> kLists = {
    "Active Set",       "Detected Set",      "Equivalent PLMN List", "GSM Set",
    "Monitored Set",    "Neighboring Cells", "Non-Ranked GSM Set",   "Non-Ranked UMTS Set",
    "PDP Context Info", "UMTS Set",          "Virtual Active Set"};

class GSMBadInput : public testing::Test {
protected:
    /// A display part as the section has it, with something to lose.
    static Value partFor(std::string_view name) {
        if (kLists.contains(name)) return Array::make({"row"});
        return Dictionary::make({{"Shown", "before"}});
    }

    /// A record of `size` bytes whose payload is nothing but `fill`.
    static Record filled(LogCode code, std::size_t size, std::uint32_t fill) {
        Record record(code, 0);
        for (std::size_t at = 13; at < size; ++at) record.u8(at, fill);
        return record;
    }

    /// Every section with every code of its own.
    template <class Each>
    void forEachCode(Each each) {
        for (std::string_view name : index.getAllNames()) {
            Base& section = *index.getClass(name);
            for (LogCode code : section.getLogCodeArray()) each(section, code);
        }
    }

    static void feed(Base& section, const Bytes& bytes, LogCode code) {
        try {
            section.updateWithData(bytes, code);
        } catch (const LogCode_0xFF0000::UnknownDataException&) {
            EXPECT_EQ(code, 0xff0000U);
        }
    }

    OSK_GSMClassIndex index;
};

TEST_F(GSMBadInput, ChangesNothingBelowTheMinimumSizeAndSomethingFromItOn) {
    forEachCode([](Base& section, LogCode code) {
        if (code >= kExtendedLogCodes || code == 0x51ff) return;  // identities show with the next measurement only
        const std::size_t minimum = kMinimumSizes.at(code);
        for (std::uint32_t fill : {0x00, 0x01, 0x5A, 0xFF}) {
            const Record record = filled(code, minimum + 2, fill);
            for (std::size_t size = 0; size <= minimum + 2; ++size) {
                const Value part = partFor(section.getSectionName());
                const Value before = part.copy();
                section.updateSectionRef(part);
                feed(section, record.cut(size), code);
                EXPECT_EQ(part == before, size < minimum)
                    << section.getSectionName() << ", code " << code << ", size " << size << ", fill " << fill;
            }
        }
    });
}

TEST_F(GSMBadInput, KeepsNeighborIdentitiesBelowTheMinimumSizeAndForgetsThemFromItOn) {
    Base& section = *index.getClass("Neighboring Cells");
    const Record identity = Record(0x51ff, 19).u8(14, 1).u16(15, 975).u8(17, 42);
    const Record measurement = Record(0x5137, 43).u8(28, 1).u16(29, 975);
    const std::size_t minimum = kMinimumSizes.at(0x51ff);
    for (std::uint32_t fill : {0x00, 0x01, 0x5A, 0xFF}) {
        const Record record = filled(0x51ff, minimum + 2, fill);
        for (std::size_t size = 0; size <= minimum + 2; ++size) {
            const ArrayRef rows = Array::make();
            section.updateSectionRef(rows);
            feed(section, identity.bytes(), 0x51ff);
            feed(section, record.cut(size), 0x51ff);
            feed(section, measurement.bytes(), 0x5137);
            ASSERT_EQ(rows->size(), 1U);
            EXPECT_EQ((*rows)[0].dictionary()->find("BSIC") != nullptr, size < minimum)
                << "size " << size << ", fill " << fill;
        }
    }
}

TEST_F(GSMBadInput, SurvivesAnyRecordUnderAnyCode) {
    for (std::string_view name : index.getAllNames()) {
        Base& section = *index.getClass(name);
        for (const auto& [code, minimum] : kMinimumSizes) {
            for (const Value& part :
                 {partFor(name), Value(), Value("text"), Value(Array::make()), Value(Dictionary::make())}) {
                section.updateSectionRef(part);
                feed(section, Bytes(300, 0xFF), code);
                feed(section, {}, code);
            }
        }
    }
}

TEST_F(GSMBadInput, SurvivesEveryPrefixOfACellArray) {
    const Record array = cellArray({cell("GSM", "Serving", {{"kPLCellMonitorCellId", 1}}), cell("UMTS", "Neighbor")});
    forEachCode([&](Base& section, LogCode code) {
        if (code < kExtendedLogCodes) return;
        for (std::size_t size = 0; size < array.bytes().size(); ++size) {
            section.updateSectionRef(partFor(section.getSectionName()));
            feed(section, array.cut(size), code);
        }
    });
}

const std::vector<Value> kOddValues = {"text",
                                       1,
                                       1.5,
                                       true,
                                       Bytes{1, 2},
                                       Value(Date(std::chrono::milliseconds(1))),
                                       Array::make(),
                                       Array::make({1, "text", Array::make()}),
                                       Dictionary::make({{"key", 1}})};

TEST_F(GSMBadInput, TakesACellArrayOfAnotherTypeForOneWithoutCells) {
    for (std::string_view name :
         {"Serving PLMN", "GSM Serving Cell", "UMTS RR Info", "UMTS Set", "Neighboring Cells"}) {
        Base& section = *index.getClass(name);
        for (const Value& content : kOddValues) {
            const Value part = partFor(name);
            section.updateSectionRef(part);
            test::RecordingLog log;
            const Environment::Scope environment({.log = &log});
            feed(section, payload(0xff0001, content).bytes(), 0xff0001);
            EXPECT_EQ(part, part.array() ? Value(Array::make()) : Value(Dictionary::make({{"Shown", "before"}})))
                << name;
            EXPECT_EQ(log.lines().size(), 1U) << name;  // the trace word
        }
    }
}

TEST_F(GSMBadInput, SkipsCellsWhoseTechnologyOrTypeIsNoText) {
    for (std::string_view name :
         {"Serving PLMN", "GSM Serving Cell", "UMTS RR Info", "UMTS Set", "Neighboring Cells"}) {
        Base& section = *index.getClass(name);
        for (const char* key : {"kPLCellMonitorCellRadioAccessTechnology", "kPLCellMonitorCellType"}) {
            for (const Value& odd : kOddValues) {
                const ArrayRef cells = Array::make();
                for (const char* technology : {"GSM", "UMTS"}) {
                    for (const char* type : {"Serving", "Neighbor"}) {
                        const Value skipped =
                            cell(technology, type, {{"kPLCellMonitorCellId", 1}, {"kPLCellMonitorARFCN", 1}});
                        skipped.dictionary()->set(key, odd);
                        cells->append(skipped);
                    }
                }
                const Value part = partFor(name);
                section.updateSectionRef(part);
                feed(section, payload(0xff0001, cells).bytes(), 0xff0001);
                EXPECT_EQ(part, part.array() ? Value(Array::make()) : Value(Dictionary::make({{"Shown", "before"}})))
                    << name;
            }
        }
    }
}

struct CellValue {
    const char* section;
    const char* technology;
    const char* type;
    const char* cellKey;
    const char* displayKey;
    const char* failure;
};

const std::vector<CellValue> kCellValues = {
    {"Serving PLMN", "GSM", "Serving", "kPLCellMonitorMCC", "Mobile Country Code",
     "ServingPLMN: Failed to retrieve MCC\n"},
    {"Serving PLMN", "UMTS", "Serving", "kPLCellMonitorMNC", "Mobile Network Code",
     "ServingPLMN: Failed to retrieve MNC\n"},
    {"Serving PLMN", "UMTS", "Serving", "kPLCellMonitorLAC", "Location Area Code",
     "ServingPLMN: Failed to retrieve LAC\n"},
    {"UMTS RR Info", "UMTS", "Serving", "kPLCellMonitorCellId", "Cell ID", "UMTSRRInfo: Failed to retrieve Cell ID\n"},
    {"UMTS RR Info", "UMTS", "Serving", "kPLCellMonitorUARFCN", "UARFCN", "UMTSRRInfo: Failed to retrieve UARFCN\n"},
    {"UMTS RR Info", "UMTS", "Serving", "kPLCellMonitorSCN", "Scrambling Code",
     "UMTSRRInfo: Failed to retrieve Scrambling Code\n"},
    {"GSM Serving Cell", "GSM", "Serving", "kPLCellMonitorCellId", "Cell ID",
     "GSMServingCell: Failed to retrieve Cell ID\n"},
    {"GSM Serving Cell", "GSM", "Serving", "kPLCellMonitorARFCN", "ARFCN",
     "GSMServingCell: Failed to retrieve ARFCN\n"},
    {"UMTS Set", "UMTS", "Neighbor", "kPLCellMonitorUARFCN", "UARFCN", "UMTSSet: Failed to retrieve UARFCN\n"},
    {"UMTS Set", "UMTS", "Neighbor", "kPLCellMonitorSCN", "Scrambling Code",
     "UMTSSet: Failed to retrieve Scrambling Code\n"},
    {"UMTS Set", "UMTS", "Neighbor", "kPLCellMonitorRSCP", "RSCP", "UMTSSet: Failed to retrieve RSCP\n"},
    {"UMTS Set", "UMTS", "Neighbor", "kPLCellMonitorECN0", "Energy Per Chip",
     "UMTSSet: Failed to retrieve Energy Per Chip\n"},
    {"Neighboring Cells", "GSM", "Neighbor", "kPLCellMonitorARFCN", "ARFCN",
     "NeighboringCells: Failed to retrieve ARFCN\n"},
    {"Neighboring Cells", "GSM", "Neighbor", "kPLCellMonitorRSSI", "RSSI",
     "NeighboringCells: Failed to retrieve RSSI\n"},
};

TEST_F(GSMBadInput, ReportsACellValueThatIsNo32BitNumberAndLeavesItOut) {
    std::vector<Value> oddNumbers = {std::int64_t{2147483648}, std::int64_t{-2147483649}};
    for (const Value& odd : kOddValues) {
        if (odd != Value(1)) oddNumbers.push_back(odd);
    }
    for (const CellValue& expected : kCellValues) {
        Base& section = *index.getClass(expected.section);
        for (const Value& odd : oddNumbers) {
            const Value part = partFor(expected.section);
            section.updateSectionRef(part);
            test::RecordingLog log;
            const Environment::Scope environment({.log = &log});
            feed(section, cellArray({cell(expected.technology, expected.type, {{expected.cellKey, odd}})}).bytes(),
                 0xff0001);
            const Value& shown = part.array() ? (*part.array())[0] : part;
            EXPECT_EQ(shown.dictionary()->find(expected.displayKey), nullptr) << expected.failure;
            EXPECT_EQ(std::count(log.lines().begin(), log.lines().end(), test::RecordingLog::Line(3, expected.failure)),
                      1)
                << expected.failure;
        }
    }
}

TEST_F(GSMBadInput, ShowsTheEndsOfTheNumberRange) {
    for (const CellValue& expected : kCellValues) {
        if (std::string_view(expected.cellKey) == "kPLCellMonitorRSSI") continue;  // shown doubled
        Base& section = *index.getClass(expected.section);
        for (const std::int64_t end : {std::int64_t{2147483647}, std::int64_t{-2147483648}}) {
            const Value part = partFor(expected.section);
            section.updateSectionRef(part);
            feed(section, cellArray({cell(expected.technology, expected.type, {{expected.cellKey, end}})}).bytes(),
                 0xff0001);
            const Value& shown = (*(part.array() ? (*part.array())[0] : part).dictionary())[expected.displayKey];
            ASSERT_NE(shown.string(), nullptr) << expected.failure;
            EXPECT_EQ(shown.string()->find(std::to_string(end)), 0U) << expected.failure;
        }
    }
}

}  // namespace
}  // namespace kelvo
