#include "platform/encodings/WholeNumber.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

std::string refusal(std::string_view text, std::uint64_t least = 0) {
    const auto number = wholeNumber(text, least);
    return number ? "it was taken" : number.error().reason;
}

TEST(WholeNumber, TakesDigitsFromTheLeastToTheLargest) {
    EXPECT_EQ(*wholeNumber("0"), 0U);
    EXPECT_EQ(*wholeNumber("010"), 10U);  // decimal, whatever it begins with
    EXPECT_EQ(*wholeNumber("3", 3), 3U);
    EXPECT_EQ(*wholeNumber("18446744073709551615"), 18446744073709551615U);
}

TEST(WholeNumber, SaysWhatIsWrongWithAnythingElse) {
    for (const char* text : {"", "-1", "+1", "1.5", "1e3", "0x10", "ten", "7 ", " 7"}) {
        EXPECT_EQ(refusal(text), std::string(text) + " is not a whole number from 0");
    }
    EXPECT_EQ(refusal("2", 3), "2 is not a whole number from 3");
    EXPECT_EQ(refusal("18446744073709551616"),
              "18446744073709551616 is too large; the largest number is 18446744073709551615");
}

}  // namespace
}  // namespace kelvo
