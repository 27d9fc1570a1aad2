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
void expectSilence(const char* traceWord, const Value& part) {
    Fed<SectionClass> section(part.copy());
    section.feed(Record(0x417a, 200));
    EXPECT_EQ(section.part(), part);
    EXPECT_EQ(section.log(), (Lines{{4, traceWord}}));
    EXPECT_TRUE(section.section().getLogCodeArray().empty());
}

TEST(SilentSection, WritesItsTraceWordAndNothingElse) {
    const Value values = Dictionary::make({{"Shown", "before"}});
    const Value list = Array::make({"row"});
    expectSilence<CellChangeCounters>("CellChangeCounters", values);
    expectSilence<CodingScheme>("CellChangeCounters", values);
    expectSilence<UMTSRRMeasurement>("UMTSRRMeasurement", values);
    expectSilence<NonRankedUMTSSet>("NonRankedUMTSSet", list);
    expectSilence<NonRankedGSMSet>("NonRankedGSMSet", list);
}

}  // namespace
}  // namespace kelvo
