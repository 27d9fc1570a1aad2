#include "LogGenerator/GSMUMTS/SilentSection.h"

#include <gtest/gtest.h>

#include "LogGenerator/GSMUMTS/CellChangeCounters.h"
#include "LogGenerator/GSMUMTS/CodingScheme.h"
#include "LogGenerator/GSMUMTS/NonRankedGSMSet.h"
#include "LogGenerator/GSMUMTS/NonRankedUMTSSet.h"
#include "LogGenerator/GSMUMTS/UMTSRRMeasurement.h"
#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

template <class SectionClass>
void expectSilence(const char* traceWord) {
    const Value part = Dictionary::make({{"Status", "not reported by the modem"}});
    Fed<SectionClass> section(part);
    section.feed(Record(0x417a, 200));
    EXPECT_EQ(part, Value(Dictionary::make({{"Status", "not reported by the modem"}})));
    EXPECT_EQ(section.log(), (Lines{{4, traceWord}}));
    EXPECT_TRUE(section.section().getLogCodeArray().empty());
}

TEST(SilentSection, WritesItsTraceWordAndNothingElse) {
    expectSilence<CellChangeCounters>("CellChangeCounters");
    expectSilence<CodingScheme>("CellChangeCounters");
    expectSilence<UMTSRRMeasurement>("UMTSRRMeasurement");
    expectSilence<NonRankedUMTSSet>("NonRankedUMTSSet");
    expectSilence<NonRankedGSMSet>("NonRankedGSMSet");
}

}  // namespace
}  // namespace kelvo
