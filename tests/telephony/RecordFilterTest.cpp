#include "telephony/RecordFilter.h"

#include <gtest/gtest.h>

using kelvo::Bytes;
using kelvo::RecordFilter;

namespace {

std::shared_ptr<const RecordFilter::Codes> only(std::size_t code) {
    auto codes = std::make_shared<RecordFilter::Codes>();
    codes->set(code);
    return codes;
}

// A record of `type` with the code's bytes at offset 3, low byte first.
Bytes record(std::uint8_t type, std::uint8_t low, std::uint8_t high) { return {type, 0, 0, low, high, 0, 0}; }

}  // namespace

TEST(RecordFilter, LetsNothingPassUntilItIsAsked) {
    EXPECT_FALSE(RecordFilter().passes(record(1, 0xC2, 0xB0)));
    EXPECT_FALSE(RecordFilter().passes({}));
}

TEST(RecordFilter, TellsOrdinaryFromExtendedCodes) {
    RecordFilter filter;
    filter.setOrdinaryCodes(only(0xB0C2));
    filter.setExtendedCodes(only(0x0001));
    EXPECT_TRUE(filter.passes(record(1, 0xC2, 0xB0)));
    EXPECT_FALSE(filter.passes(record(255, 0xC2, 0xB0)));
    EXPECT_TRUE(filter.passes(record(255, 0x01, 0x00)));
    EXPECT_FALSE(filter.passes(record(1, 0x01, 0x00)));
    EXPECT_FALSE(filter.passes(record(1, 0xB0, 0xC2)));
}

TEST(RecordFilter, ReadsTheCodeBehindThePrefix) {
    RecordFilter filter;
    filter.setOrdinaryCodes(only(0xB0C2));
    EXPECT_TRUE(filter.passes(Bytes{0x81, 0x55, 1, 0, 0, 0xC2, 0xB0}));
    EXPECT_FALSE(filter.passes(Bytes{0x81, 0x55, 1, 0xC2, 0xB0, 0, 0}));
}

TEST(RecordFilter, LetsNoRecordPassThatIsTooShortForACode) {
    RecordFilter filter;
    filter.setOrdinaryCodes(only(0));
    EXPECT_FALSE(filter.passes({}));
    EXPECT_FALSE(filter.passes(Bytes{0x81}));
    EXPECT_FALSE(filter.passes(Bytes{1, 0, 0, 0}));
    EXPECT_FALSE(filter.passes(Bytes{0x81, 0, 1, 0, 0, 0}));
    EXPECT_TRUE(filter.passes(Bytes{1, 0, 0, 0, 0}));
}

TEST(RecordFilter, LetsEverythingPassForRecordsWithoutCodes) {
    RecordFilter filter;
    filter.passEverything();
    EXPECT_TRUE(filter.passes({}));
    EXPECT_TRUE(filter.passes(Bytes{'<'}));
}
