#pragma once

#include <string>
#include <vector>

#include "platform/encodings/PropertyList.h"
#include "tests/support/CellArray.h"
#include "tests/support/Subpackets.h"
#include "tests/telephony/recordings/Wire.h"
#include "tests/tools/KelvoctlTest.h"

/// Files with secrets in them: numbers, identities, names, in the fields of every family and where Kelvo knows of none.
namespace kelvo::test {

inline const std::string kImsi = "262019876543210";
inline const std::string kOther = "358240051111110";  // an IMEI, in what Kelvo does not know

/// The packet with the length that it has.
inline Bytes whole(const Record& record) {
    Bytes bytes = record.bytes();
    bytes[1] = static_cast<std::uint8_t>(bytes.size() - 1);
    bytes[2] = static_cast<std::uint8_t>((bytes.size() - 1) >> 8);
    return bytes;
}

inline Record simFiles() {
    return payload(
        0xFF0000,
        Dictionary::make({{"kSimFile_ICCID", "8949020198765432109"},
                          {"kSimFile_MSISDN", "+491709876543"},
                          {"kSimFile_MBDN", Bytes{'A',  'n',  'n',  'e',  'g',  'r',  'e',  't',  7,    0x91, 0x94,
                                                  0x71, 0x31, 0x33, 0x89, 0x67, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF}},
                          {"kSimFile_LOCI", "3A9C41D762F2191234FF00"},
                          {"kSimFile_PSLOCI", "C41B7E02A95D1362F21912340A00"},
                          {"kSimFile_FPLMN", Bytes{0x62, 0xF2, 0x19, 0xFF, 0xFF, 0xFF}},
                          {"kSimFile_AHPLMN", "62F219"},
                          {"kSimFile_PNN", "Nordfunk"},
                          {"kSimFile_OPL", "62f2190000fffe01"},
                          {"kSimFile_OPLMNAcT", "62F219C080"},
                          {"kSimFile_IMSI", kImsi},
                          {"kSimFile_AD", "of IMSI " + kImsi}}));
}

inline Record contexts() {
    return payload(0xFF0002, Array::make({Dictionary::make({{"Context ID", "5"},
                                                            {"APN", "fabrik.example"},
                                                            {"PDP Type", "IPv4v6"},
                                                            {"State", "Active"},
                                                            {"PDP Address", "100.71.23.45, 2003:e4:1705:b1a::5"},
                                                            {"User", "Annegret"}}),
                                          Dictionary::make({{"PDP Address", Bytes{100, 71, 23, 45}}})}));
}

inline Record cells(const std::string& technology) {
    return cellArray({cell(technology, "Serving",
                           {{"kPLCellMonitorMCC", 262},
                            {"kPLCellMonitorMNC", 91},
                            {"kPLCellMonitorCellId", 26'385'441},
                            {"kPLCellMonitorTAC", 45'663},
                            {"kPLCellMonitorLAC", 45'663},
                            {"kPLCellMonitorPID", 301},
                            {"kPLCellMonitorOwner", kImsi}})});
}

/// Digits in nibbles, the low one first, between the fields that Kelvo knows.
inline void plant(Record& record, std::size_t at, const std::string& digits) {
    for (std::size_t i = 0; i < digits.size(); i += 2) {
        const int high = i + 1 < digits.size() ? digits[i + 1] - '0' : 15;
        record.u8(at++, static_cast<std::uint32_t>(high << 4 | (digits[i] - '0')));
    }
}

/// A record of a code that Kelvo does not know.
inline Bytes unknown() { return whole(Record(0xB195, 13).text(13, "IMSI " + kImsi + ", Annegret, by the river")); }

inline std::vector<Bytes> lteMessages() {
    Record serving(0xB0C2, 38);
    serving.u8(13, 2).u16(14, 301).u16(16, 1300).u16(18, 19'300).u8(20, 50).u8(21, 25).u32(22, 26'385'441);
    serving.u16(26, 45'663).u32(28, 3).u16(32, 262).u8(34, 2).u16(35, 91);
    Record idle(0xB17F, 33);
    idle.u8(13, 2).u16(17, 1300).u16(19, 301).u32(21, 0x4A95A52F).u32(25, 0x0BB0C0D0).u32(29, 0x0A0B0C0D);
    return {serving.bytes(), whole(simFiles()), unknown(), whole(cells("LTE")), whole(contexts()), idle.bytes()};
}

inline std::vector<Bytes> gsmMessages() {
    Record network(0x7135, 40);
    network.u8(14, 3).u8(15, 0x62).u8(16, 0xF2).u8(17, 0x19).u8(18, 0xB2).u8(19, 0x5F).u8(20, 17);
    plant(network, 22, kImsi);
    Record cell(0x4127, 29);
    cell.u32(13, 9613).u32(17, 10'563).u32(21, 66'712'345).u16(25, 4711);
    return {network.bytes(), whole(simFiles()), whole(cells("UMTS")), whole(contexts()), cell.bytes(), unknown()};
}

inline std::vector<Bytes> utranMessages() {
    Record cell(0xD0E2, 40);
    cell.u8(14, 1).u8(15, 9).u16(17, 9613).u16(19, 10'054).u32(21, 66'712'345).u8(25, 1);
    plant(cell, 27, kImsi);
    return {cell.bytes(), whole(simFiles()), whole(cells("UTRAN2")), whole(contexts()), unknown()};
}

inline std::vector<Bytes> cdmaMessages() {
    Record status(0x1183, 50);
    status.u16(13, 0x0921).u8(15, 0xB0).u16(18, 123).u8(36, 5).u8(37, 4).u16(38, 0xFFE5).u8(40, 0xC0).u8(41, 77);
    plant(status, 22, kOther);
    Record system(0x134F, 200);
    system.u8(13, 2).u32(42, 0).u32(46, 2).u16(50, 4711).u16(52, 77).u8(131, 3).u16(184, 777).u8(133, 6);
    plant(system, 60, kImsi);
    Subpackets oneX(0x119C);
    oneX.add(1, 16).u8(4, 8).add(2, 16).add(3, 12).add(4, 16);
    Record oneXStatus = oneX;
    plant(oneXStatus, 17 + 8, kImsi);
    return {status.bytes(), system.bytes(), oneXStatus.bytes(), unknown()};
}

inline Bytes cellMonitorTree() {
    const Value cell = Dictionary::make({{"MCC", "262"},
                                         {"MNC", "91"},
                                         {"CellId", "26385441"},
                                         {"IMSI", kImsi},
                                         {"TMSI", "3A9C41D7"},
                                         {"RSSI", "-71 dBm"},
                                         {"Annegret", kOther}});
    return *writeXmlPropertyList(Dictionary::make({{"Serving", Dictionary::make({{"Cell", cell}})}}));
}

/// Runs "kelvoctl share" with a key of its own, access points hidden.
struct SharedFiles : KelvoctlTest {
    SharedFiles() { directory.write("key", bytesOf("a key of a test, long enough")); }

    std::string out() { return path("out"); }
    Finished share(const std::string& in, std::vector<std::string> more = {}) {
        more.insert(more.begin(), {"share", in, "-o", out(), "--force", "--hide-apns", "--key", path("key")});
        return kelvoctl(more);
    }
    std::string frames(const std::vector<Bytes>& messages) {
        Bytes bytes = {0x31, 0x32, 0x7E};  // the end of a frame
        for (const Bytes& message : messages) {
            bytes += plainFrame(recordBodyOf(Bytes(message.begin() + 1, message.end())));
        }
        Bytes text = {0x79, 1};  // of the modem
        text.insert(text.end(), kImsi.begin(), kImsi.end());
        bytes += plainFrame(text);
        const Bytes record = unknown();
        Bytes damaged = plainFrame(recordBodyOf(Bytes(record.begin() + 1, record.end())));
        damaged[8] ^= 1;
        bytes += damaged;
        return directory.write("in.frames", bytes);
    }
    /// A snapshot as the application saves one, with what it does not save beside it.
    std::string snapshot(const std::vector<Bytes>& messages, const Value& display) {
        Bytes records;
        for (const Bytes& message : messages) records += message;
        Bytes log(161);
        log[0] = 161;
        log.insert(log.end(), records.begin() + 1, records.end());
        const Value entry = Dictionary::make({{"DisplayState", records},
                                              {"Display", display},
                                              {"ExtraInfo", Dictionary::make({{"FLDataSeqNum1", 7}, {"IMSI", kImsi}})},
                                              {"Date", "2023-11-04 09:15:02 +0100"},
                                              {"Description", "Snapshot (2023-11-04 09:15:02 +0100)"},
                                              {"Owner", "Annegret"}});
        const Value dlf = Dictionary::make({{"Description", "DLF binary"}, {"DLF", log}});
        const Value all = Dictionary::make({{"Timestamp", "2023-11-04 08:15:02 +0000"},
                                            {"Data", Array::make({entry, dlf})},
                                            {"Description", "Annegret, by the river"},
                                            {kImsi, kOther}});
        return directory.write("in.kelvo", *writeXmlPropertyList(all));
    }
};

}  // namespace kelvo::test
