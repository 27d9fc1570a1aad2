#include "LogGenerator/PhoneServices/PDPContextList.h"

#include <gtest/gtest.h>

#include "tests/support/CellArray.h"
#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

using test::payload;

TEST(PDPContextList, ShowsTheContextsAsDelivered) {
    const Value context = Dictionary::make({{"APN", "internet"}, {"NSAPI", 5}, {"QoS", Array::make({1.5, true})}});
    Fed<PDPContextList> section(Array::make({"old"}));
    section.feed(payload(0xff0002, Array::make({context, "text"})));
    EXPECT_EQ(section.part(), Value(Array::make({context, "text"})));
    EXPECT_EQ(section.log(), (Lines{{4, "PDPContextList"}}));
    section.feed(payload(0xff0002, Array::make()));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST(PDPContextList, KeepsTheArrayOfTheDisplay) {
    const Value part = Array::make();
    Fed<PDPContextList> section(part);
    section.feed(payload(0xff0002, Array::make({"context"})));
    EXPECT_EQ(part.array()->size(), 1U);
}

TEST(PDPContextList, ChangesNothingForAnythingButAnArray) {
    Fed<PDPContextList> section(Array::make({"old"}));
    section.feed(payload(0xff0002, Dictionary::make({{"APN", "internet"}})));
    section.feed(payload(0xff0002, "text"));
    section.feed(Record(0xff0002, 13).text(13, "<plist><array>"));
    section.feed(Record(0xff0002, 13));
    EXPECT_EQ(section.part(), Value(Array::make({"old"})));
    EXPECT_EQ(section.log(), (Lines(4, {4, "PDPContextList"})));
}

TEST(PDPContextList, ReportsACodeOfOthers) {
    Fed<PDPContextList> section(Array::make({"old"}));
    section.feed(payload(0xff0001, Array::make()));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.log(), (Lines{{4, "PDPContextList"}, {3, "Received an unknown log message: 16711681"}}));
}

}  // namespace
}  // namespace kelvo
