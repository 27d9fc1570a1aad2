#include "platform/encodings/Base64.h"
#include "tests/support/Secrets.h"
#include "tests/tools/SharedFiles.h"
#include "tests/tools/share/IdentityKeys.h"

namespace kelvo {
namespace {

using namespace test;

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

struct ShareSecrets : SharedFiles {
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
};

TEST_F(ShareSecrets, AreNotInACaptureOfLte) { expectNoSecret(capture(Technology::LTE, lteMessages()), 15); }

TEST_F(ShareSecrets, AreNotInACaptureOfGsm) { expectNoSecret(capture(Technology::GSM, gsmMessages()), 16); }

TEST_F(ShareSecrets, AreNotInACaptureOfUtran) { expectNoSecret(capture(Technology::UTRAN, utranMessages()), 16); }

TEST_F(ShareSecrets, AreNotInACaptureOfCdma) { expectNoSecret(capture(Technology::CDMA, cdmaMessages()), 5); }

TEST_F(ShareSecrets, AreNotInACellMonitorsCapture) { expectNoSecret(capture(Technology::IFX, {cellMonitorTree()}), 5); }

TEST_F(ShareSecrets, AreNotInAStream) { expectNoSecret(frames(lteMessages()), 15); }

TEST_F(ShareSecrets, AreNotInADlfFile) {
    Bytes bytes;
    for (Bytes message : gsmMessages()) {
        for (std::size_t i = 0; i < 6; ++i) message[7 + i] = static_cast<std::uint8_t>(kTicks >> 8 * i);
        bytes += Bytes(message.begin() + 1, message.end());
    }
    expectNoSecret(directory.write("in.dlf", bytes), 16);
}

TEST_F(ShareSecrets, AreNotInASnapshot) {
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

TEST_F(ShareSecrets, AreNotInACdmaSnapshot) {
    const Value display = Dictionary::make(
        {{"2;EV-DO", Dictionary::make({{"_sorted", "_sorted"},
                                       {"11;UATI24", "0xc0ffe5"},
                                       {"04;Fingers", Dictionary::make({{"_sorted", "_sorted"},
                                                                        {"0;123", "-3.01 dB"},
                                                                        {"1;" + kImsi, "-4.00 dB"}})}})}});
    expectNoSecret(snapshot(cdmaMessages(), display), 5);
}

TEST_F(ShareSecrets, AreNotInACellMonitorsSnapshot) {
    const Value tree = *readPropertyList(cellMonitorTree());
    const Value entry = Dictionary::make({{"DisplayState", tree}, {"Display", tree}, {"Date", "by the river"}});
    const Value all = Dictionary::make({{"Timestamp", "2023-11-04 08:15:02 +0000"}, {"Data", Array::make({entry})}});
    expectNoSecret(directory.write("in.kelvo", *writeXmlPropertyList(all)), 6);
}

// The same screens, level by level: what differs are identities.

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
    EXPECT_TRUE(test::namesSomebody(key)) << key << ": " << one << " and " << other;
    return 1;
}

struct SharedFamily : SharedFiles, testing::WithParamInterface<const char*> {};

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

}  // namespace
}  // namespace kelvo
