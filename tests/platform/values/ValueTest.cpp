#include "platform/values/Value.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
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

TEST(Dictionary, WritesWhereTheKeyIsWhateverWasWrittenBefore) {
    Dictionary values;
    for (const char* key : {"Cell ID", "TAC", "Physical Cell ID", "ab", "Band"}) values.set(key, key);
    const auto valueAt = [&](int position) { return *std::next(values.begin(), position)->value.string(); };
    values.set("Physical Cell ID", "in between");
    values.set("ab", "behind it");
    values.set("Cell ID", "back to the first");
    values.set("Band", "the last");
    values.set("Cell ID", "and round");
    EXPECT_EQ(valueAt(0), "and round");
    EXPECT_EQ(valueAt(1), "TAC");
    EXPECT_EQ(valueAt(2), "in between");
    EXPECT_EQ(valueAt(3), "behind it");
    EXPECT_EQ(valueAt(4), "the last");

    values.set("Physical Cell ID", "before one that goes");
    EXPECT_TRUE(values.remove("ab"));
    values.set("Band", "one place up");
    EXPECT_TRUE(values.remove("Band"));
    values.set("TAC", "where nothing follows");
    EXPECT_EQ(valueAt(0), "and round");
    EXPECT_EQ(valueAt(1), "where nothing follows");
    EXPECT_EQ(valueAt(2), "before one that goes");
    EXPECT_EQ(values.size(), 3U);
    { const Dictionary::Rewrite nothing(values); }
    values.set("Band", "in an empty one");
    EXPECT_EQ(values.size(), 1U);
}

TEST(Key, TextsOfEveryLengthAreTheSameWhenEveryCharacterIs) {
    for (std::size_t size = 0; size <= 40; ++size) {
        const std::string text = std::string("Num of Consecutive DRX Cycles of S < 0 ..").substr(0, size);
        EXPECT_TRUE(isSameText(text, std::string(text)));
        EXPECT_FALSE(isSameText(text, text + "x"));
        for (std::size_t at = 0; at < size; ++at) {
            std::string other = text;
            other[at] = '#';
            EXPECT_FALSE(isSameText(text, other)) << other;
        }
    }
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

/// Shows a raw number in halves of a decibel, nothing at 99, and counts how often it printed.
class HalfDecibels final : public Quantity {
public:
    void print(std::string& text, std::int64_t raw) const override {
        text = std::to_string(raw) + "/2 dB";
        ++prints;
    }
    std::optional<Measurement> measure(std::int64_t raw) const override {
        if (raw == 99) return std::nullopt;
        return Measurement{static_cast<double>(raw) / 2, "dB"};
    }
    mutable int prints = 0;
};

TEST(Value, PrintsAReadingWhenItIsReadAndOnce) {
    static const HalfDecibels quantity;
    Value value = "before";
    for (int raw = 0; raw < 10; ++raw) value.set({.raw = raw, .quantity = &quantity});
    EXPECT_EQ(value.kind(), Value::Kind::String);
    EXPECT_TRUE(value);
    EXPECT_EQ(quantity.prints, 0);
    EXPECT_EQ(*value.string(), "9/2 dB");
    EXPECT_EQ(*value.string(), "9/2 dB");
    EXPECT_EQ(quantity.prints, 1);
    value.set({.raw = 10, .quantity = &quantity});
    EXPECT_EQ(*value.string(), "10/2 dB");
}

#if defined(__GLIBCXX__) && defined(__x86_64__)
// 40 bytes of what is shown, and eight for the record that wrote it.
static_assert(sizeof(Value) == 40 + 8 && sizeof(Reading) == 24 && sizeof(Place) == 8);
#endif

TEST(Value, KeepsTheNumberOfTheRecordWhoeverCopiesIt) {
    Value text = "a text";
    EXPECT_EQ(text.record(), 0U);
    text.setRecord(4711);
    const Value row = Dictionary::make({{"key", text}});
    EXPECT_EQ((*row.copy().dictionary())["key"].record(), 4711U);
    EXPECT_EQ(text, Value("a text"));  // whoever wrote it
    text.text() = "another";
    EXPECT_EQ(text.record(), 4711U);
    text = "a new value";
    EXPECT_EQ(text.record(), 0U);
}

TEST(Value, KeepsTheNumberOfAReadingBesideItsText) {
    static const HalfDecibels quantity;
    Value value;
    value.set({.raw = -3, .quantity = &quantity, .place = Place(21, 4, 9, 9, false)}, 0xFFFFFFFFFFFFFFFF);
    for (const char* when : {"before it is printed", "afterwards"}) {
        SCOPED_TRACE(when);
        ASSERT_TRUE(value.measurement());
        EXPECT_DOUBLE_EQ(value.measurement()->number, -1.5);
        EXPECT_EQ(value.measurement()->unit, "dB");
        ASSERT_NE(value.reading(), nullptr);
        EXPECT_EQ(value.reading()->raw, -3);
        EXPECT_EQ(value.reading()->quantity, &quantity);
        EXPECT_EQ(value.reading()->place.at(), 21U);
        EXPECT_EQ(value.reading()->place.lowBit(), 9);
        EXPECT_EQ(value.record(), 0xFFFFFFFFFFFFFFFF);
        EXPECT_EQ(value, Value("-3/2 dB"));
    }
    EXPECT_EQ(value.copy().measurement()->number, -1.5);
    value.set({.raw = 99, .quantity = &quantity});
    EXPECT_FALSE(value.measurement());
    EXPECT_EQ(value.reading()->raw, 99);
    EXPECT_FALSE(value.reading()->place);
    EXPECT_EQ(value.record(), 0U);
}

TEST(Value, HasNoReadingWhenNoRecordStandsBehindIt) {
    static const HalfDecibels quantity;
    Value value;
    value.set({.raw = 4, .quantity = &quantity});
    value = "2.0 dB";
    for (const Value& plain : {value, Value("-95.25 dBm"), Value(7), Value(), Value(Array::make())}) {
        EXPECT_EQ(plain.reading(), nullptr);
        EXPECT_FALSE(plain.measurement());
    }
}

TEST(Value, IsAStringLikeAnyOtherWhileItIsAReading) {
    static const HalfDecibels quantity;
    Value value;
    value.set({.raw = 7, .quantity = &quantity});
    const Value copy = value.copy();
    value = "later";
    EXPECT_EQ(copy, Value("7/2 dB"));
    EXPECT_EQ(copy.number(), nullptr);
    Value text = copy;
    text.set({.raw = 8, .quantity = &quantity});
    text.text() += " or so";
    EXPECT_EQ(text, Value("8/2 dB or so"));
    EXPECT_EQ(text.reading(), nullptr);
}

TEST(Value, BecomesAStringWhateverItWas) {
    Value value = 7;
    value.text() = "seven";
    EXPECT_EQ(*value.string(), "seven");
    EXPECT_EQ(value.number(), nullptr);
}

}  // namespace
}  // namespace kelvo
