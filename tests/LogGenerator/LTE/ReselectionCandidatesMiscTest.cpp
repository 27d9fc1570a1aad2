#include "LogGenerator/LTE/ReselectionCandidatesMisc.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kTitle = "Reselection Candidates";

TEST(ReselectionCandidatesMisc, ShowsEveryField) {
    Fed<ReselectionCandidatesMisc> section(Record(0xB186, 21).u8(13, 2).u16(15, 5780).u16(17, 301));
    EXPECT_EQ(section["Version"], "2");
    EXPECT_EQ(section["Serving EARFCN"], "5780");
    EXPECT_EQ(section["Serving Cell ID"], "301");
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}}));
}

TEST(ReselectionCandidatesMisc, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<ReselectionCandidatesMisc> section(Record(0xB186, 20).u8(13, 2));
    section.feed(Record(0xB180, 40));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, kTitle}, {3, "Received an unknown log message: 45440"}}));
}

}  // namespace
}  // namespace kelvo
