#include "LogGenerator/IFX/NumberInText.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

struct Written {
    std::string_view text;
    double number;
    std::string_view unit;
};

constexpr Written kNumbers[] = {
    {"-71 dBm", -71, "dBm"},
    {"-71dBm", -71, "dBm"},
    {"-10.5 dB", -10.5, "dB"},
    {"+3.25 dB", 3.25, "dB"},
    {"12", 12, ""},
    {"-12", -12, ""},
    {"+7", 7, ""},
    {"0", 0, ""},
    {"0.0 dB", 0, "dB"},
    {"0.1 %", 0.1, "%"},
    {"99.9%", 99.9, "%"},
    {"236 kbit/s", 236, "kbit/s"},
    {"-0.5 dB", -0.5, "dB"},
    {"0.125", 0.125, ""},
    {"1.10", 1.1, ""},
    {"999999999999999", 999999999999999, ""},
};

TEST(NumberInText, IsTheNumberInItsUnit) {
    for (const auto& [text, number, unit] : kNumbers) {
        const auto reading = numberInText(text);
        ASSERT_TRUE(reading) << text;
        const auto measured = reading->quantity->measure(reading->raw);
        ASSERT_TRUE(measured) << text;
        EXPECT_EQ(measured->number, number) << text;
        EXPECT_EQ(measured->unit, unit) << text;
        EXPECT_FALSE(reading->place) << text;  // no record's field holds it
    }
}

TEST(NumberInText, PrintsTheVeryTextAgain) {
    for (const Written& written : kNumbers) {
        const auto reading = numberInText(written.text);
        ASSERT_TRUE(reading) << written.text;
        std::string printed;
        reading->quantity->print(printed, reading->raw);
        EXPECT_EQ(printed, written.text);
    }
}

TEST(NumberInText, IsNoneForWhatWouldBeWrittenOtherwiseOrIsNoNumber) {
    for (const char* text : {"",
                             "-",
                             "+",
                             ".",
                             ".5",
                             "5.",
                             "01",
                             "-01 dBm",
                             "-0",
                             "-0 dBm",
                             "+-3",
                             "-+3",
                             "--3",
                             "1e3",
                             "0x10",
                             "nan",
                             "inf",
                             " 12",
                             "12 ",
                             "-71  dBm",
                             "-71 dbm",
                             "-71 dBm ",
                             "3 apples",
                             "GSM 900",
                             "12/3",
                             "1,5",
                             "1.2345",
                             "TCH/F",
                             "1000000000000000",
                             "123456789012345.6",
                             "99999999999999999999999999",
                             "\xe2\x88\x92"
                             "71 dBm"}) {
        EXPECT_FALSE(numberInText(text)) << text;
    }
    EXPECT_FALSE(numberInText(std::string_view("12\0", 3)));
}

}  // namespace
}  // namespace kelvo
