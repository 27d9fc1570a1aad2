#include "tools/share/Pseudonyms.h"

#include <gtest/gtest.h>

#include <set>

namespace kelvo {
namespace {

const Pseudonyms::Secret kSecret = Pseudonyms::secretOf("a test");

TEST(Pseudonyms, AreThoseOfTheSecret) {
    Pseudonyms one(kSecret);
    Pseudonyms same(kSecret);
    Pseudonyms other(Pseudonyms::secretOf("another"));
    EXPECT_EQ(one.digits("SIM", "8900101000000123456"), same.digits("SIM", "8900101000000123456"));
    EXPECT_NE(one.digits("SIM", "8900101000000123456"), other.digits("SIM", "8900101000000123456"));
    EXPECT_NE(one.digits("SIM", "8900101000000123456"), one.digits("phone", "8900101000000123456"));
    EXPECT_NE(Pseudonyms::randomSecret(), Pseudonyms::randomSecret());
}

TEST(Pseudonyms, OfARangeAreAPermutationThatLeavesNoneInPlace) {
    Pseudonyms pseudonyms(kSecret);
    for (const auto& [low, end] : {std::pair(0, 2), std::pair(1, 10), std::pair(100, 504), std::pair(1000, 5000)}) {
        std::set<std::uint64_t> seen;
        for (int value = low; value < end; ++value) {
            const auto other = pseudonyms.permuted("cell", static_cast<std::uint64_t>(value),
                                                   static_cast<std::uint64_t>(low), static_cast<std::uint64_t>(end));
            EXPECT_NE(other, static_cast<std::uint64_t>(value));
            EXPECT_GE(other, static_cast<std::uint64_t>(low));
            EXPECT_LT(other, static_cast<std::uint64_t>(end));
            seen.insert(other);
        }
        EXPECT_EQ(seen.size(), static_cast<std::size_t>(end - low));
    }
}

TEST(Pseudonyms, OfARangeOfOneAreItself) {
    EXPECT_EQ(Pseudonyms(kSecret).permuted("cell", 7, 7, 8), 7U);
    EXPECT_EQ(Pseudonyms(kSecret).permuted("cell", 9, 7, 8), 9U);
}

TEST(Pseudonyms, OfNumbersHaveAsManyDigitsAndStayWithinTheBounds) {
    Pseudonyms pseudonyms(kSecret);
    const std::uint64_t bounds[] = {504};
    for (std::uint32_t value = 100; value < 504; ++value) {
        const std::uint32_t other = pseudonyms.number("PCI", value, bounds);
        EXPECT_GE(other, 100U);
        EXPECT_LT(other, 504U);
    }
    EXPECT_EQ(std::to_string(pseudonyms.number("cell", 123'456'789)).size(), 9U);
    EXPECT_LT(pseudonyms.number("area", 40'000), 65'535U);
}

TEST(Pseudonyms, OfNumbersThatSayNothingAreThemselves) {
    Pseudonyms pseudonyms(kSecret);
    for (const std::uint32_t value : {0U, 255U, 65'535U, 268'435'455U, 2'147'483'647U, 4'294'967'295U}) {
        EXPECT_EQ(pseudonyms.number("cell", value), value);
    }
}

TEST(Pseudonyms, OfDigitsHaveAsMany) {
    Pseudonyms pseudonyms(kSecret);
    for (const char* digits : {"7", "42", "310410123456789", "89001010000001234560", "0015550123"}) {
        const std::string other = pseudonyms.digits("number", digits);
        EXPECT_EQ(other.size(), std::string(digits).size());
        EXPECT_EQ(other.find_first_not_of("0123456789"), std::string::npos);
        EXPECT_NE(other, digits);
    }
    EXPECT_EQ(pseudonyms.digits("number", "0000"), "0000");
    EXPECT_EQ(pseudonyms.digits("number", ""), "");
}

TEST(Pseudonyms, OfLongDigitsShareNoPartWhereTheDigitsDo) {
    Pseudonyms pseudonyms(kSecret);
    const std::string one = pseudonyms.digits("SIM", "89001010000001234560");
    const std::string next = pseudonyms.digits("SIM", "89001010000001234561");
    EXPECT_NE(one.substr(0, 18), next.substr(0, 18));
}

TEST(Pseudonyms, OfOctetsAreAsManyAndFillersStay) {
    Pseudonyms pseudonyms(kSecret);
    const Bytes tmsi = {0x3A, 0x9C, 0x41, 0xD7};
    EXPECT_EQ(pseudonyms.octets("TMSI", tmsi).size(), 4U);
    EXPECT_NE(pseudonyms.octets("TMSI", tmsi), tmsi);
    EXPECT_EQ(pseudonyms.octets("TMSI", Bytes(4, 0xFF)), Bytes(4, 0xFF));
    EXPECT_EQ(pseudonyms.octets("TMSI", Bytes(4)), Bytes(4));
    EXPECT_EQ(pseudonyms.octets("GUTI", Bytes(10, 7)).size(), 10U);
}

TEST(Pseudonyms, OfTextsKeepTheirForm) {
    const std::string other = Pseudonyms(kSecret).letters("APN", "corp2.Example");
    EXPECT_EQ(other.size(), 13U);
    EXPECT_EQ(other[5], '.');
    EXPECT_TRUE(other[4] >= '0' && other[4] <= '9');
    EXPECT_TRUE(other[6] >= 'A' && other[6] <= 'Z');
    for (std::size_t i = 0; i < other.size(); ++i) EXPECT_TRUE(i == 5 || other[i] != std::string("corp2.Example")[i]);
}

}  // namespace
}  // namespace kelvo
