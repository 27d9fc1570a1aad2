// The numbers that the tables print, against printf: every 16-bit value and the edges of 32 bits, for every format that
// a table uses. Texts go the way of a display: kept as a raw value, printed when read.

#include <gtest/gtest.h>

#include <cstdio>
#include <functional>
#include <vector>

#include "LogGenerator/ShowFields.h"

namespace kelvo {
namespace {

std::vector<std::int64_t> sixteenBits() {
    std::vector<std::int64_t> values;
    for (std::int64_t raw = -32768; raw <= 65535; ++raw) values.push_back(raw);
    return values;
}

std::vector<std::int64_t> signedEdges() {
    return {-2147483648LL, -2147483647, -1000000000, -999999999, -65537, 65536, 999999999, 1000000000, 2147483647};
}

std::vector<std::int64_t> unsignedEdges() {
    return {65536, 0x7FFFFFFE, 0x7FFFFFFF, 0x80000000, 0x80000001, 4000000000, 0xFFFFFFFE, 0xFFFFFFFF};
}

template <class Number>
std::string byPrintf(const char* format, Number value) {
    char text[400];
    std::snprintf(text, sizeof text, format, value);
    return text;
}

void expectLikePrintf(const Shown& shown, const std::vector<std::int64_t>& raws,
                      const std::function<std::string(std::int64_t)>& reference) {
    Value value;
    for (const std::int64_t raw : raws) {
        showValue(value, raw, shown);
        ASSERT_EQ(*value.string(), reference(raw)) << "raw value " << raw;
    }
}

TEST(Printing, WritesWholeNumbersAsPrintfDoes) {
    static constexpr struct {
        std::int64_t factor;
        std::int64_t summand;
        const char* format;
        Shown shown;
    } kCases[] = {
        {1, 0, "%ld", decimal},
        {1, 0, "%ld dBm", whole(1, 0, dBm)},
        {1, 0, "%ld dB", whole(1, 0, dB)},
        {1, 0, "%ld sec", whole(1, 0, inSeconds)},
        {1, 0, "%ld × 64chips", whole(1, 0, pnOffset)},
        {1, 0, "%+ld dBm", whole(1, 0, dBm, "%+d")},
        {1, -21, "%ld dB", whole(1, -21, dB)},
        {1, -30, "%ld dBm", whole(1, -30, dBm)},
        {2, -140, "%ld dBm", whole(2, -140, dBm)},
        {2, 0, "%ld dBm", whole(2, 0, dBm)},
        {2, 0, "%ld dB", whole(2, 0, dB)},
    };
    for (const auto& number : kCases) {
        SCOPED_TRACE(number.format);
        const auto reference = [&](std::int64_t raw) {
            return byPrintf(number.format, static_cast<long>(raw * number.factor + number.summand));
        };
        expectLikePrintf(number.shown, sixteenBits(), reference);
        expectLikePrintf(number.shown, signedEdges(), reference);
    }
}

TEST(Printing, WritesThirtyTwoBitsWithTheSignTheyAreSaidToHave) {
    const auto asInt = [](std::int64_t raw) {
        return byPrintf("%d", static_cast<int>(static_cast<std::uint32_t>(raw)));
    };
    const auto asUnsignedInt = [](std::int64_t raw) { return byPrintf("%u", static_cast<unsigned>(raw)); };
    std::vector<std::int64_t> raws;
    for (std::int64_t raw = 0; raw <= 65535; ++raw) raws.push_back(raw);
    const std::vector<std::int64_t> edges = unsignedEdges();
    raws.insert(raws.end(), edges.begin(), edges.end());
    expectLikePrintf(asSigned, raws, asInt);
    expectLikePrintf(asUnsigned, raws, asUnsignedInt);
    static constexpr Shown kHexadecimal = hexadecimal("0x%06x");
    expectLikePrintf(kHexadecimal, raws,
                     [](std::int64_t raw) { return byPrintf("0x%06x", static_cast<unsigned>(raw)); });
}

TEST(Printing, WritesRealNumbersAsPrintfDoes) {
    static constexpr struct {
        double scale;
        double offset;
        const char* format;
        Shown shown;
    } kCases[] = {
        {0.25, -140.0, "%4.2f dBm", linear(0.25, -140.0, "%4.2f", dBm)},
        {0.5, -140.0, "%4.2f dBm", linear(0.5, -140.0, "%4.2f", dBm)},
        {0.125, -20.0, "%4.2f dB", linear(0.125, -20.0, "%4.2f", dB)},
        {0.25, -30.0, "%4.2f dB", linear(0.25, -30.0, "%4.2f", dB)},
        {0.5, 0.0, "%f dB", linear(0.5, 0.0, "%f", dB)},
        {1.0 / 256, 0.0, "%f", linear(1.0 / 256, 0.0, "%f")},
        {0.334, -63.248, "%+.2f dBm", linear(0.334, -63.248, "%+.2f", dBm)},
        {0.1, 0.0, "%+.2f dBm", linear(0.1, 0.0, "%+.2f", dBm)},
    };
    for (const auto& number : kCases) {
        SCOPED_TRACE(number.format);
        const auto reference = [&](std::int64_t raw) {
            return byPrintf(number.format, static_cast<double>(raw) * number.scale + number.offset);
        };
        expectLikePrintf(number.shown, sixteenBits(), reference);
        expectLikePrintf(number.shown, signedEdges(), reference);
    }
}

TEST(Printing, WritesTheNumberOfAFieldInAnotherFormatForTheLog) {
    static constexpr Shown kLevel = linear(0.25, -30.0, "%4.2f", dB);
    static constexpr NumberFormat kLine("Measured RSSI: %lf\n");
    std::string text;
    for (std::int64_t raw = -32768; raw <= 65535; ++raw) {
        kLine.print(text, kLevel.measure(raw)->number);
        ASSERT_EQ(text, byPrintf("Measured RSSI: %lf\n", static_cast<double>(raw) * 0.25 - 30.0));
    }
}

}  // namespace
}  // namespace kelvo
