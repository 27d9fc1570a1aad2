#include "LogGenerator/CodeNames.h"

#include <gtest/gtest.h>

#include <set>

using namespace kelvo;

TEST(CodeNames, NameACodeOfEachFamily) {
    EXPECT_EQ(nameOfCode(0xB17F), "LTE serving cell, idle");
    EXPECT_EQ(nameOfCode(0x51F5), "GPRS network control and access");
    EXPECT_EQ(nameOfCode(0x4005), "UMTS and GSM neighbor cells, ranked");
    EXPECT_EQ(nameOfCode(0x119C), "1x status");
    EXPECT_EQ(nameOfCode(0xD0E0), "UTRAN RRC state");
    EXPECT_EQ(nameOfCode(0xFF0000), "SIM files");
}

TEST(CodeNames, NameWhatNewerModemsSend) {
    EXPECT_EQ(nameOfCode(0xB193), "LTE serving cell, every mode");
    EXPECT_EQ(nameOfCode(0x51FC), "GPRS cell reselection");
}

TEST(CodeNames, TellTheSecondSimsRecordsFromTheFirsts) {
    EXPECT_EQ(nameOfCode(0x5B34), "GSM serving cell, dual SIM");
    EXPECT_EQ(nameOfCode(0x5BFF), "GSM neighbor cells, BSIC, dual SIM");
    EXPECT_EQ(nameOfCode(0x7B30), "");  // 0x7130 has no such twin
    EXPECT_EQ(nameOfCode(0xBB79), "");
}

TEST(CodeNames, SayNothingOfCodesThatNobodyKnows) {
    for (const LogCode code : {0x0000U, 0x5000U, 0xB0C0U, 0xFFFFU, 0xFF0003U, 0xFFB17FU}) {
        EXPECT_EQ(knownCode(code), nullptr) << code;
        EXPECT_EQ(nameOfCode(code), "") << code;
    }
}

TEST(CodeNames, StandBehindTheNumber) {
    EXPECT_EQ(describeCode(0xB17F), "0xb17f  LTE serving cell, idle");
    EXPECT_EQ(describeCode(0xFF0002), "0xff0002  Packet data contexts");
    EXPECT_EQ(describeCode(0x51F7), "0x51f7");
    EXPECT_EQ(describeCode(0x7), "0x0007");
}

TEST(CodeNames, AreEachForOneCode) {
    std::set<std::string_view> names;
    std::set<LogCode> codes;
    const auto add = [&](const KnownCode& known) {
        EXPECT_TRUE(names.insert(known.name).second) << known.name;
        EXPECT_TRUE(codes.insert(known.code).second) << known.name;
        EXPECT_LE(describeCode(known.code).size(), 46U) << known.name;  // the width of its column in the status
        EXPECT_FALSE(known.source.empty()) << known.name;
    };
    for (const KnownCode& known : code::kCDMA) add(known);
    for (const KnownCode& known : code::kGSMUMTS) add(known);
    for (const KnownCode& known : code::kLTE) add(known);
    for (const KnownCode& known : code::kPhoneServices) add(known);
    for (const KnownCode& known : code::kUTRAN) add(known);
    EXPECT_EQ(codes.size(), 8U + 26U + 7U + 3U + 5U);
}
