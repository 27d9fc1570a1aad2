#include "LogGenerator/ShowFields.h"

#include <fmt/format.h>
#include <gtest/gtest.h>

#include <cmath>
#include <cstdio>

namespace kelvo {
namespace {

std::string printed(std::int64_t raw, const Shown& shown) {
    std::string text;
    shown.print(text, raw);
    return text;
}

std::string byPrintf(const char* format, double value) {
    char text[400];
    std::snprintf(text, sizeof text, format, value);
    return text;
}

TEST(RecordView, ReadsBothByteOrdersAndSigns) {
    const Bytes bytes = {0x01, 0xFE, 0xFF, 0x80};
    const RecordView record(bytes);
    EXPECT_EQ(record.read(0, u8), 1);
    EXPECT_EQ(record.read(1, i8), -2);
    EXPECT_EQ(record.read(0, u16), 0xFE01);
    EXPECT_EQ(record.read(0, u16.bigEndian()), 0x01FE);
    EXPECT_EQ(record.read(1, i16), -2);
    EXPECT_EQ(record.read(0, u32), 0x80FFFE01);
    EXPECT_EQ(record.read(0, i32), static_cast<std::int32_t>(0x80FFFE01));
    EXPECT_EQ(record.read(0, u32.bits(25, 31)), 64);
    EXPECT_EQ(record.read(0, u16.bit(0)), 1);
    EXPECT_EQ(record.read(0, i16.bits(9, 15)), -1);
}

TEST(RecordView, ReadsZeroPastTheEnd) {
    const Bytes bytes = {0x11, 0x22, 0x33};
    const RecordView record(bytes);
    EXPECT_EQ(record.read(2, u16), 0x33);
    EXPECT_EQ(record.read(2, u16.bigEndian()), 0x3300);
    EXPECT_EQ(record.read(3, u32), 0);
    EXPECT_EQ(record.read(static_cast<std::size_t>(-1), u8), 0);
    EXPECT_EQ(RecordView({}).read(0, u8), 0);
}

TEST(RecordEntries, RefusesAnIndexThatTheCountDoesNotCover) {
    const RecordEntries entries(29, 6, 2);
    EXPECT_EQ(entries.offsetOf(1), 35U);
    EXPECT_THROW(entries.offsetOf(2), ArrayOutOfBoundsException);
}

TEST(FieldTable, PrintsWholeNumbersAsPrintfDoes) {
    EXPECT_EQ(printed(-7, decimal), "-7");
    EXPECT_EQ(printed(0xFFFFFFFF, asSigned), "-1");
    EXPECT_EQ(printed(0xFFFFFFFF, asUnsigned), "4294967295");
    EXPECT_EQ(printed(5, whole(2, -140, dBm)), "-130 dBm");
    EXPECT_EQ(printed(5, whole(1, 0, dBm, "%+d")), "+5 dBm");
    EXPECT_EQ(printed(-5, whole(1, 0, dBm, "%+d")), "-5 dBm");
    EXPECT_EQ(printed(64, whole(1, -30, dBm).unless(64, "Not Present")), "Not Present");
}

TEST(FieldTable, PrintsHexadecimalNumbersAsPrintfDoes) {
    EXPECT_EQ(printed(0xabc, hexadecimal("0x%06x")), "0x000abc");
    EXPECT_EQ(printed(0xfedcba, hexadecimal("0x%06x")), "0xfedcba");
    EXPECT_EQ(printed(0x1234567, hexadecimal("%06x")), "1234567");
    EXPECT_EQ(printed(0xF0, hexadecimal("%x h")), "f0 h");
    EXPECT_EQ(printed(10, hexadecimal("%4x")), "   a");
}

TEST(FieldTable, NamesValuesAndFallsBack) {
    static constexpr ValueTable kDense({{0, "A"}, {1, "B"}}, "Unknown");
    static constexpr ValueTable kSparse({{6, "six"}, {255, "last"}}, "[Reserved %d]");
    EXPECT_EQ(printed(1, label(kDense)), "B");
    EXPECT_EQ(printed(2, label(kDense)), "Unknown");
    EXPECT_EQ(printed(255, label(kSparse)), "last");
    EXPECT_EQ(printed(0, label(kSparse)), "[Reserved 0]");
    EXPECT_EQ(printed(0, flag("ON", "OFF")), "OFF");
    EXPECT_EQ(printed(200, flag("ON", "OFF")), "ON");
}

TEST(FieldTable, PrintsEveryStepOfAnEighthAsPrintfDoes) {
    for (std::int64_t raw = 0; raw <= 65535; ++raw) {
        const double value = static_cast<double>(raw);
        ASSERT_EQ(printed(raw, linear(0.25, -140.0, "%4.2f", dBm)), byPrintf("%4.2f dBm", value * 0.25 - 140.0));
        ASSERT_EQ(printed(raw, linear(0.125, -20.0, "%4.2f", dB)), byPrintf("%4.2f dB", value * 0.125 - 20.0));
        ASSERT_EQ(printed(raw, linear(0.5, -30.0, "%+.2f", dB)), byPrintf("%+.2f dB", value * 0.5 - 30.0));
        ASSERT_EQ(printed(raw, linear(0.125, -20.0, "%8.2f")), byPrintf("%8.2f", value * 0.125 - 20.0));
    }
}

TEST(FieldTable, PrintsOtherRealNumbersAsPrintfDoes) {
    for (std::int64_t raw = -32768; raw <= 32767; ++raw) {
        const double value = static_cast<double>(raw);
        ASSERT_EQ(printed(raw, linear(1.0 / 256, 0.0, "%f")), byPrintf("%f", value * (1.0 / 256)));
        ASSERT_EQ(printed(raw, linear(0.334, -63.248, "%+.2f", dBm)), byPrintf("%+.2f dBm", value * 0.334 - 63.248));
    }
}

TEST(FieldTable, PrintsRealNumbersOutsideTheNumberLineAsPrintfDoes) {
    for (const double value : {-1.0 / 0.0, 1.0 / 0.0, std::nan(""), -std::nan(""), -0.0, 0.0, -0.001, 1e300}) {
        std::string text;
        NumberFormat("%+.2f", dB).print(text, value);
        EXPECT_EQ(text, byPrintf("%+.2f dB", value));
    }
    std::string text;
    NumberFormat("%+.2f", dB).print(text, -1.0 / 0.0);
    EXPECT_EQ(text, "-inf dB");
}

/// The number and the unit behind a raw value; "none" when it stands for no number.
std::string measured(std::int64_t raw, const Shown& shown) {
    const auto measurement = shown.measure(raw);
    return measurement ? fmt::format("{} {}", measurement->number, measurement->unit) : "none";
}

TEST(FieldTable, TellsTheNumberAndTheUnitBehindAText) {
    EXPECT_EQ(measured(179, linear(0.25, -140.0, "%4.2f", dBm)), "-95.25 dBm");
    EXPECT_EQ(measured(0, linear(0.334, -63.248, "%+.2f", dBm)), "-63.248 dBm");
    EXPECT_EQ(measured(3, linear(0.5, 0.0, "%f", dB)), "1.5 dB");
    EXPECT_EQ(measured(10, whole(2, -140, dBm)), "-120 dBm");
    EXPECT_EQ(measured(4, whole(1, 0, inSeconds)), "4 s");
    EXPECT_EQ(measured(168, whole(1, 0, pnOffset)), "168 64 chips");
    EXPECT_EQ(measured(301, decimal), "301 ");
    EXPECT_EQ(measured(0xFFFFFFFE, asSigned), "-2 ");
    EXPECT_EQ(measured(0xFFFFFFFE, asUnsigned), "4294967294 ");
}

TEST(FieldTable, TellsNoNumberForWhatIsNone) {
    static constexpr ValueTable kState({{0, "A"}}, "[Reserved %d]");
    EXPECT_EQ(measured(0, label(kState)), "none");
    EXPECT_EQ(measured(9, label(kState)), "none");
    EXPECT_EQ(measured(1, flag("ON", "OFF")), "none");
    EXPECT_EQ(measured(64, whole(1, -30, dBm).unless(64, "Not Present")), "none");
    EXPECT_EQ(measured(65, whole(1, -30, dBm).unless(64, "Not Present")), "35 dBm");
}

TEST(FieldTable, KeepsRealNumbersAsTheyAre) {
    static constexpr ShownReal kRate("%.02f (old)", percent);
    Value value;
    showReal(value, 1.5625, kRate);
    EXPECT_EQ(value, Value("1.56% (old)"));
    ASSERT_TRUE(value.measurement());
    EXPECT_DOUBLE_EQ(value.measurement()->number, 1.5625);
    EXPECT_EQ(value.measurement()->unit, "%");
    for (const double none : {-1.0 / 0.0, std::nan("")}) {
        showReal(value, none, kRate);
        EXPECT_FALSE(value.measurement());
    }
}

TEST(FieldTable, LeavesAKeyOutAtOneValueAlone) {
    static constexpr ValueTable kStatus({{0, "A"}, {1, "B"}}, "Unknown");
    static constexpr auto kCell = entry(1, {{0, u8, "Status", label(kStatus).absentAt(3)}});
    const DictionaryRef shown = Dictionary::make();
    const auto show = [&](std::uint8_t raw) {
        showFields(*shown, RecordView(ByteView(&raw, 1)), 0, kCell.fields);
        return (*shown)["Status"];
    };
    EXPECT_EQ(show(1), Value("B"));
    EXPECT_EQ(show(3), Value());
    EXPECT_TRUE(shown->empty());
    EXPECT_EQ(show(2), Value("Unknown"));
}

TEST(FieldTable, DoesNotMakeUpRowsBeyondTheEnd) {
    static constexpr auto kCell = entry(4, {{0, u16, "ID", decimal}, {2, u16, "Level", decimal}});
    const Bytes bytes = {0xEE, 1, 0, 2, 0, 3, 0};  // one whole entry and half of the next
    const ArrayRef cells = Array::make();
    showRows(cells, ByteView(bytes), 1, 200, kCell);
    EXPECT_EQ(Value(cells), Value(Array::make({Dictionary::make({{"ID", "1"}, {"Level", "2"}}),
                                               Dictionary::make({{"ID", "3"}, {"Level", "0"}})})));
}

}  // namespace
}  // namespace kelvo
