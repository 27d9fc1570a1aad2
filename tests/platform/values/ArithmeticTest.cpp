// What every processor has to agree on, so that all of them show the same texts.
#include <gtest/gtest.h>

#include <type_traits>

namespace {

static_assert(std::is_signed_v<char>);

TEST(Arithmetic, RoundsAProductBeforeSomethingIsAddedToIt) {
    volatile double factor = 0x1.0000002p0;  // 1 + 2^-27
    volatile double rounded =
        0x1.0000004p0;  // its square is 1 + 2^-26 + 2^-54, of which the last is past a double's end
    EXPECT_EQ(factor * factor - rounded, 0.0);
}

}  // namespace
