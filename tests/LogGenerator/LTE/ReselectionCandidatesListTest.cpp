#include "LogGenerator/LTE/ReselectionCandidatesList.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kTitle = "Reselection Candidates List";

Fed<ReselectionCandidatesList> emptyList() { return Fed<ReselectionCandidatesList>(Value(Array::make())); }

/// One candidate of priority 5, its further fields from offset 25 on.
Record candidate(std::uint32_t type) { return Record(0xB186, 33).u16(19, 1).u16(21, 5).u16(23, type); }

Value row(std::initializer_list<std::pair<std::string_view, Value>> entries) { return Dictionary::make(entries); }

TEST(ReselectionCandidatesList, ShowsTheFieldsOfEachTechnology) {
    const auto shown = [](const Record& record) {
        auto section = emptyList();
        section.feed(record);
        return section.rowCount() == 1 ? (*section.part().array())[0] : Value();
    };
    EXPECT_EQ(
        shown(candidate(0).u16(25, 5780).u16(27, 301 << 7 | 0x7F)),
        row({{"Candidate Priority", "5"}, {"Candidate RAT Type", "LTE"}, {"E ARFCN", "5780"}, {"Cell ID", "301"}}));
    EXPECT_EQ(
        shown(candidate(1).u16(25, 10562).u16(27, 511)),
        row({{"Candidate Priority", "5"}, {"Candidate RAT Type", "UTRAN"}, {"U ARFCN", "10562"}, {"PSC", "511"}}));
    EXPECT_EQ(shown(candidate(2).u16(25, 661).u8(27, 1).u8(28, 63)), row({{"Candidate Priority", "5"},
                                                                          {"Candidate RAT Type", "GERAN"},
                                                                          {"ARFCN", "661"},
                                                                          {"Band", "1"},
                                                                          {"BSIC ID", "63"}}));
    const auto cdma = [](std::uint32_t type) {
        return candidate(type).u16(25, 0xFF0A).u16(27, 0xFFFF).u16(29, 384).u16(31, 508);
    };
    EXPECT_EQ(shown(cdma(3)), row({{"Candidate Priority", "5"},
                                   {"Candidate RAT Type", "CDMA1XRTT"},
                                   {"Band", "10"},
                                   {"Channel", "384"},
                                   {"Pilot", "508"}}));
    EXPECT_EQ(shown(cdma(4)), row({{"Candidate Priority", "5"},
                                   {"Candidate RAT Type", "CDMAHRPD"},
                                   {"Band", "10"},
                                   {"Channel", "384"},
                                   {"Pilot", "508"}}));
    for (std::uint32_t type : {5u, 7u, 256u, 65535u}) {
        EXPECT_EQ(shown(cdma(type)), row({{"Candidate Priority", "5"}, {"Candidate RAT Type", "??"}})) << type;
    }
}

TEST(ReselectionCandidatesList, ShowsTheFieldsInTheirOrder) {
    const std::vector<std::string> fieldsByType[] = {{"E ARFCN", "Cell ID"},
                                                     {"U ARFCN", "PSC"},
                                                     {"ARFCN", "Band", "BSIC ID"},
                                                     {"Band", "Channel", "Pilot"},
                                                     {"Band", "Channel", "Pilot"}};
    auto section = emptyList();
    for (std::uint32_t type = 0; type < 5; ++type) {
        std::vector<std::string> expected = {"Candidate Priority", "Candidate RAT Type"};
        for (const std::string& key : fieldsByType[type]) expected.push_back(key);
        section.feed(candidate(type));
        ASSERT_EQ(section.rowCount(), 1U);
        EXPECT_EQ(test::keysOf((*section.part().array())[0]), expected) << type;
    }
}

TEST(ReselectionCandidatesList, OverlapsCandidatesAtAStrideOfFourBytes) {
    auto section = emptyList();
    section.feed(
        Record(0xB186, 41).u16(19, 3).u16(21, 6).u16(23, 0).u16(25, 1).u16(27, 2).u16(29, 700).u16(31, 0x0304));
    ASSERT_EQ(section.rowCount(), 3U);
    EXPECT_EQ(section.row(0, "Candidate Priority"), "6");
    EXPECT_EQ(section.row(0, "Candidate RAT Type"), "LTE");
    EXPECT_EQ(section.row(0, "E ARFCN"), "1");  // the second candidate's priority
    EXPECT_EQ(section.row(0, "Cell ID"), "0");  // the second candidate's type, shifted away
    EXPECT_EQ(section.row(1, "Candidate Priority"), "1");
    EXPECT_EQ(section.row(1, "Candidate RAT Type"), "GERAN");
    EXPECT_EQ(section.row(1, "ARFCN"), "700");
    EXPECT_EQ(section.row(1, "Band"), "4");
    EXPECT_EQ(section.row(1, "BSIC ID"), "3");
    EXPECT_EQ(section.row(2, "Candidate Priority"), "700");
    EXPECT_EQ(section.row(2, "Candidate RAT Type"), "??");
}

TEST(ReselectionCandidatesList, CountsByTheLowByteAlone) {
    auto section = emptyList();
    section.feed(candidate(0));
    EXPECT_EQ(section.rowCount(), 1U);
    section.feed(candidate(0).u16(19, 256));
    EXPECT_EQ(section.rowCount(), 0U);
    section.feed(candidate(0).u16(19, 0x0201));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, kTitle}, {4, kTitle}}));
}

TEST(ReselectionCandidatesList, KeepsTheRowsWhenARecordIsShortOrOfAnotherCode) {
    auto section = emptyList();
    section.feed(candidate(0));
    section.clearLog();
    section.feed(candidate(1).cut(20), 0xB186);
    section.feed(Record(0xB179, 60));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.row(0, "Candidate RAT Type"), "LTE");
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, kTitle}, {3, "Received an unknown log message: 45433"}}));
}

TEST(ReselectionCandidatesList, ShowsWhatTheRecordHoldsOfACountThatLies) {
    auto section = emptyList();
    section.feed(Record(0xB186, 27).u8(19, 255).u16(21, 5).u16(23, 1).u16(25, 10562));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(0, "U ARFCN"), "10562");
    EXPECT_EQ(section.row(0, "PSC"), "0");  // beyond the end
    EXPECT_EQ(section.row(1, "Candidate Priority"), "10562");
    EXPECT_EQ(section.row(1, "Candidate RAT Type"), "LTE");
    section.feed(Record(0xB186, 21).u8(19, 255));
    EXPECT_EQ(section.rowCount(), 0U);
}

}  // namespace
}  // namespace kelvo
