// Whole LTE displays against a decoder written as plainly as can be: byte by byte, with printf, into maps that are made
// anew for each record. Records are random, also in their lengths, and follow one another on one display.

#include <gtest/gtest.h>

#include <cstdarg>
#include <cstdio>
#include <random>

#include "LogGenerator/LTE/LTELogGenerator.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "tests/support/Record.h"

namespace kelvo {
namespace {

using Row = std::vector<std::pair<std::string, std::string>>;

__attribute__((format(printf, 1, 2))) std::string byPrintf(const char* format, ...) {
    char text[100];
    std::va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(text, sizeof text, format, arguments);
    va_end(arguments);
    return text;
}

class PlainRecord {
public:
    explicit PlainRecord(const Bytes& bytes) : _bytes(bytes) {}

    unsigned number(std::size_t at, int bytes) const {
        unsigned value = 0;
        for (int i = 0; i < bytes; ++i) value += (at + i < _bytes.size() ? _bytes[at + i] : 0u) << (8 * i);
        return value;
    }
    unsigned bits(std::size_t at, int low, int high) const { return (number(at, 4) >> low) % (1u << (high - low + 1)); }
    std::size_t size() const { return _bytes.size(); }

private:
    const Bytes& _bytes;
};

std::vector<Row> measuredCells(const PlainRecord& record) {
    std::vector<Row> rows;
    for (unsigned i = 0; i < record.number(27, 1); ++i) {
        const std::size_t at = 29 + 6 * i;
        if (at >= record.size()) break;
        rows.push_back({{"Physical Cell ID", byPrintf("%d", record.number(at, 2))},
                        {"Filtered RSRP", byPrintf("%4.2f dBm", record.number(at + 2, 2) * 0.25 - 140)},
                        {"Filtered RSRQ", byPrintf("%4.2f dB", record.number(at + 4, 2) * 0.125 - 20)}});
    }
    return rows;
}

std::vector<Row> detectedCells(const PlainRecord& record) {
    std::vector<Row> rows;
    for (unsigned i = 0; i < record.number(28, 1); ++i) {
        const std::size_t at = 29 + 6 * record.number(27, 1) + 2 * i;
        if (at >= record.size()) break;
        rows.push_back({{"Physical Cell ID", byPrintf("%d", record.number(at, 2))}});
    }
    return rows;
}

std::vector<Row> idleCells(const PlainRecord& record) {
    std::vector<Row> rows;
    for (unsigned i = 0; i < (record.number(19, 2) >> 6 & 31) + 1; ++i) {
        const std::size_t at = 21 + 20 * i;
        if (at >= record.size()) break;
        const auto level = [&](std::size_t word, int low, int high) {
            return byPrintf("%4.2f dBm", record.bits(word, low, high) * 0.5 - 140);
        };
        const auto quality = [&](std::size_t word, int low, int high) {
            return byPrintf("%4.2f dB", record.bits(word, low, high) * 0.25 - 30);
        };
        const std::string frame = byPrintf("%d", record.bits(at + 12, 0, 10));
        const std::string sample = byPrintf("%d", record.bits(at + 12, 11, 29));
        rows.push_back({{"Physical Cell ID", byPrintf("%d", record.bits(at, 0, 8))},
                        {"Measured RSSI", level(at, 9, 16)},
                        {"Measured RSRP", level(at, 17, 25)},
                        {"Average RSRP", level(at + 4, 0, 8)},
                        {"Measured RSRQ", quality(at + 4, 9, 15)},
                        {"Average RSRQ", quality(at + 4, 16, 22)},
                        {"Srxlev", byPrintf("%d dBm", static_cast<int>(record.bits(at + 4, 23, 29)) - 30)},
                        {"Frequency Offset", byPrintf("%d", record.number(at + 8, 2))},
                        {"Ant 0 Frame Offset", frame},
                        {"Ant 0 Sample Offset", sample},
                        {"Ant 1 Frame Offset", frame},
                        {"Ant 1 Sample Offset", sample}});
    }
    return rows;
}

std::string bandwidth(unsigned blocks) {
    switch (blocks) {
        case 6: return "1.4 MHz";
        case 15: return "3 MHz";
        case 25: return "5 MHz";
        case 50: return "10 MHz";
        case 75: return "15 MHz";
        case 100: return "20 MHz";
        default: return "Unknown";
    }
}

Row servingCell(const PlainRecord& record) {
    return {{"Physical Cell ID", byPrintf("%d", record.number(14, 2))},
            {"Download Frequency", byPrintf("%d", record.number(16, 2))},
            {"Upload Frequency", byPrintf("%d", record.number(18, 2))},
            {"Download Bandwidth", bandwidth(record.number(20, 1))},
            {"Upload Bandwidth", bandwidth(record.number(21, 1))},
            {"Cell Identity", byPrintf("%d", static_cast<int>(record.number(22, 4)))},
            {"Tracking Area Code", byPrintf("%d", record.number(26, 2))},
            {"Freq Band Indicator", byPrintf("%d", static_cast<int>(record.number(28, 4)))}};
}

class PlainReference : public testing::Test {
protected:
    Bytes randomRecord(LogCode code, std::size_t minimum, std::size_t maximum) {
        Bytes bytes(minimum + _random() % (maximum - minimum + 1));
        for (std::uint8_t& byte : bytes) byte = static_cast<std::uint8_t>(_random());
        bytes[0] = 1;
        bytes[3] = static_cast<std::uint8_t>(code);
        bytes[4] = static_cast<std::uint8_t>(code >> 8);
        if (code == 0xB179) bytes[27] %= 8;
        if (code == 0xB0C2) bytes[20] %= 101;
        return bytes;
    }

    std::vector<Row> shownRows(const char* section) {
        std::vector<Row> rows;
        for (const Value& row : *(*_state["Display"].dictionary())[section].array()) {
            rows.emplace_back();
            for (const auto& [key, value] : *row.dictionary()) rows.back().emplace_back(key, *value.string());
        }
        return rows;
    }
    Row shownValues(const char* section, const Row& like) {
        Row values;
        const Dictionary& shown = *(*_state["Display"].dictionary())[section].dictionary();
        for (const auto& [key, value] : like) values.emplace_back(key, *shown[key].string());
        return values;
    }

    std::mt19937 _random{20190307};
    const DirectoryResources _resources{KELVO_RESOURCE_DIR};
    const Environment::Scope _environment{{.resources = &_resources}};
    Dictionary _state;
    LTELogGenerator _generator;
};

TEST_F(PlainReference, AgreesOnEveryCellOfManyRecords) {
    for (int i = 0; i < 3000; ++i) {
        const Bytes connected = randomRecord(0xB179, 29, 90);
        const Bytes idle = randomRecord(0xB180, 21, 700);
        _generator.updateState(_state, connected);
        _generator.updateState(_state, idle);
        if (i % 3 == 1) continue;  // a display is not read after each record
        ASSERT_EQ(shownRows("Measured Neighbor Cells"), measuredCells(PlainRecord(connected)));
        ASSERT_EQ(shownRows("Detected Cells"), detectedCells(PlainRecord(connected)));
        ASSERT_EQ(shownRows("Neighbor Cells List"), idleCells(PlainRecord(idle)));
    }
}

TEST_F(PlainReference, AgreesOnTheServingCellOfManyRecords) {
    for (int i = 0; i < 3000; ++i) {
        const Bytes bytes = randomRecord(0xB0C2, 38, 50);
        _generator.updateState(_state, bytes);
        const Row expected = servingCell(PlainRecord(bytes));
        ASSERT_EQ(shownValues("Serving Cell Info", expected), expected);
    }
}

}  // namespace
}  // namespace kelvo
