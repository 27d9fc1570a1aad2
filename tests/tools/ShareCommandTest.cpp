#include <set>

#include "platform/encodings/Base64.h"
#include "platform/encodings/PropertyList.h"
#include "tests/support/CellArray.h"
#include "tests/support/Secrets.h"
#include "tests/support/Subpackets.h"
#include "tests/telephony/recordings/Wire.h"
#include "tests/tools/KelvoctlTest.h"

namespace kelvo {
namespace {

using test::contentsOf;
using test::expectFailure;
using test::Finished;
using test::plainFrame;
using test::Record;
using test::recordBodyOf;
using test::Secret;
using test::operator+=;

const std::string kImsi = "262019876543210";
const std::string kOther = "358240051111110";  // an IMEI, in what Kelvo does not know

// What is planted in every file. Numbers of one or two bytes are too short to be looked for: any byte could be one.
const std::vector<Secret> kSecrets = {
    Secret::digits("ICCID", "8949020198765432109"),
    Secret::digits("telephone number", "491709876543"),
    Secret::digits("mailbox", "491713339876"),
    Secret::digits("IMSI", kImsi),
    Secret::digits("IMEI", kOther),
    Secret::bytes("TMSI", {0x3A, 0x9C, 0x41, 0xD7}),
    Secret::bytes("P-TMSI", {0xC4, 0x1B, 0x7E, 0x02}),
    Secret::bytes("signature", {0xA9, 0x5D, 0x13}),
    Secret::bytes("network", {0x62, 0xF2, 0x19}),
    Secret::number("UATI", 0xC0FFE5, 3),
    Secret::number("LTE cell", 26'385'441, 4),
    Secret::number("UMTS cell", 66'712'345, 4),
    Secret::address("address", {100, 71, 23, 45}),
    Secret::text("address of version 6", "2003:e4:1705:b1a::5"),
    Secret::text("access point", "fabrik.example"),
    Secret::text("network's name", "Nordfunk"),
    Secret::text("name", "Annegret"),
    Secret::text("words", "by the river"),
};

/// The packet with the length that it has.
Bytes whole(const Record& record) {
    Bytes bytes = record.bytes();
    bytes[1] = static_cast<std::uint8_t>(bytes.size() - 1);
    bytes[2] = static_cast<std::uint8_t>((bytes.size() - 1) >> 8);
    return bytes;
}

Record simFiles() {
    return test::payload(
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

Record contexts() {
    return test::payload(0xFF0002, Array::make({Dictionary::make({{"Context ID", "5"},
                                                                  {"APN", "fabrik.example"},
                                                                  {"PDP Type", "IPv4v6"},
                                                                  {"State", "Active"},
                                                                  {"PDP Address", "100.71.23.45, 2003:e4:1705:b1a::5"},
                                                                  {"User", "Annegret"}}),
                                                Dictionary::make({{"PDP Address", Bytes{100, 71, 23, 45}}})}));
}

Record cells(const std::string& technology) {
    return test::cellArray({test::cell(technology, "Serving",
                                       {{"kPLCellMonitorMCC", 262},
                                        {"kPLCellMonitorMNC", 91},
                                        {"kPLCellMonitorCellId", 26'385'441},
                                        {"kPLCellMonitorTAC", 45'663},
                                        {"kPLCellMonitorLAC", 45'663},
                                        {"kPLCellMonitorPID", 301},
                                        {"kPLCellMonitorOwner", kImsi}})});
}

/// Digits in nibbles, the low one first, between the fields that Kelvo knows.
void plant(Record& record, std::size_t at, const std::string& digits) {
    for (std::size_t i = 0; i < digits.size(); i += 2) {
        const int high = i + 1 < digits.size() ? digits[i + 1] - '0' : 15;
        record.u8(at++, static_cast<std::uint32_t>(high << 4 | (digits[i] - '0')));
    }
}

/// A record of a code that Kelvo does not know.
Bytes unknown() { return whole(Record(0xB195, 13).text(13, "IMSI " + kImsi + ", Annegret, by the river")); }

std::vector<Bytes> lteMessages() {
    Record serving(0xB0C2, 38);
    serving.u8(13, 2).u16(14, 301).u16(16, 1300).u16(18, 19'300).u8(20, 50).u8(21, 25).u32(22, 26'385'441);
    serving.u16(26, 45'663).u32(28, 3).u16(32, 262).u8(34, 2).u16(35, 91);
    Record idle(0xB17F, 33);
    idle.u8(13, 2).u16(17, 1300).u16(19, 301).u32(21, 0x4A95A52F).u32(25, 0x0BB0C0D0).u32(29, 0x0A0B0C0D);
    return {serving.bytes(), whole(simFiles()), unknown(), whole(cells("LTE")), whole(contexts()), idle.bytes()};
}

std::vector<Bytes> gsmMessages() {
    Record network(0x7135, 40);
    network.u8(14, 3).u8(15, 0x62).u8(16, 0xF2).u8(17, 0x19).u8(18, 0xB2).u8(19, 0x5F).u8(20, 17);
    plant(network, 22, kImsi);
    Record cell(0x4127, 29);
    cell.u32(13, 9613).u32(17, 10'563).u32(21, 66'712'345).u16(25, 4711);
    return {network.bytes(), whole(simFiles()), whole(cells("UMTS")), whole(contexts()), cell.bytes(), unknown()};
}

std::vector<Bytes> utranMessages() {
    Record cell(0xD0E2, 40);
    cell.u8(14, 1).u8(15, 9).u16(17, 9613).u16(19, 10'054).u32(21, 66'712'345).u8(25, 1);
    plant(cell, 27, kImsi);
    return {cell.bytes(), whole(simFiles()), whole(cells("UTRAN2")), whole(contexts()), unknown()};
}

std::vector<Bytes> cdmaMessages() {
    Record status(0x1183, 50);
    status.u16(13, 0x0921).u8(15, 0xB0).u16(18, 123).u8(36, 5).u8(37, 4).u16(38, 0xFFE5).u8(40, 0xC0).u8(41, 77);
    plant(status, 22, kOther);
    Record system(0x134F, 200);
    system.u8(13, 2).u32(42, 0).u32(46, 2).u16(50, 4711).u16(52, 77).u8(131, 3).u16(184, 777).u8(133, 6);
    plant(system, 60, kImsi);
    test::Subpackets oneX(0x119C);
    oneX.add(1, 16).u8(4, 8).add(2, 16).add(3, 12).add(4, 16);
    Record oneXStatus = oneX;
    plant(oneXStatus, 17 + 8, kImsi);
    return {status.bytes(), system.bytes(), oneXStatus.bytes(), unknown()};
}

Bytes cellMonitorTree() {
    const Value cell = Dictionary::make({{"MCC", "262"},
                                         {"MNC", "91"},
                                         {"CellId", "26385441"},
                                         {"IMSI", kImsi},
                                         {"TMSI", "3A9C41D7"},
                                         {"RSSI", "-71 dBm"},
                                         {"Annegret", kOther}});
    return *writeXmlPropertyList(Dictionary::make({{"Serving", Dictionary::make({{"Cell", cell}})}}));
}

/// A file's content, and behind it what its data stand for, and what that holds in its turn.
std::string unfolded(const std::string& content) {
    std::string all = content;
    for (std::size_t at = all.find("<data>"); at != all.npos; at = all.find("<data>", at + 1)) {
        const std::string text = all.substr(at + 6, all.find("</data>", at) - at - 6);
        const auto bytes = bytesFromBase64(text);
        if (bytes) all.append(bytes->begin(), bytes->end());
    }
    return all;
}

struct ShareCommand : test::KelvoctlTest {
    ShareCommand() { directory.write("key", bytesOf("a key of a test, long enough")); }

    std::string out() { return path("out"); }
    Finished share(const std::string& in, std::vector<std::string> more = {}) {
        more.insert(more.begin(), {"share", in, "-o", out(), "--force", "--hide-apns", "--key", path("key")});
        return kelvoctl(more);
    }
    /// Shares a file in which some of the secrets stand, and looks for each in the copy and in what is printed.
    void expectNoSecret(const std::string& in, std::size_t planted) {
        const std::string before = unfolded(contentsOf(in));
        const Finished done = share(in);
        EXPECT_EQ(done.status, 0) << done.errors;
        const std::string after = unfolded(contentsOf(out())) + done.output + done.errors;
        std::size_t found = 0;
        std::string missing;
        for (const Secret& secret : kSecrets) {
            const bool isThere = !secret.foundIn(before).empty();
            found += isThere ? 1 : 0;
            missing += isThere ? "" : secret.name() + "; ";
            EXPECT_EQ(secret.foundIn(after), "") << secret.name();
        }
        EXPECT_EQ(found, planted) << "not there: " << missing;
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

TEST_F(ShareCommand, LeavesNoSecretInACaptureOfLte) { expectNoSecret(capture(Technology::LTE, lteMessages()), 15); }

TEST_F(ShareCommand, LeavesNoSecretInACaptureOfGsm) { expectNoSecret(capture(Technology::GSM, gsmMessages()), 16); }

TEST_F(ShareCommand, LeavesNoSecretInACaptureOfUtran) {
    expectNoSecret(capture(Technology::UTRAN, utranMessages()), 16);
}

TEST_F(ShareCommand, LeavesNoSecretInACaptureOfCdma) { expectNoSecret(capture(Technology::CDMA, cdmaMessages()), 5); }

TEST_F(ShareCommand, LeavesNoSecretInACellMonitorsCapture) {
    expectNoSecret(capture(Technology::IFX, {cellMonitorTree()}), 5);
}

TEST_F(ShareCommand, LeavesNoSecretInAStream) { expectNoSecret(frames(lteMessages()), 15); }

TEST_F(ShareCommand, LeavesNoSecretInADlfFile) {
    Bytes bytes;
    for (Bytes message : gsmMessages()) {
        for (std::size_t i = 0; i < 6; ++i) message[7 + i] = static_cast<std::uint8_t>(test::kTicks >> 8 * i);
        bytes += Bytes(message.begin() + 1, message.end());
    }
    expectNoSecret(directory.write("in.dlf", bytes), 16);
}

TEST_F(ShareCommand, LeavesNoSecretInASnapshot) {
    const Value display = Dictionary::make(
        {{"Serving Cell Info", Dictionary::make({{"Physical Cell ID", "301"},
                                                 {"Cell Identity", "26385441"},
                                                 {"Download Frequency", "1300"},
                                                 {"Owner", kImsi}})},
         {"SIM Info", Dictionary::make({{"EF-ICCID", "8949020198765432109"}, {"EF-LOCI", "3A9C41D762F2191234FF00"}})},
         {"PDP Context Info", Array::make({Dictionary::make({{"PDP Address", "100.71.23.45"}})})},
         {kImsi, Dictionary::make({{"State", "home"}})},
         {"RRC State", "IMSI " + kImsi}});
    expectNoSecret(snapshot(lteMessages(), display), 16);
}

TEST_F(ShareCommand, LeavesNoSecretInACdmaSnapshot) {
    const Value display = Dictionary::make(
        {{"2;EV-DO", Dictionary::make({{"_sorted", "_sorted"},
                                       {"11;UATI24", "0xc0ffe5"},
                                       {"04;Fingers", Dictionary::make({{"_sorted", "_sorted"},
                                                                        {"0;123", "-3.01 dB"},
                                                                        {"1;" + kImsi, "-4.00 dB"}})}})}});
    expectNoSecret(snapshot(cdmaMessages(), display), 5);
}

TEST_F(ShareCommand, LeavesNoSecretInACellMonitorsSnapshot) {
    const Value tree = *readPropertyList(cellMonitorTree());
    const Value entry = Dictionary::make({{"DisplayState", tree}, {"Display", tree}, {"Date", "by the river"}});
    const Value all = Dictionary::make({{"Timestamp", "2023-11-04 08:15:02 +0000"}, {"Data", Array::make({entry})}});
    expectNoSecret(directory.write("in.kelvo", *writeXmlPropertyList(all)), 6);
}

// The same screens, level by level: what differs are identities.

const std::set<std::string> kIdentities = {"Physical Cell ID",
                                           "Serving Physical Cell ID",
                                           "Serving Cell ID",
                                           "Cell ID",
                                           "Cell Identity",
                                           "Tracking Area Code",
                                           "PSC",
                                           "BSIC ID",
                                           "Pilot",
                                           "Mobile Country Code",
                                           "Mobile Network Code",
                                           "Location Area Code",
                                           "Routing Area Code",
                                           "URA ID",
                                           "Scrambling Code",
                                           "BSIC",
                                           "Local Area Code",
                                           "Cell Scrambling Code",
                                           "Serving PN Offset",
                                           "UATI24",
                                           "Color Code",
                                           "System ID",
                                           "Network ID",
                                           "Base Station ID",
                                           "Packet Zone ID",
                                           "PDP Address",
                                           "MCC",
                                           "MNC",
                                           "LAC",
                                           "CellId",
                                           "SCN",
                                           "RAC"};
const std::set<std::string> kFiles = {"EF-ICCID",
                                      "EF-MSISDN",
                                      "EF-LOCI",
                                      "EF-3GPP MAIL BOX DIALING NUMBER",
                                      "EF-GPRS/PS-LOCI",
                                      "EF-ACCESS CONTROL CLASS",
                                      "EF-FPLMN",
                                      "EF-ACTING HPLMN",
                                      "EF-PLMN NETWORK NAME",
                                      "EF-OPERATOR PLMN LIST",
                                      "EF-OPLMNAcT"};

using Json = nlohmann::ordered_json;

/// How many values differ that may; everything else must be the same.
int differences(const Json& one, const Json& other, const std::string& key) {
    EXPECT_EQ(one.type(), other.type()) << key;
    EXPECT_EQ(one.size(), other.size()) << key;
    if (one.type() != other.type() || one.size() != other.size()) return 0;
    int all = 0;
    if (one.is_structured()) {
        auto next = other.begin();
        for (auto entry = one.begin(); entry != one.end(); ++entry, ++next) {
            if (one.is_array()) {
                all += differences(*entry, *next, key);
                continue;
            }
            const std::string name = entry.key().substr(entry.key().find(';') + 1);
            const bool isPilot = entry.key() != next.key() && (key == "Active Set" || key == "Fingers");
            if (isPilot) {
                EXPECT_EQ(entry.key().substr(0, entry.key().find(';')), next.key().substr(0, next.key().find(';')));
            } else {
                EXPECT_EQ(entry.key(), next.key());
            }
            all += (isPilot ? 1 : 0) + differences(*entry, *next, isPilot ? key : name);
        }
        return all;
    }
    if (one == other) return 0;
    EXPECT_TRUE(kIdentities.contains(key) || kFiles.contains(key)) << key << ": " << one << " and " << other;
    return 1;
}

struct SharedFamily : ShareCommand, testing::WithParamInterface<const char*> {};

TEST_P(SharedFamily, ShowsTheSameScreens) {
    const std::string in = std::string(KELVO_CAPTURES) + "/" + GetParam() + ".pcap";
    const Finished done = kelvoctl({"share", in, "-o", out(), "--key", path("key")});
    EXPECT_EQ(done.status, 0) << done.errors;
    EXPECT_NE(done.output.find("Removed: nothing\n"), std::string::npos) << done.output;
    const Json before = json({"decode", "--json", in});
    const Json after = json({"decode", "--json", out()});
    EXPECT_EQ(before["messages"], after["messages"]);
    EXPECT_GT(differences(before["display"], after["display"], {}), 4);
}

INSTANTIATE_TEST_SUITE_P(Of, SharedFamily, testing::Values("lte", "gsm", "cdma", "utran", "ifx"),
                         [](const auto& parameter) { return std::string(parameter.param); });

TEST_F(ShareCommand, MakesAStreamThatImportsAsTheOriginalDoes) {
    const std::string in = frames(lteMessages());
    share(in);
    const Finished before = kelvoctl({"import", in, "-o", path("before.pcap")});
    const Finished after = kelvoctl({"import", out(), "-o", path("after.pcap")});
    EXPECT_EQ(before.status, 0) << before.errors;
    EXPECT_EQ(after.status, 0) << after.errors;
    const Json one = json({"decode", "--json", path("before.pcap")});
    const Json other = json({"decode", "--json", path("after.pcap")});
    EXPECT_EQ(one["display"]["Serving Cell Info"]["Download Frequency"], "1300");
    EXPECT_EQ(one["display"]["Serving Cell Measurements"], [&] {
        Json shared = other["display"]["Serving Cell Measurements"];
        EXPECT_NE(shared["Physical Cell ID"], "301");
        shared["Physical Cell ID"] = "301";
        return shared;
    }());
}

TEST_F(ShareCommand, KeepsTheSubscriptionOfAFrame) {
    const Bytes message = lteMessages().front();
    Bytes body = {0x98, 1, 0, 0, 2, 0, 0, 0};
    body += recordBodyOf(Bytes(message.begin() + 1, message.end()));
    share(directory.write("in.frames", plainFrame(body)));
    EXPECT_EQ(kelvoctl({"import", out(), "-o", path("a.pcap"), "--subscription", "2"}).status, 0);
    EXPECT_EQ(kelvoctl({"import", out(), "-o", path("b.pcap"), "--subscription", "1"}).status, 1);
}

TEST_F(ShareCommand, MakesASnapshotWhoseScreensAndRecordsAgree) {
    const Value display = Dictionary::make(
        {{"Serving Cell Info", Dictionary::make({{"Cell Identity", "26385441"}, {"UARFCN", "1300"}})}});
    share(snapshot({lteMessages().front()}, display));
    const Json shown = json({"snapshot", out(), "--entry", "1", "--json"});
    EXPECT_EQ(kelvoctl({"snapshot", out(), "--capture", path("c.pcap"), "--technology", "lte"}).status, 0);
    const Json decoded = json({"decode", "--json", path("c.pcap")});
    EXPECT_EQ(shown["Serving Cell Info"]["Cell Identity"], decoded["display"]["Serving Cell Info"]["Cell Identity"]);
    EXPECT_NE(shown["Serving Cell Info"]["Cell Identity"], "26385441");
    EXPECT_EQ(shown["Serving Cell Info"]["UARFCN"], "1300");
    EXPECT_EQ(kelvoctl({"snapshot", out(), "--dlf", path("d.dlf")}).output,
              "198 bytes written to " + path("d.dlf") + "\n");  // 161 and a record of 37
    EXPECT_EQ(kelvoctl({"import", path("d.dlf"), "-o", path("d.pcap")}).status, 0);
    EXPECT_EQ(json({"decode", "--json", path("d.pcap")})["display"], decoded["display"]);
}

TEST_F(ShareCommand, ShowsACellMonitorsSnapshotAsItsTreeIs) {
    const Value tree = *readPropertyList(cellMonitorTree());
    const Value entry = Dictionary::make({{"DisplayState", tree}, {"Display", Dictionary::make({{"Serving", "x"}})}});
    const Value all = Dictionary::make({{"Data", Array::make({entry})}});
    share(directory.write("in.kelvo", *writeXmlPropertyList(all)));
    const Json shown = json({"snapshot", out(), "--entry", "1", "--json"});
    EXPECT_EQ(shown["Serving"]["RSSI"], "-71 dBm");
    EXPECT_EQ(shown["Serving"].size(), 7U);
}

TEST_F(ShareCommand, GivesEveryCopyItsOwnPseudonyms) {
    const std::string in = capture(Technology::LTE, lteMessages());
    EXPECT_EQ(kelvoctl({"share", in, "-o", path("a")}).status, 0);
    EXPECT_EQ(kelvoctl({"share", in, "-o", path("b")}).status, 0);
    EXPECT_NE(contentsOf(path("a")), contentsOf(path("b")));
    share(in);
    const std::string once = contentsOf(out());
    share(in);
    EXPECT_EQ(contentsOf(out()), once);
}

TEST_F(ShareCommand, TellsWhatItReplacedRemovedAndKept) {
    const Finished done = share(frames(lteMessages()), {"--shift-times"});
    EXPECT_EQ(done.errors, "");
    EXPECT_EQ(done.output, "2 of 6 records written to " + out() + R"(
Replaced:
        1  Cell Identity (cell)
        1  Mobile Country Code (country)
        1  Mobile Network Code (network)
        2  Physical Cell ID (cell's code)
        1  Tracking Area Code (area)
Removed:
        1  damaged frame
        4  record of a code that Kelvo does not know
        1  text of the modem
Kept: levels, states, channels
)");
}

TEST_F(ShareCommand, TellsWhatItReplacedAndRemovedOfThePhonesRecords) {
    EXPECT_EQ(share(capture(Technology::GSM, {simFiles().bytes(), contexts().bytes()})).output,
              "2 of 2 records written to " + out() + R"(
Replaced:
        1  APN (access point)
        1  EF-3GPP MAIL BOX DIALING NUMBER (telephone number)
        1  EF-ACTING HPLMN (networks)
        1  EF-FPLMN (networks)
        1  EF-GPRS/PS-LOCI (temporary identity and area)
        1  EF-ICCID (SIM number)
        1  EF-LOCI (temporary identity and area)
        1  EF-MSISDN (telephone number)
        1  EF-OPERATOR PLMN LIST (networks and areas)
        1  EF-OPLMNAcT (networks)
        1  EF-PLMN NETWORK NAME (network's name)
        2  PDP Address (address)
Removed:
        2  entry of a phone's record under a name that Kelvo does not know
        1  value in a form that Kelvo does not know
Kept: levels, states, channels, times (--shift-times)
)");
}

TEST_F(ShareCommand, KeepsCellsOnRequest) {
    const Finished done = share(capture(Technology::LTE, lteMessages()), {"--keep-cells"});
    const Json shown = json({"decode", "--json", out()})["display"]["Serving Cell Info"];
    EXPECT_EQ(shown["Cell Identity"], "26385441");
    EXPECT_EQ(shown["Tracking Area Code"], "45663");
    EXPECT_NE(done.output.find("Kept: levels, states, channels, cells, areas and networks, times (--shift-times)\n"),
              std::string::npos)
        << done.output;
    EXPECT_EQ(share(path("in.pcap"), {"--keep-cells", "--hide-cells"}).status, 1);
}

TEST_F(ShareCommand, ShiftsTimesOnRequestAndKeepsTheirIntervals) {
    auto times = [&](const std::string& file) {
        std::vector<std::int64_t> seconds;
        auto reader = CaptureReader::open(file);
        for (auto packet = reader->next(); packet && *packet; packet = reader->next()) {
            seconds.push_back(std::chrono::floor<std::chrono::seconds>((*packet)->time).time_since_epoch().count());
        }
        return seconds;
    };
    share(capture(Technology::CDMA, cdmaMessages()));
    EXPECT_EQ(times(out()), (std::vector<std::int64_t>{0, 1, 2}));
    share(path("in.pcap"), {"--shift-times"});
    EXPECT_EQ(times(out()), (std::vector<std::int64_t>{1'577'836'800, 1'577'836'801, 1'577'836'802}));
}

TEST_F(ShareCommand, ShiftsTheTimesOfASnapshotAndHidesItsZone) {
    share(snapshot({lteMessages().front()}, Dictionary::make({})), {"--shift-times"});
    const std::string listed = kelvoctl({"snapshot", out()}).output;
    EXPECT_NE(listed.find("Timestamp    2020-01-01 00:00:00 +0000"), std::string::npos) << listed;
    EXPECT_NE(listed.find("Snapshot (2020-01-01 00:00:00 +0000)"), std::string::npos) << listed;
}

TEST_F(ShareCommand, HidesTheZoneOfASnapshotWithItsCells) {
    const std::string in = snapshot({lteMessages().front()}, Dictionary::make({}));
    share(in);
    EXPECT_NE(kelvoctl({"snapshot", out()}).output.find("Snapshot (2023-11-04 08:15:02 +0000)"), std::string::npos);
    share(in, {"--keep-cells"});
    EXPECT_NE(kelvoctl({"snapshot", out()}).output.find("Snapshot (2023-11-04 09:15:02 +0100)"), std::string::npos);
}

TEST_F(ShareCommand, CopiesWhatIsGoodAndTellsWhereItStopped) {
    const std::string in = capture(Technology::LTE, lteMessages());
    const std::string whole = contentsOf(in);
    directory.write("cut.pcap", bytesOf(whole.substr(0, whole.size() - 5)));
    const Finished done = share(path("cut.pcap"));
    EXPECT_EQ(done.status, 1);
    EXPECT_TRUE(done.output.starts_with("4 of 5 records written to ")) << done.output;
    EXPECT_TRUE(done.errors.starts_with("kelvoctl: " + path("cut.pcap"))) << done.errors;
    EXPECT_EQ(std::count(done.errors.begin(), done.errors.end(), '\n'), 1);
    EXPECT_EQ(json({"decode", "--json", out()})["messages"], 4);
}

TEST_F(ShareCommand, ReplacesNoFileUnlessForcedAndNeverTheOneBeingRead) {
    const std::string in = capture(Technology::LTE, lteMessages());
    const std::string before = contentsOf(in);
    directory.write("there", bytesOf("mine"));
    EXPECT_EQ(kelvoctl({"share", in, "-o", path("there")}).status, 1);
    EXPECT_EQ(contentsOf(path("there")), "mine");
    EXPECT_EQ(kelvoctl({"share", in, "-o", in, "--force"}).status, 1);
    EXPECT_EQ(contentsOf(in), before);
    EXPECT_EQ(kelvoctl({"share", in, "-o", path("key"), "--key", path("key"), "--force"}).status, 1);
    EXPECT_EQ(contentsOf(path("key")), "a key of a test, long enough");
}

TEST_F(ShareCommand, SaysWhatItCannotShare) {
    directory.write("noise", bytesOf("no recording at all"));
    directory.write("list", bytesOf("{ Timestamp = \"2023-11-04 08:15:02 +0000\"; }"));
    EXPECT_EQ(share(path("list")).status, 0);
    EXPECT_EQ(share(path("list")).output.substr(0, 20), "0 of 0 records writt");
    std::filesystem::remove(out());
    expectFailure(share(path("noise")), path("noise") + " holds no diagnostic records");
    const std::string nothing = capture(Technology::LTE, {unknown()});
    expectFailure(share(nothing), nothing + " holds nothing that can be shared");
    EXPECT_FALSE(std::filesystem::exists(out()));
    directory.write("short", bytesOf("15 characters.."));
    expectFailure(kelvoctl({"share", nothing, "-o", out(), "--key", path("short")}),
                  path("short") + " is too short for a key: 16 bytes are the least");
    EXPECT_EQ(kelvoctl({"share", nothing}).status, 1);
}

}  // namespace
}  // namespace kelvo
