// Every field of the newer GSM and UMTS layouts over its whole range: nothing is rounded.
#include <gtest/gtest.h>

#include "tests/telephony/adaptation/LayoutProperties.h"

namespace kelvo::test {
namespace {

Sent filled(LogCode code, std::size_t size, std::uint8_t fill) {
    Sent sent(code, size);
    for (std::size_t at = 0; at < size; ++at) sent.u8(at, fill);
    return sent;
}

Field same(const std::string& name, Bits newer, Bits fixed, const std::string& path = {},
           const std::string& format = "%.0f") {
    return {name, Goes::AsItStands, newer, fixed, {}, {}, path, format};
}

// 0x4005 with two UMTS cells, of which the second is looked at.
Layout umtsRanking(std::uint32_t version, std::size_t start, std::size_t size) {
    const std::size_t at = start + size;
    const std::string cell = "UMTS Cells/UMTS Set/1/";
    return {"0x4005 version " + std::to_string(version) + ", UMTS",
            Technology::GSM,
            [=](std::uint8_t fill) {
                // Version 0 with one list is the fixed layout: there, a GSM cell follows.
                const std::size_t gsm = version == 0 ? 7 : 0;
                return filled(0x4005, start + 2 * size + gsm, fill).u8(0, version << 6 | 2).u8(1, gsm != 0 ? 1 : 0);
            },
            {same("UARFCN", u16At(at), u16At(12)), same("PSC", u16At(at + 2), u16At(14), cell + "Scrambling Code"),
             same("RSCP", u8At(at + 4), u8At(16)), same("RSCP rank", u16At(at + 5), u16At(17)),
             same("Ec/Io", u8At(at + 7), u8At(19)), same("rank", u16At(at + 8), u16At(20))}};
}

TEST(GsmLayoutProperties, OfRankedUmtsCells) {
    expectEveryValueToGoOver(umtsRanking(0, 2, 10));
    expectEveryValueToGoOver(umtsRanking(1, 2, 11));
    expectEveryValueToGoOver(umtsRanking(2, 7, 16));
}

Layout gsmRanking(std::uint32_t version, std::size_t start, std::size_t size) {
    const std::size_t at = start + size;
    const std::string cell = "GSM Cell and Neighbours/GSM Set/1/";
    return {
        "0x4005 version " + std::to_string(version) + ", GSM",
        Technology::GSM,
        [=](std::uint8_t fill) { return filled(0x4005, start + 2 * size, fill).u8(0, version << 6).u8(1, 2); },
        {same("ARFCN", {at, 0, 11}, u16At(9), cell + "ARFCN"), same("BSIC", u16At(at + 2), u16At(11), cell + "BSIC"),
         same("RSSI", u8At(at + 4), u8At(13)), same("rank", u16At(at + 5), u16At(14))}};
}

TEST(GsmLayoutProperties, OfRankedGsmCells) {
    expectEveryValueToGoOver(gsmRanking(1, 2, 8));
    expectEveryValueToGoOver(gsmRanking(2, 7, 13));
}

TEST(GsmLayoutProperties, OfTheLongCellIdentity) {
    expectEveryValueToGoOver({"0x4127",
                              Technology::GSM,
                              [](std::uint8_t fill) { return filled(0x4127, 32, fill); },
                              {same("uplink", u32At(0), u32At(0)), same("downlink", u32At(4), u32At(4)),
                               same("cell identity", u32At(8), u32At(8)),
                               same("URA", u16At(12), u16At(12), "UMTS Radio/UMTS RR Info/URA ID"),
                               same("the rest", u16At(14), u16At(14))}});
}

TEST(GsmLayoutProperties, OfTheServingCellOfTwoSims) {
    const std::string section = "GSM Cell and Neighbours/GSM Serving Cell/";
    expectEveryValueToGoOver(
        {"0x5B34",
         Technology::GSM,
         [](std::uint8_t fill) { return filled(0x5B34, 14, fill); },
         {same("ARFCN", u16At(1), u16At(0), section + "ARFCN"), same("BSIC", u16At(3), u16At(2), section + "BSIC"),
          same("cell identity", u16At(5), u16At(4), section + "Cell ID")}});
}

// The serving cell and two neighbors, of which the second is looked at.
Layout extendedCells(LogCode code, std::size_t serving) {
    const std::size_t neighbor = serving + 26 + 25;
    const std::string cell = "GSM Cell and Neighbours/Neighboring Cells/1/";
    return {
        "0x51FC",
        Technology::GSM,
        [=](std::uint8_t fill) { return filled(code, neighbor + 25, fill).u8(serving + 25, 2); },
        {same("ARFCN", {serving, 0, 11}, u16At(0)),
         same("RxLev", u8At(serving + 5), u8At(2), "GSM Cell and Neighbours/GSM Serving Cell/RSSI", "%.0f dBm"),
         same("C1", u32At(serving + 6), u32At(3)), same("C2", u32At(serving + 10), u32At(7)),
         same("timer", u8At(serving + 22), u8At(11)), same("barred", u8At(serving + 23), u8At(12)),
         same("reselected", u8At(serving + 24), u8At(13)),
         same("neighbor's ARFCN", {neighbor, 0, 11}, u16At(30), cell + "ARFCN"),
         same("neighbor's RxLev", u8At(neighbor + 5), u8At(32), cell + "RSSI"),
         same("neighbor's C1", u32At(neighbor + 6), u32At(33)), same("neighbor's C2", u32At(neighbor + 10), u32At(37)),
         same("neighbor's timer", u8At(neighbor + 22), u8At(41)),
         same("neighbor's barred", u8At(neighbor + 23), u8At(42)),
         same("neighbor's same area", u8At(neighbor + 24), u8At(43))}};
}

TEST(GsmLayoutProperties, OfTheExtendedServingCellAndNeighbors) {
    expectEveryValueToGoOver(extendedCells(0x51FC, 0));
    expectEveryValueToGoOver(extendedCells(0x5BFC, 1));
}

// 0x7150: MCC and MNC in packed BCD, a MNC of two digits with 15 in its third place.
TEST(GsmLayoutProperties, OfEveryEquivalentNetwork) {
    Adapter adapt;
    for (std::uint32_t mcc = 0; mcc < 1000; ++mcc) {
        for (std::uint32_t mnc = mcc % 7; mnc < 1100; mnc += mcc == 262 ? 1 : 97) {
            const std::uint32_t digits[] = {mcc / 100, mcc / 10 % 10, mcc % 10};
            const bool isShort = mnc >= 1000;  // 00 to 99
            const std::uint32_t code[] = {isShort ? 0 : mnc / 100, mnc / 10 % 10, mnc % 10};
            const std::uint32_t third = isShort ? 15 : code[2];
            const std::uint32_t first = isShort ? code[1] : code[0];
            const std::uint32_t second = isShort ? code[2] : code[1];
            const Sent sent = Sent(0x7150, 19)
                                  .u8(0, 0x64)
                                  .u8(3, 1)
                                  .u8(4, digits[1] << 4 | digits[0])
                                  .u8(5, third << 4 | digits[2])
                                  .u8(6, second << 4 | first);
            const Sent fixed = Sent(0x7150, 10)
                                   .u8(3, 1)
                                   .u8(4, digits[0])
                                   .u8(6, digits[1])
                                   .u8(8, digits[2])
                                   .u8(5, code[0])
                                   .u8(7, code[1])
                                   .u8(9, code[2]);
            ASSERT_EQ(adapt(sent), is(fixed)) << mcc << "-" << mnc;
        }
    }
}

}  // namespace
}  // namespace kelvo::test
