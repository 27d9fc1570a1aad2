#include "telephony/simulation/RadioNumbers.h"

#include <gtest/gtest.h>

#include <type_traits>

using namespace kelvo::simulation;

TEST(RadioNumbers, TakeTheirWholeRangeAndNothingBeyond) {
    EXPECT_EQ(Pci(0), 0);
    EXPECT_EQ(Pci(503), 503);
    EXPECT_THROW(Pci(504), std::out_of_range);
    EXPECT_THROW(Pci(-1), std::out_of_range);
    EXPECT_THROW(Arfcn(1024), std::out_of_range);
    EXPECT_THROW(Bsic(64), std::out_of_range);
    EXPECT_THROW(PnOffset(512), std::out_of_range);
}

TEST(RadioNumbers, AreNoOtherNumber) {
    EXPECT_FALSE((std::is_convertible_v<int, Psc>));
    EXPECT_FALSE((std::is_convertible_v<Uarfcn, Arfcn>));
    EXPECT_TRUE((std::is_convertible_v<Arfcn, int>));
}
