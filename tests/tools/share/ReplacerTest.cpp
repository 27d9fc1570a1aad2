#include "tools/share/Replacer.h"

#include <arpa/inet.h>
#include <gtest/gtest.h>

#include <set>

namespace kelvo {
namespace {

struct ReplacerTest : testing::Test {
    std::string text(Identity identity, const std::string& text) {
        return replacer.text(identity, "field", text).value_or("(removed)");
    }
    Bytes bytes(Identity identity, const Bytes& bytes) { return replacer.bytes(identity, "field", bytes).value(); }

    Replacer replacer{{}, Pseudonyms::secretOf("a test")};
    Replacer keepingCells{{.hideCells = false}, Pseudonyms::secretOf("a test")};
};

/// "8902-1F" has the form "9999-9F": digits are 9, capital letters A, small ones a, F and f stay.
std::string formOf(std::string text) {
    for (char& c : text) {
        if (c >= '0' && c <= '9') c = '9';
        if (c >= 'A' && c <= 'Z' && c != 'F') c = 'A';
        if (c >= 'a' && c <= 'z' && c != 'f') c = 'a';
    }
    return text;
}

TEST_F(ReplacerTest, KeepsTheFormOfCardNumbersAndTheirFillers) {
    const std::string iccid = text(Identity::SimNumber, "8900101000000123456");
    EXPECT_EQ(formOf(iccid), std::string(19, '9'));
    EXPECT_NE(iccid, "8900101000000123456");
    EXPECT_EQ(text(Identity::SimNumber, "8900101000000123456F"), iccid + "F");
    EXPECT_EQ(text(Identity::Subscriber, "310-410-123456789").substr(3, 1), "-");
    EXPECT_EQ(formOf(text(Identity::Equipment, "A1000012345678")), "A9999999999999");
}

TEST_F(ReplacerTest, SwapsNibblesLikeTheCard) {
    // 8900101000000123456 and a filler, digits swapped.
    const Bytes file = {0x98, 0x00, 0x01, 0x01, 0x00, 0x00, 0x10, 0x32, 0x54, 0xF6};
    const Bytes other = bytes(Identity::SimNumber, file);
    std::string digits;
    for (const std::uint8_t byte : other) {
        digits += static_cast<char>('0' + (byte & 15));
        if (byte >> 4 < 10) digits += static_cast<char>('0' + (byte >> 4));
    }
    EXPECT_EQ(other[9] >> 4, 15);
    EXPECT_EQ(digits, text(Identity::SimNumber, "8900101000000123456"));
}

TEST_F(ReplacerTest, ReplacesTelephoneNumbersOneByOne) {
    const std::string one = text(Identity::Phone, "+0015550123");
    EXPECT_EQ(formOf(one), "+9999999999");
    EXPECT_EQ(text(Identity::Phone, "+0015550123, +0015550100").substr(0, 11), one);
    EXPECT_NE(text(Identity::Phone, "Anna 5550123").substr(0, 4), "Anna");
}

TEST_F(ReplacerTest, ReplacesTheNameAndTheDigitsOfATelephoneNumbersFile) {
    const Bytes file = {'A',  'n',  'n',  'a',  0xFF, 0xFF, 7,    0x91, 0x00, 0x51,
                        0x55, 0x10, 0x32, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF};
    const Bytes other = bytes(Identity::Phone, file);
    ASSERT_EQ(other.size(), file.size());
    EXPECT_NE(std::string(other.begin(), other.begin() + 4), "Anna");
    EXPECT_EQ(Bytes(other.begin() + 4, other.begin() + 8), Bytes(file.begin() + 4, file.begin() + 8));
    EXPECT_NE(Bytes(other.begin() + 8, other.begin() + 13), Bytes(file.begin() + 8, file.begin() + 13));
    EXPECT_EQ(Bytes(other.begin() + 13, other.end()), Bytes(7, 0xFF));
}

TEST_F(ReplacerTest, ReplacesTemporaryIdentityNetworkAndAreaOfALocation) {
    // TMSI 3A9C41D7, 262-01 (62 F2 10), area 1234, a filler, updated.
    const std::string other = text(Identity::Location, "3A9C41D762F2101234FF00");
    ASSERT_EQ(other.size(), 22U);
    EXPECT_NE(other.substr(0, 8), "3A9C41D7");
    EXPECT_NE(other.substr(8, 6), "62F210");
    EXPECT_EQ(other[10], 'F');
    EXPECT_NE(other.substr(14, 4), "1234");
    EXPECT_EQ(other.substr(18), "FF00");
    EXPECT_EQ(text(Identity::Plmn, "62F210"), other.substr(8, 6));
}

TEST_F(ReplacerTest, KeepsTheAreaOfALocationWhereCellsAreKept) {
    const std::string other = *keepingCells.text(Identity::Location, "field", "3A9C41D762F2101234FF00");
    EXPECT_NE(other.substr(0, 8), "3A9C41D7");
    EXPECT_EQ(other.substr(8), "62F2101234FF00");
}

TEST_F(ReplacerTest, ReplacesTheSignatureAndTheRoutingAreaOfAPacketLocation) {
    const std::string other = text(Identity::PsLocation, "C41B7E02A95D1362F21012340A00");
    ASSERT_EQ(other.size(), 28U);
    EXPECT_NE(other.substr(0, 8), "C41B7E02");
    EXPECT_NE(other.substr(8, 6), "A95D13");
    EXPECT_NE(other.substr(14, 6), "62F210");
    EXPECT_NE(other.substr(20, 4), "1234");
    EXPECT_NE(other.substr(24, 2), "0A");
    EXPECT_EQ(other.substr(26), "00");
}

TEST_F(ReplacerTest, LeavesNothingOfALocationOfAnotherLength) {
    const std::string other = text(Identity::Location, "3A9C41D762F21012");
    EXPECT_EQ(other.size(), 16U);
    for (std::size_t i = 0; i + 3 <= other.size(); ++i) {
        EXPECT_TRUE(i == 10 || other.substr(i, 3) != std::string("3A9C41D762F21012").substr(i, 3)) << i;
    }
}

TEST_F(ReplacerTest, HasOnePseudonymForANetworkInAllForms) {
    const Bytes plmn = bytes(Identity::Plmn, {0x62, 0xF2, 0x10});  // 262-01
    const std::uint32_t country = replacer.number(Identity::Country, "field", 262);
    const std::uint32_t network = replacer.number(Identity::Network, "field", 1);
    EXPECT_EQ((plmn[0] & 15) * 100U + (plmn[0] >> 4) * 10U + (plmn[1] & 15U), country);
    EXPECT_EQ((plmn[2] & 15) * 10U + (plmn[2] >> 4), network);
    EXPECT_EQ(plmn[1] >> 4, 15);
    EXPECT_EQ(text(Identity::Country, "262"), std::to_string(country));
    EXPECT_EQ(text(Identity::Network, "01 "), "0" + std::to_string(network) + " ");
    EXPECT_EQ(text(Identity::Network, "001"), "00" + std::to_string(network));
}

TEST_F(ReplacerTest, KeepsEmptyPlacesOfNetworkLists) {
    const std::string other = text(Identity::Plmn, "62F210FFFFFF");
    EXPECT_EQ(other.substr(6), "FFFFFF");
    EXPECT_NE(other.substr(0, 6), "62F210");
    const std::string access = text(Identity::PlmnAccess, "62F210C080");
    EXPECT_EQ(access, other.substr(0, 6) + "C080");
    const std::string areas = text(Identity::PlmnAreas, "62F2100000FFFE01");
    EXPECT_EQ(areas, other.substr(0, 6) + "0000FFFE01");
}

TEST_F(ReplacerTest, MovesTheAccessClassThatTellsTheLastDigit) {
    std::set<std::string> seen;
    for (const char* one : {"0001", "0002", "0004", "0008", "0010", "0020", "0040", "0080", "0100", "0200"}) {
        const std::string other = text(Identity::AccessClass, one);
        EXPECT_NE(other, one);
        seen.insert(other);
    }
    EXPECT_EQ(seen.size(), 10U);
    EXPECT_EQ(text(Identity::AccessClass, "8000"), "8000");  // class 15, which is nobody's own
}

TEST_F(ReplacerTest, GivesAddressesOfTheRangesForDocumentation) {
    const std::string four = text(Identity::Address, "10.20.30.40");
    EXPECT_TRUE(four.starts_with("192.0.2.") || four.starts_with("198.51.100.") || four.starts_with("203.0.113."))
        << four;
    EXPECT_EQ(text(Identity::Address, "10.20.30.40, 2001:470:1::2").substr(0, four.size()), four);
    EXPECT_TRUE(text(Identity::Address, "2001:470:1::2").starts_with("2001:db8:"));
    Bytes binary(4);
    ASSERT_EQ(inet_pton(AF_INET, four.c_str(), binary.data()), 1);
    EXPECT_EQ(bytes(Identity::Address, {10, 20, 30, 40}), binary);
    EXPECT_EQ(text(Identity::Address, "0.0.0.0"), "0.0.0.0");
}

TEST_F(ReplacerTest, GivesEveryAddressItsOwnForAsLongAsThereAreSome) {
    std::set<std::string> seen;
    for (int i = 1; i <= 700; ++i) {
        seen.insert(text(Identity::Address, "10.1." + std::to_string(i / 250) + "." + std::to_string(i % 250 + 1)));
    }
    EXPECT_EQ(seen.size(), 700U);
    for (int i = 1; i <= 200; ++i) text(Identity::Address, "10.2.0." + std::to_string(i));
    EXPECT_TRUE(text(Identity::Address, "10.3.0.1").starts_with("198.1"));
}

TEST_F(ReplacerTest, KeepsAccessPointsButForTheNetworkInTheirNames) {
    EXPECT_EQ(text(Identity::Apn, "internet"), "internet");
    const std::string other = text(Identity::Apn, "corp.MNC001.mcc262.gprs");
    EXPECT_EQ(other.substr(0, 8), "corp.MNC");
    EXPECT_EQ(other.substr(8, 3), text(Identity::Network, "001"));
    EXPECT_EQ(other.substr(15, 3), text(Identity::Country, "262"));
    EXPECT_EQ(other.substr(18), ".gprs");
    EXPECT_EQ(keepingCells.text(Identity::Apn, "field", "corp.mnc001.mcc262.gprs"), "corp.mnc001.mcc262.gprs");
}

TEST_F(ReplacerTest, ReplacesAccessPointsOnRequest) {
    Replacer hiding({.hideApns = true}, Pseudonyms::secretOf("a test"));
    const std::string other = *hiding.text(Identity::Apn, "field", "corp.example");
    EXPECT_EQ(formOf(other).size(), 12U);
    EXPECT_EQ(other[4], '.');
    EXPECT_NE(other.substr(0, 4), "corp");
    EXPECT_NE(other.substr(5), "example");
}

TEST_F(ReplacerTest, ReplacesNumbersInTheTextsOfScreens) {
    const std::string pn = text(Identity::Pilot, "12 \u00D7 64chips");
    EXPECT_EQ(pn, std::to_string(replacer.number(Identity::Pilot, "field", 12)) + " \u00D7 64chips");
    EXPECT_EQ(text(Identity::Pilot, "Invalid Value"), "Invalid Value");
    EXPECT_EQ(text(Identity::System, "(unknown system type 1)"), "(unknown system type 1)");
    EXPECT_EQ(text(Identity::Cell, "\u2013"), "\u2013");
    const auto signed32 = static_cast<std::int32_t>(replacer.number(Identity::Cell, "field", 0xFFFFFFFE));
    EXPECT_EQ(text(Identity::Cell, "-2"), std::to_string(signed32));
    EXPECT_EQ(text(Identity::Temporary, "0x00abcd").size(), 8U);
    const std::uint32_t uati = replacer.number(Identity::Temporary, "field", 0xABCD);
    char expected[16];
    std::snprintf(expected, sizeof expected, "0x%06x", uati);
    EXPECT_EQ(text(Identity::Temporary, "0x00abcd"), expected);
}

TEST_F(ReplacerTest, KeepsTheSectorsOfAnENodeBTogetherAndTellsNeitherPart) {
    // 27439618 is sector 2 of eNB 107186.
    std::set<std::uint32_t> sites;
    std::set<std::uint32_t> sectors;
    for (std::uint32_t sector = 0; sector < 256; ++sector) {
        const std::uint32_t other = replacer.number(Identity::EutranCell, "field", 27'439'616 + sector);
        sites.insert(other / 256);
        sectors.insert(other % 256);
        EXPECT_NE(other % 256, sector);
    }
    ASSERT_EQ(sites.size(), 1U);
    EXPECT_EQ(sectors.size(), 256U);
    EXPECT_FALSE(sites.contains(107'186));
    EXPECT_EQ(text(Identity::EutranCell, "27439618"),
              std::to_string(replacer.number(Identity::EutranCell, "field", 27'439'618)));
    EXPECT_EQ(text(Identity::EutranCell, "27439618").size(), 8U);
}

TEST_F(ReplacerTest, KeepsTwoENodeBsApartAndTheirSectorsInPlacesOfTheirOwn) {
    std::set<std::uint32_t> sites;
    std::set<std::uint32_t> places;  // of sector 1
    for (std::uint32_t site = 391; site < 3907; ++site) {
        const std::uint32_t other = replacer.number(Identity::EutranCell, "field", site * 256 + 1);
        EXPECT_NE(other / 256, site);
        EXPECT_GE(other / 256, 391U);
        EXPECT_LT(other / 256, 3907U);
        sites.insert(other / 256);
        places.insert(other % 256);
    }
    EXPECT_EQ(sites.size(), 3516U);
    EXPECT_GT(places.size(), 200U);
}

TEST_F(ReplacerTest, KeepsTheCellsOfAnRncTogether) {
    // 44041665 is cell 1 of RNC 672.
    const std::uint32_t one = replacer.number(Identity::UtranCell, "field", 44'041'665);
    const std::uint32_t two = replacer.number(Identity::UtranCell, "field", 44'041'666);
    const std::uint32_t elsewhere = replacer.number(Identity::UtranCell, "field", 44'041'665 + 65'536);
    EXPECT_NE(one >> 16, 672U);
    EXPECT_EQ(one >> 16, two >> 16);
    EXPECT_NE(one, two);
    EXPECT_NE(elsewhere >> 16, one >> 16);
    EXPECT_NE(one & 0xFFFF, 1U);
}

TEST_F(ReplacerTest, TakesNumbersWithoutASiteAndOfMoreBitsAsTheyAre) {
    EXPECT_EQ(replacer.number(Identity::EutranCell, "field", 0x0FFFFFFF), 0x0FFFFFFFU);
    EXPECT_NE(replacer.number(Identity::EutranCell, "field", 0x0FFFFFFE), 0x0FFFFFFEU);
    EXPECT_NE(replacer.number(Identity::EutranCell, "field", 0x0FFFFFFE), 0x0FFFFFFFU);
    EXPECT_EQ(replacer.number(Identity::UtranCell, "field", 21'345), replacer.number(Identity::Cell, "field", 21'345));
    EXPECT_GT(replacer.number(Identity::EutranCell, "field", 0x10000001), 0x0FFFFFFFU);
}

TEST_F(ReplacerTest, RemovesWhatIsNoNumber) {
    EXPECT_EQ(text(Identity::Cell, "310410123456789"), "(removed)");
    EXPECT_EQ(text(Identity::Cell, "12 Main Street"), "(removed)");
    EXPECT_EQ(text(Identity::Cell, "home"), "(removed)");
}

TEST_F(ReplacerTest, ReplacesEveryLetterOfANetworksName) {
    const std::string other = text(Identity::NetworkName, "Test Network");
    EXPECT_EQ(formOf(other), "Aaaa Aaaaaaa");
    EXPECT_NE(other, "Test Network");
}

TEST_F(ReplacerTest, CountsWhatItReplacesAndNothingElse) {
    replacer.number(Identity::Cell, "Cell Identity", 7);
    replacer.number(Identity::Cell, "Cell Identity", 8);
    replacer.number(Identity::Cell, "Cell Identity", 0);
    replacer.text(Identity::None, "Version", "2");
    ASSERT_EQ(replacer.tally().replaced().size(), 1U);
    EXPECT_EQ(replacer.tally().replaced().at("Cell Identity").values, 2U);
}

TEST_F(ReplacerTest, TakesValuesOfAllKinds) {
    const Value list = replacer.value(Identity::Plmn, "field", Array::make({"62F210", Bytes{0x62, 0xF2, 0x10}}));
    ASSERT_TRUE(list.array());
    EXPECT_EQ(*(*list.array())[0].string(), text(Identity::Plmn, "62F210"));
    EXPECT_EQ(*(*list.array())[1].data(), bytes(Identity::Plmn, {0x62, 0xF2, 0x10}));
    EXPECT_EQ(replacer.value(Identity::Cell, "field", 77).number()->integer(),
              replacer.number(Identity::Cell, "field", 77));
    EXPECT_FALSE(replacer.value(Identity::SimNumber, "field", Dictionary::make({{"a", "8900101"}})));
    EXPECT_FALSE(replacer.value(Identity::SimNumber, "field", true));
}

}  // namespace
}  // namespace kelvo
