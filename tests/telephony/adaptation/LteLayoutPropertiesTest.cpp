// Every field of the newer LTE layouts over its whole range, through the adapter and onto the screens.
#include <gtest/gtest.h>

#include "tests/telephony/adaptation/LayoutProperties.h"

namespace kelvo::test {
namespace {

using enum Goes;

constexpr Scale kRsrp16{1.0 / 16, -180};
constexpr Scale kRsrq16{1.0 / 16, -30};
constexpr Scale kRssi16{1.0 / 16, -110};
constexpr Scale kRsrpQuarter{0.25, -140};
constexpr Scale kRsrpHalf{0.5, -140};
constexpr Scale kRsrqEighth{0.125, -20};
constexpr Scale kRsrqQuarter{0.25, -30};
constexpr Scale kRssiHalf{0.5, -140};
constexpr const char* kDbm = "%4.2f dBm";
constexpr const char* kDb = "%4.2f dB";

/// A record of `size` bytes of `fill`, but for its version.
Sent filled(LogCode code, std::size_t size, std::uint8_t fill, std::uint32_t version) {
    Sent sent(code, size);
    for (std::size_t at = 0; at < size; ++at) sent.u8(at, fill);
    return sent.u8(0, version);
}

Field same(const std::string& name, Bits newer, Bits fixed, const std::string& path = {},
           const std::string& format = "%.0f", Scale scale = {}) {
    return {name, AsItStands, newer, fixed, scale, scale, path, format};
}
Field channel(const std::string& name, Bits newer, Bits fixed, const std::string& path = {}) {
    return {name, AsChannel, newer, fixed, {}, {}, path, "%.0f"};
}
Field level(const std::string& name, Bits newer, Scale newerScale, Bits fixed, Scale fixedScale,
            const std::string& path, const std::string& format) {
    return {name, ToNearest, newer, fixed, newerScale, fixedScale, path, format};
}

TEST(LteLayoutProperties, OfMasterInformation) {
    const auto layout = [](std::uint32_t version, std::size_t size, std::size_t ports) {
        return Layout{
            "0xB0C1 version " + std::to_string(version),
            Technology::LTE,
            [=](std::uint8_t fill) { return filled(0xB0C1, size, fill, version); },
            {same("PCI", u16At(1), u16At(1)), channel("EARFCN", u32At(3), u16At(3)), same("frame", u16At(7), u16At(5)),
             same("ports", u8At(ports), u8At(7), "Serving Cell Info/Num Tx Antennas")}};
    };
    for (Layout wide : {layout(2, 11, 9), layout(3, 12, 9)}) {
        wide.fields.push_back(same("resource blocks", u8At(10), u8At(8)));
        expectEveryValueToGoOver(wide);
    }
    expectEveryValueToGoOver(layout(17, 18, 17));
}

TEST(LteLayoutProperties, OfTheServingCell) {
    expectEveryValueToGoOver(
        {"0xB0C2 version 3",
         Technology::LTE,
         [](std::uint8_t fill) { return filled(0xB0C2, 29, fill, 3); },
         {same("PCI", u16At(1), u16At(1), "Serving Cell Info/Physical Cell ID"),
          channel("EARFCN down", u32At(3), u16At(3), "Serving Cell Info/Download Frequency"),
          channel("EARFCN up", u32At(7), u16At(5), "Serving Cell Info/Upload Frequency"),
          same("blocks down", u8At(11), u8At(7)), same("blocks up", u8At(12), u8At(8)),
          same("cell identity", u32At(13), u32At(9)),
          same("tracking area", u16At(17), u16At(13), "Serving Cell Info/Tracking Area Code"),
          same("band", u32At(19), u32At(15)), same("MCC", u16At(23), u16At(19)), same("MNC digits", u8At(25), u8At(21)),
          same("MNC", u16At(26), u16At(22)), same("allowed access", u8At(28), u8At(24))}});
}

// One measured and one detected cell.
Layout connected(std::uint32_t version, std::size_t start, Field earfcn, std::size_t pci, Bits detectedPci) {
    const std::string section = "Connected mode LTE Intra-frequency Measurement/";
    const std::string cell = "Measured Neighbor Cells/0/";
    earfcn.path = section + "E-ARFCN";
    return {"0xB179 version " + std::to_string(version),
            Technology::LTE,
            [=](std::uint8_t fill) {
                return filled(0xB179, start + 12 + 16, fill, version)
                    .u8(4, 0)
                    .u8(start - 2 - (version == 4 ? 2 : 0), 1)
                    .u8(start - 1 - (version == 4 ? 2 : 0), 1)
                    .u32(start + 12, 7);
            },
            {earfcn, same("PCI", u16At(pci), u16At(6), section + "Serving Physical Cell ID"),
             same("frame and sub-frame", u16At(pci + 2), u16At(8), section + "Subframe Number"),
             level("RSRP", s16At(pci + 4), kRsrp16, u16At(10), kRsrpQuarter, section + "Serving Filtered RSRP", kDbm),
             level("RSRQ", s16At(pci + 8), kRsrq16, u16At(12), kRsrqEighth, section + "Serving Filtered RSRQ", kDb),
             same("measured PCI", u16At(start), u16At(16), cell + "Physical Cell ID"),
             level("measured RSRP", s16At(start + 2), kRsrp16, u16At(18), kRsrpQuarter, cell + "Filtered RSRP", kDbm),
             level("measured RSRQ", s16At(start + 6), kRsrq16, u16At(20), kRsrqEighth, cell + "Filtered RSRQ", kDb),
             same("detected PCI", detectedPci, u16At(22), "Detected Cells/0/Physical Cell ID")}};
}

TEST(LteLayoutProperties, OfConnectedMode) {
    expectEveryValueToGoOver(connected(3, 24, same("EARFCN", u16At(8), u16At(4)), 10, u32At(36)));
    expectEveryValueToGoOver(connected(4, 28, channel("EARFCN", u32At(8), u16At(4)), 12, u16At(40)));
}

const std::string kIdle = "Serving Cell Measurements/";

Layout idle(std::uint32_t version, std::uint32_t flag, Field earfcn, std::size_t pci, std::size_t words) {
    earfcn.path = kIdle + "E-ARFCN";
    const std::size_t limits = words + 16;
    const std::size_t rules = words + 20;
    Field priority = same("priority", {pci, 9, 15}, {6, 9, 12}, kIdle + "Serving Layer Priority");
    priority.goes = Cut;
    Field maximum = same("P_Max", {limits, 6, 12}, {12, 15, 21}, kIdle + "P_Max", "%.0f dBm", {1, -30});
    maximum.absent = 64;
    Field power =
        same("maximum power", {limits, 13, 18}, {12, 22, 27}, kIdle + "Max UE Tx Power", "%.0f dBm", {1, -30});
    const auto search = [&](const std::string& name, Bits newer, Bits fixed, const std::string& key,
                            const std::string& format) {
        return Field{name, AsSearch, newer, fixed, {}, {2, 0}, kIdle + key, format, 32};
    };
    return {
        "0xB17F version " + std::to_string(version) + " flag " + std::to_string(flag),
        Technology::LTE,
        [=](std::uint8_t fill) { return filled(0xB17F, words + 24 + 4 * flag, fill, version).u8(1, flag); },
        {earfcn, same("PCI", {pci, 0, 8}, {6, 0, 8}, kIdle + "Physical Cell ID"), priority,
         level("RSRP", {words, 0, 11}, kRsrp16, {8, 0, 8}, kRsrpQuarter, kIdle + "Measured RSRP", kDbm),
         level("averaged RSRP", {words + 4, 0, 11}, kRsrp16, {8, 9, 17}, kRsrpQuarter, kIdle + "Average RSRP", kDbm),
         level("RSRQ", {words + 8, 0, 9}, kRsrq16, {8, 18, 24}, kRsrqQuarter, kIdle + "Measured RSRQ", kDb),
         level("averaged RSRQ", {words + 8, 20, 29}, kRsrq16, {8, 25, 31}, kRsrqQuarter, kIdle + "Average RSRQ", kDb),
         level("RSSI", {words + 12, 10, 20}, kRssi16, {12, 0, 8}, kRssiHalf, kIdle + "Measured RSSI", kDbm),
         same("Qrxlevmin", {limits, 0, 5}, {12, 9, 14}, kIdle + "Qrxlevmin", "%.0f dBm", {2, -140}), maximum, power,
         level("Srxlev", {limits, 19, 25}, {1, -50}, {16, 0, 6}, {1, -30}, kIdle + "Srxlev", "%.0f dBm"),
         same("DRX cycles", {limits, 26, 31}, {16, 7, 12}, kIdle + "Num of Consecutive DRX Cycles of S < 0"),
         search("S intra", {rules, 0, 5}, {16, 13, 18}, "S Intra Search", "%.0f dB"),
         search("S non intra", {rules, 6, 11}, {16, 19, 24}, "S Non Intra Search", "%.0f dBm"),
         same("rules updated", {rules, 12, 12}, {16, 25, 25}),
         same("rules", {rules, 13, 16}, {16, 26, 29}, kIdle + "Measurement Rules")}};
}

TEST(LteLayoutProperties, OfTheIdleServingCell) {
    for (const std::uint32_t flag : {0U, 1U}) {
        expectEveryValueToGoOver(idle(3, flag, same("EARFCN", u16At(4), u16At(4)), 6, 8));
        expectEveryValueToGoOver(idle(5, flag, channel("EARFCN", u32At(4), u16At(4)), 8, 12));
    }
    expectEveryValueToGoOver(idle(4, 0, same("EARFCN", u16At(4), u16At(4)), 6, 8));
}

// Two cells, of which the second is looked at; PCI and Srxlev are 1, so that no place is an empty one.
Layout neighbors(std::uint32_t version, std::uint32_t flag) {
    const bool isWide = version == 5;
    const std::size_t stride = 28 + 4 * flag;
    const std::size_t first = isWide ? 12 : 8;
    const std::size_t at = first + stride;
    const std::string list = "Neighbor Cells List/1/";
    Field earfcn = isWide ? channel("EARFCN", u32At(4), u16At(4)) : same("EARFCN", u16At(4), u16At(4));
    earfcn.path = "Neighbor Measurements/E-ARFCN";
    const auto word = [at](std::size_t index, int low, int high) { return Bits{at + 4 * index, low, high}; };
    const auto fixed = [](std::size_t offset, int low, int high) { return Bits{8 + 20 + offset, low, high}; };
    return {"0xB180 version " + std::to_string(version) + " flag " + std::to_string(flag),
            Technology::LTE,
            [=](std::uint8_t fill) {
                Sent sent = filled(0xB180, first + 2 * stride, fill, version).u8(1, flag);
                isWide ? sent.bits(8, 6, 31, 2) : sent.bits(6, 6, 15, 2);
                for (const std::size_t cell : {first, at}) sent.bits(cell, 0, 8, 1).bits(cell + 12, 20, 25, 1);
                return sent;
            },
            {earfcn,
             same("Qrxlevmin", {isWide ? 8U : 6U, 0, 5}, {6, 0, 5}, "Neighbor Measurements/Qrxlevmin", "%.0f dBm",
                  {2, -140}),
             same("PCI", word(0, 0, 8), fixed(0, 0, 8), list + "Physical Cell ID"),
             level("RSSI", word(0, 9, 19), kRssi16, fixed(0, 9, 16), kRssiHalf, list + "Measured RSSI", kDbm),
             level("RSRP", word(0, 20, 31), kRsrp16, fixed(0, 17, 25), kRsrpHalf, list + "Measured RSRP", kDbm),
             level("averaged RSRP", word(1, 12, 23), kRsrp16, fixed(4, 0, 8), kRsrpHalf, list + "Average RSRP", kDbm),
             level("RSRQ", word(2, 12, 21), kRsrq16, fixed(4, 9, 15), kRsrqQuarter, list + "Measured RSRQ", kDb),
             level("averaged RSRQ", word(3, 0, 9), kRsrq16, fixed(4, 16, 22), kRsrqQuarter, list + "Average RSRQ", kDb),
             same("Srxlev", word(3, 20, 25), fixed(4, 23, 29), list + "Srxlev", "%.0f dBm", {1, -30}),
             same("frequency offset", u16At(at + 16), u16At(28 + 8), list + "Frequency Offset"),
             same("frame, antenna 0", word(5, 0, 10), fixed(12, 0, 10), list + "Ant 0 Frame Offset"),
             same("sample, antenna 0", word(5, 11, 29), fixed(12, 11, 29), list + "Ant 0 Sample Offset"),
             same("frame, antenna 1", word(6, 0, 10), fixed(16, 0, 10)),
             same("sample, antenna 1", word(6, 11, 29), fixed(16, 11, 29))}};
}

TEST(LteLayoutProperties, OfIdleNeighbors) {
    for (const std::uint32_t version : {4U, 5U}) {
        for (const std::uint32_t flag : {0U, 1U}) expectEveryValueToGoOver(neighbors(version, flag));
    }
}

// 0xB193 with part 25 alone; its body starts at 8, and B counts from there. The cell is not known otherwise, so that
// Srxlev is the level above -140 dBm.
constexpr std::size_t B = 8;
struct Cell {
    std::size_t pci;
    Bits rsrp, filteredRsrp, rsrq, filteredRsrq, rssi;
};
Layout everyMode(std::uint32_t version, std::size_t body, const Cell& cell) {
    const auto in = [](Bits bits) { return Bits{B + bits.at, bits.low, bits.high}; };
    return {
        "0xB193 part 25 version " + std::to_string(version),
        Technology::LTE,
        [=](std::uint8_t fill) {
            Sent sent = filled(0xB193, B + body, fill, 1);
            sent.u8(1, 1).u8(4, 25).u8(5, version).u16(6, static_cast<std::uint32_t>(4 + body));
            if (version != 18) sent.u16(B + 4, 1);
            return sent.bits(B + cell.pci, 9, 11, 0).bits(B + cell.pci, 12, 12, 1);
        },
        {channel("EARFCN", u32At(B), u16At(4), kIdle + "E-ARFCN"),
         same("PCI", {B + cell.pci, 0, 8}, {6, 0, 8}, kIdle + "Physical Cell ID"),
         level("RSRP", in(cell.rsrp), kRsrp16, {8, 0, 8}, kRsrpQuarter, kIdle + "Measured RSRP", kDbm),
         level("averaged RSRP", in(cell.filteredRsrp), kRsrp16, {8, 9, 17}, kRsrpQuarter, kIdle + "Average RSRP", kDbm),
         level("RSRQ", in(cell.rsrq), kRsrq16, {8, 18, 24}, kRsrqQuarter, kIdle + "Measured RSRQ", kDb),
         level("averaged RSRQ", in(cell.filteredRsrq), kRsrq16, {8, 25, 31}, kRsrqQuarter, kIdle + "Average RSRQ", kDb),
         level("RSSI", in(cell.rssi), kRssi16, {12, 0, 8}, kRssiHalf, kIdle + "Measured RSSI", kDbm),
         level("Srxlev", in(cell.rsrp), {1.0 / 16, -180 + 140}, {16, 0, 6}, {1, -30}, kIdle + "Srxlev", "%.0f dBm")}};
}

TEST(LteLayoutProperties, OfTheServingCellInEveryMode) {
    expectEveryValueToGoOver(
        everyMode(18, 92, {4, {28, 12, 23}, {28, 12, 23}, {36, 20, 29}, {36, 20, 29}, {44, 0, 10}}));
    expectEveryValueToGoOver(
        everyMode(19, 360, {8, {32, 12, 23}, {32, 12, 23}, {40, 20, 29}, {40, 20, 29}, {48, 0, 10}}));
    expectEveryValueToGoOver(everyMode(36, 520, {8, {40, 0, 11}, {40, 12, 23}, {52, 0, 9}, {52, 20, 29}, {64, 0, 10}}));
}

}  // namespace
}  // namespace kelvo::test
