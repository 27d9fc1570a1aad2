#include "platform/values/Value.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <limits>
#include <string>
#include <unordered_map>
#include <vector>

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

/// Texts of six characters that leave an FNV-1a hash as it is at its start, so that every row of them has one hash:
/// found by going three characters forward and three back.
std::vector<std::string> textsThatLeaveTheHashAlone() {
    constexpr std::uint32_t kStart = 2166136261;
    constexpr std::uint32_t kPrime = 16777619;
    constexpr std::uint32_t kInverse = 899433627;
    std::unordered_multimap<std::uint32_t, std::string> halves;
    std::vector<std::string> texts;
    for (std::uint32_t i = 0; i < 1 << 19; ++i) {
        const std::string half{static_cast<char>(i), static_cast<char>(i >> 8), static_cast<char>(i >> 16)};
        std::uint32_t hash = kStart;
        for (const char c : half) hash = (hash ^ static_cast<std::uint8_t>(c)) * kPrime;
        halves.emplace(hash, half);
    }
    for (std::uint32_t i = 0; i < 1 << 19; ++i) {
        const std::string half{static_cast<char>(i), static_cast<char>(i >> 8), static_cast<char>(i >> 16)};
        std::uint32_t hash = kStart;
        for (auto c = half.rbegin(); c != half.rend(); ++c) hash = (hash * kInverse) ^ static_cast<std::uint8_t>(*c);
        const auto [first, last] = halves.equal_range(hash);
        for (auto hit = first; hit != last; ++hit) texts.push_back(hit->second + half);
    }
    return texts;
}

// Compared one by one, these keys would take minutes.
TEST(Dictionary, IsNotSlowedDownByKeysMadeToShareOneHash) {
    const std::vector<std::string> parts = textsThatLeaveTheHashAlone();
    std::vector<std::string> keys;
    for (const std::string& a : parts)
        for (const std::string& b : parts)
            for (const std::string& c : parts) keys.push_back(a + b + c);
    ASSERT_GT(keys.size(), 50'000U);
    keys.resize(50'000);
    ASSERT_EQ(Key(keys.front()).hash(), Key(keys.back()).hash());
    Dictionary dictionary;
    for (const std::string& key : keys) dictionary.set(key, 1);
    ASSERT_EQ(dictionary.size(), keys.size());
    EXPECT_TRUE(std::all_of(keys.begin(), keys.end(), [&](const std::string& key) { return dictionary.find(key); }));
}

TEST(Dictionary, FindsItsKeysWhateverSizeItGrowsAndShrinksTo) {
    Dictionary dictionary;
    for (int i = 0; i < 1100; ++i) dictionary.set(std::to_string(i), i);
    const DictionaryRef copy = dictionary.copy();
    for (int i = 0; i < 1080; ++i) EXPECT_TRUE(dictionary.remove(std::to_string(i)));
    for (int i = 0; i < 1100; ++i) EXPECT_EQ(dictionary.find(std::to_string(i)) != nullptr, i >= 1080) << i;
    for (int i = 0; i < 1080; ++i) dictionary.set(std::to_string(i), -i);
    for (int i = 0; i < 1100; ++i) {
        EXPECT_EQ(dictionary[std::to_string(i)].number()->integer(), i >= 1080 ? i : -i);
        EXPECT_EQ((*copy)[std::to_string(i)].number()->integer(), i);
    }
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

TEST(Dictionary, RewritesItsEntriesInTheirPlaces) {
    const DictionaryRef row = Dictionary::make({{"a", "1"}, {"b", "2"}, {"c", "3"}});
    const Value* second = row->find("b");
    {
        Dictionary::Rewrite rewrite(*row);
        rewrite.next("a") = "4";
        rewrite.next("b") = "5";
    }
    EXPECT_EQ(row->find("b"), second);
    EXPECT_EQ(row->size(), 2U);
    {
        Dictionary::Rewrite rewrite(*row);
        rewrite.next("b") = "6";
        rewrite.next("a") = "7";
    }
    std::string order;
    for (const auto& entry : *row) order += entry.key + *entry.value.string();
    EXPECT_EQ(order, "b6a7");
}

TEST(Dictionary, RewritesALargeOneIntoASmallOneAndBack) {
    Dictionary large;
    const auto rewrite = [&](int entries) {
        Dictionary::Rewrite rewrite(large);
        for (int i = 0; i < entries; ++i) rewrite.next(std::to_string(i)) = i;
    };
    for (const int entries : {100, 10, 50}) {
        rewrite(entries);
        EXPECT_EQ(large.size(), static_cast<std::size_t>(entries));
        for (int i = 0; i < 100; ++i) EXPECT_EQ(large.find(std::to_string(i)) != nullptr, i < entries) << i;
    }
}

/// Prints the number, and counts how often it did.
void printAndCount(std::string& text, std::int64_t raw, const void* how) {
    text = std::to_string(raw);
    ++**static_cast<int* const*>(how);
}

TEST(Value, WritesATextWhenItIsReadAndOnce) {
    static int prints;
    static int* const kCounter = &prints;
    prints = 0;
    Value value = "before";
    for (int raw = 0; raw < 10; ++raw) value.set({.raw = raw, .how = &kCounter, .print = printAndCount});
    EXPECT_EQ(value.kind(), Value::Kind::String);
    EXPECT_TRUE(value);
    EXPECT_EQ(prints, 0);
    EXPECT_EQ(*value.string(), "9");
    EXPECT_EQ(*value.string(), "9");
    EXPECT_EQ(prints, 1);
}

TEST(Value, IsAStringLikeAnyOtherWhileItsTextIsUnwritten) {
    static int prints;
    static int* const kCounter = &prints;
    Value value;
    value.set({.raw = 7, .how = &kCounter, .print = printAndCount});
    const Value copy = value.copy();
    value = "later";
    EXPECT_EQ(copy, Value("7"));
    EXPECT_EQ(copy.number(), nullptr);
    Value text = copy;
    text.set({.raw = 8, .how = &kCounter, .print = printAndCount});
    text.text() += " dB";
    EXPECT_EQ(text, Value("8 dB"));
}

TEST(Value, BecomesAStringWhateverItWas) {
    Value value = 7;
    value.text() = "seven";
    EXPECT_EQ(*value.string(), "seven");
    EXPECT_EQ(value.number(), nullptr);
}

}  // namespace
}  // namespace kelvo
