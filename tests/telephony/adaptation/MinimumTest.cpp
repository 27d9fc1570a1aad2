#include "telephony/adaptation/Minimum.h"

#include <gtest/gtest.h>

#include "LogGenerator/CodeNames.h"
#include "telephony/adaptation/RecordAdapter.h"
#include "tests/support/Record.h"

namespace kelvo {
namespace {

using adaptation::Adapted;
using adaptation::Refusal;

void expectAnyLayout(std::span<const KnownCode> family) {
    for (const KnownCode& known : family) {
        adaptation::RecordAdapter adapter;
        const Bytes packet = test::Record(known.code, 2000).bytes();
        const Adapted adapted = adapter.adapt(packet);
        EXPECT_FALSE(adapted.outcome == Adapted::Outcome::Refused && adapted.refusal == Refusal::NotOurs) << known.name;
    }
}

// A code that the sections take and the adapter does not know would never come from a modem's port.
TEST(Minimum, HasEveryCodeThatScreensShow) {
    expectAnyLayout(code::kCDMA);
    expectAnyLayout(code::kGSMUMTS);
    expectAnyLayout(code::kLTE);
    expectAnyLayout(code::kUTRAN);
}

TEST(Minimum, RefusesACodeThatNoScreenShows) {
    EXPECT_EQ(adaptation::lengthRefusal(0xB195, test::Record(0xB195, 100).bytes()), Refusal::NotOurs);
}

TEST(Minimum, IsTheLeastLengthOfARecord) {
    EXPECT_EQ(adaptation::lengthRefusal(0xB186, test::Record(0xB186, 20).bytes()), Refusal::TooShort);
    EXPECT_EQ(adaptation::lengthRefusal(0xB186, test::Record(0xB186, 21).bytes()), std::nullopt);
}

}  // namespace
}  // namespace kelvo
