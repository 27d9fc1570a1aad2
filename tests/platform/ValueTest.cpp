#include "platform/Value.h"

#include <gtest/gtest.h>

#include <limits>

namespace kelvo {
namespace {

TEST(Dictionary, KeepsTheOrderInWhichKeysWereFirstSet) {
    const DictionaryRef cell = Dictionary::make({{"b", "1"}, {"a", "2"}, {"c", "3"}});
    cell->set("a", "4");
    cell->remove("b");
    cell->set("b", "5");
    std::string order;
    for (const auto& entry : *cell) order += entry.key + *entry.value.string();
    EXPECT_EQ(order, "a4c3b5");
}

TEST(Dictionary, FindsEveryKeyOfALargeOneAlsoAfterRemovals) {
    Dictionary large;
    for (int i = 0; i < 1000; ++i) large.set(std::to_string(i), i);
    for (int i = 0; i < 1000; i += 2) EXPECT_TRUE(large.remove(std::to_string(i)));
    for (int i = 0; i < 1000; ++i) EXPECT_EQ(large.find(std::to_string(i)) != nullptr, i % 2 == 1) << i;
    EXPECT_EQ(large["999"].number()->integer(), 999);
}

TEST(Value, SharesArraysAndDictionariesUntilTheyAreCopied) {
    const DictionaryRef row = Dictionary::make({{"Cell ID", "1"}});
    const Value shared = row;
    const Value copy = shared.copy();
    row->set("Cell ID", "2");
    EXPECT_EQ(*shared.dictionary()->find("Cell ID")->string(), "2");
    EXPECT_EQ(*copy.dictionary()->find("Cell ID")->string(), "1");
}

TEST(Value, ComparesDeeplyAndDictionariesWithoutTheirOrder) {
    const Value a = Dictionary::make({{"x", Array::make({1, "two"})}, {"y", true}});
    const Value b = Dictionary::make({{"y", true}, {"x", Array::make({1, "two"})}});
    EXPECT_EQ(a, b);
    b.dictionary()->set("y", false);
    EXPECT_FALSE(a == b);
    EXPECT_FALSE(Value("1") == Value(1));
}

TEST(Number, FitsThirtyTwoBitsOnlyWhenNothingIsLost) {
    EXPECT_EQ(Number(std::int64_t{-2147483648}).int32(), std::numeric_limits<std::int32_t>::min());
    EXPECT_EQ(Number(std::int64_t{2147483648}).int32(), std::nullopt);
    EXPECT_EQ(Number(3.0).int32(), 3);
    EXPECT_EQ(Number(3.5).int32(), std::nullopt);
    EXPECT_EQ(Number(std::numeric_limits<double>::quiet_NaN()).int32(), std::nullopt);
    EXPECT_EQ(Number(1e300).int32(), std::nullopt);
}

TEST(Value, BecomesAStringWhateverItWas) {
    Value value = 7;
    value.text() = "seven";
    EXPECT_EQ(*value.string(), "seven");
    EXPECT_EQ(value.number(), nullptr);
}

}  // namespace
}  // namespace kelvo
