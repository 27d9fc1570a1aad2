// Shared records fill the screens as the originals do: random ones of every code, both through the family's decoder.
#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <random>

#include "LogGenerator/Factory.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "telephony/adaptation/RecordAdapter.h"
#include "tests/support/CellArray.h"
#include "tests/support/Record.h"
#include "tests/support/Subpackets.h"
#include "tests/tools/share/IdentityKeys.h"
#include "tools/share/RecordSharer.h"

namespace kelvo {
namespace {

using test::Record;

class Random {
public:
    std::uint8_t byte() { return static_cast<std::uint8_t>(_engine()); }
    std::uint32_t below(std::uint32_t end) { return static_cast<std::uint32_t>(_engine() % end); }
    /// A packet of noise behind its header.
    Record record(LogCode code, std::size_t size) {
        Record record(code, size);
        for (std::size_t at = 5; at < size; ++at) record.u8(at, byte());
        return record;
    }

private:
    std::mt19937 _engine{20};
};

/// One of random content in a layout that passes, with lists of up to six entries.
Bytes made(Random& random, LogCode code) {
    const std::uint32_t n = random.below(7);
    const auto of = [&](std::size_t size) { return random.record(code, size); };
    switch (code) {
        case 0xB0C1: return of(22).u8(13, 1).bytes();
        case 0xB0C2: return of(38).u8(13, 2).bytes();
        case 0xB179: return of(29 + 6 * n + 2 * 3).u8(13, 2).u8(27, n).u8(28, 3).bytes();
        case 0xB17F: return of(33).u8(13, 2).u8(14, 0).bytes();
        case 0xB180: return of(21 + 20 * (n + 1)).u8(13, 2).u16(19, n << 6 | random.below(64)).bytes();
        case 0xB186: {
            Record record = of(21 + 4 * n + 8).u8(19, n);
            for (std::uint32_t i = 0; i < n; i += 3) record.u16(23 + 4 * i, random.below(6));
            return record.bytes();
        }
        case 0x4005:
            return n % 2 == 0 ? of(15 + 10 * n).u8(13, n).u8(14, 0).bytes()
                              : of(15 + 7 * n).u8(13, 0).u8(14, n).bytes();
        case 0x4031: return of(16 + 14 * n).u8(14, n).bytes();
        case 0x4116: return of(16 + 9 * n).u8(13, n).bytes();
        case 0x4127: return of(29).bytes();
        case 0x417A: return of(16 + 59 * n).u8(15, n).bytes();
        case 0x4221: return of(18 + 171 * n).u8(16, n).u8(17, n).bytes();
        case 0x5137: return of(29 + 14 * n).u8(28, n).bytes();
        case 0x51F8: return of(15 + 2 * n).u8(14, n).bytes();
        case 0x51FF: return of(15 + 4 * n).u8(14, n).bytes();
        case 0x7150: {
            Record record = of(n == 0 ? 17 : 20 + 3 * n).u8(13, 0).u8(14, 0).u8(15, 0).u8(16, n);
            for (std::size_t at = 17; at < record.bytes().size(); ++at) record.u8(at, random.below(10));
            return record.bytes();
        }
        case 0x108A: return of(23 + 14 * n).u8(22, n).bytes();
        case 0x1183: return of(50).bytes();
        case 0x12B6: return of(25 + 12 * n).u8(15, n).bytes();
        case 0x134F: return of(200).u8(13, 2).u32(46, 1 + n % 2).bytes();
        case 0xD00A: return of(168 + 16 * n).u8(16, n << 1 | 1).bytes();
        case 0xD00C: return of(289 + 34 * n + 8 * 2).u16(14, n << 6 | 2 << 12).bytes();
        case 0xD00E: return of(17 + 8 * n).u8(16, n).bytes();
        case 0x127E: return of(1750).bytes();
        case 0x1192: return of(241).bytes();
        default: return of(40).bytes();
    }
}

Bytes oneXStatus(Random& random) {
    test::Subpackets packet(0x119C);
    const std::uint32_t pilots = random.below(4);
    const std::uint32_t extras = 1 + random.below(2);  // without, a pilot's level lies where the next one's offset does
    const std::uint32_t size = 12 + pilots * ((6 * extras + 15) / 4 * 4);
    packet.add(1, 6).u8(4, random.below(13)).add(2, 16);
    for (std::size_t at = 4; at < 16; ++at) packet.u8(at, random.byte());
    packet.add(3, size);
    for (std::size_t at = 4; at < size; ++at) packet.u8(at, random.byte());
    packet.u8(8, pilots).u8(9, extras);
    if (pilots > 0) packet.u16(12, 300).u16(10, 300);  // the reference pilot
    packet.add(4, 8).u16(4, 0x4142);
    return packet.bytes();
}

class Screens : public testing::Test {
protected:
    void start(Technology technology) {
        generator = generatorFromTechnology(namesOf(technology).identifier);
        other = generatorFromTechnology(namesOf(technology).identifier);
        family = technology;
    }

    /// Shows the original and the shared record; false when it is left out.
    bool show(const Bytes& message) {
        const auto shared = sharer.share(message, family);
        if (!shared) return false;
        adaptation::Adapted adapted;
        adapted.packet = message;
        if (hasCodes(family)) adapted = adapter->adapt(message);
        generator->updateState(*state, adapted.packet);
        const Bytes bytes(shared->begin(), shared->end());
        other->updateState(*otherState, bytes);
        compare((*state)["Display"], (*otherState)["Display"], "");
        return true;
    }

    void compare(const Value& original, const Value& shared, const std::string& path) {
        ASSERT_EQ(original.kind(), shared.kind()) << path;
        if (original.array()) {
            ASSERT_EQ(original.array()->size(), shared.array()->size()) << path;
            for (std::size_t i = 0; i < original.array()->size(); ++i) {
                compare((*original.array())[i], (*shared.array())[i], path);
            }
        } else if (original.dictionary()) {
            ASSERT_EQ(original.dictionary()->size(), shared.dictionary()->size()) << path;
            auto next = shared.dictionary()->begin();
            for (const auto& [key, value] : *original.dictionary()) {
                // Pilots are listed under "position;offset".
                const bool isList = path.ends_with("Active Set") || path.ends_with("Fingers");
                const bool isPilot = family == Technology::CDMA && isList;
                const auto shown = [&](const std::string& text) {
                    return isPilot && text != "_sorted" ? text.substr(0, text.find(';')) : text;
                };
                EXPECT_EQ(shown(key), shown(next->key)) << path;
                if (isPilot && key != next->key) ++replaced;
                compare(value, next->value, isPilot ? path : path + "/" + key);
                ++next;
            }
        } else {
            compareTexts(*original.string(), *shared.string(), path.substr(path.find_last_of("/;") + 1), path);
        }
    }

    void compareTexts(const std::string& original, const std::string& shared, const std::string& key,
                      const std::string& path) {
        if (!test::namesSomebody(key)) {
            EXPECT_EQ(original, shared) << path;
        } else {
            EXPECT_EQ(original.size(), shared.size()) << path << ": " << original << " and " << shared;
            if (original != shared) ++replaced;
        }
    }

    DirectoryResources resources{KELVO_RESOURCE_DIR};
    Environment::Scope environment{{.resources = &resources}};
    RecordSharer sharer{{}, Pseudonyms::secretOf("a test")};
    std::unique_ptr<adaptation::RecordAdapter> adapter = std::make_unique<adaptation::RecordAdapter>();
    Technology family{};
    std::unique_ptr<LogGenerator> generator;
    std::unique_ptr<LogGenerator> other;
    DictionaryRef state = Dictionary::make();
    DictionaryRef otherState = Dictionary::make();
    Random random;
    int replaced = 0;
};

TEST_F(Screens, OfLteShowTheSameOfSharedRecords) {
    start(Technology::LTE);
    for (int i = 0; i < 40; ++i) {
        for (const LogCode code : {0xB0C1, 0xB0C2, 0xB179, 0xB17F, 0xB180, 0xB186}) {
            EXPECT_TRUE(show(made(random, code))) << std::hex << code;
        }
    }
    EXPECT_GT(replaced, 1000);
}

TEST_F(Screens, OfGsmAndUmtsShowTheSameOfSharedRecords) {
    start(Technology::GSM);
    for (int i = 0; i < 30; ++i) {
        for (const LogCode code :
             {0x4005, 0x4031, 0x4116, 0x4125, 0x4127, 0x4157, 0x417A, 0x4221, 0x5072, 0x5076, 0x512C, 0x5134,
              0x5137, 0x51F4, 0x51F5, 0x51F6, 0x51F8, 0x51FB, 0x51FD, 0x51FF, 0x7130, 0x7131, 0x7132, 0x7135}) {
            EXPECT_TRUE(show(made(random, code))) << std::hex << code;
        }
    }
    EXPECT_GT(replaced, 500);
}

TEST_F(Screens, OfUtranShowTheSameOfSharedRecords) {
    start(Technology::UTRAN);
    for (int i = 0; i < 40; ++i) {
        for (const LogCode code : {0xD00A, 0xD00C, 0xD00E, 0xD0E0, 0xD0E2}) {
            EXPECT_TRUE(show(made(random, code))) << std::hex << code;
        }
    }
    EXPECT_GT(replaced, 100);
}

TEST_F(Screens, OfCdmaShowTheSameOfSharedRecords) {
    start(Technology::CDMA);
    for (int i = 0; i < 40; ++i) {
        for (const LogCode code : {0x108A, 0x1183, 0x1192, 0x127E, 0x12B6, 0x134F}) {
            EXPECT_TRUE(show(made(random, code))) << std::hex << code;
        }
        EXPECT_TRUE(show(oneXStatus(random)));
        EXPECT_TRUE(show(test::Subpackets(0x119D).add(11, 25).u8(24, random.below(2)).bytes()));
    }
    EXPECT_GT(replaced, 500);
}

TEST_F(Screens, ShowWhatPhonesTellAsTheyDidBefore) {
    for (const Technology technology : {Technology::LTE, Technology::GSM, Technology::UTRAN}) {
        start(technology);
        state = Dictionary::make();
        otherState = Dictionary::make();
        const char* const radio = technology == Technology::LTE   ? "LTE"
                                  : technology == Technology::GSM ? "GSM"
                                                                  : "UTRAN2";
        EXPECT_TRUE(show(test::payload(0xFF0000, Dictionary::make({{"kSimFile_ICCID", "8900101000000123456"},
                                                                   {"kSimFile_HPPLMN", "05"},
                                                                   {"kSimFile_LOCI", "3A9C41D762F2101234FF00"}}))
                             .bytes()));
        EXPECT_TRUE(show(
            test::cellArray({test::cell(radio, "Serving",
                                        {{"kPLCellMonitorCellId", 44'041'665},
                                         {"kPLCellMonitorTAC", 4566},
                                         {"kPLCellMonitorLAC", 4566},
                                         {"kPLCellMonitorMCC", 262},
                                         {"kPLCellMonitorMNC", 1},
                                         {"kPLCellMonitorPID", 301},
                                         {"kPLCellMonitorSCN", 301},
                                         {"kPLCellMonitorARFCN", 62},
                                         {"kPLCellMonitorUARFCN", 10'562},
                                         {"kPLCellMonitorBandInfo", 3}}),
                             test::cell(radio, "Neighbor", {{"kPLCellMonitorARFCN", 70}, {"kPLCellMonitorRSSI", -50}})})
                .bytes()));
        EXPECT_TRUE(show(test::payload(0xFF0002, Array::make({Dictionary::make({{"Context ID", "5"},
                                                                                {"APN", "internet"},
                                                                                {"PDP Type", "IPv4"},
                                                                                {"State", "Active"},
                                                                                {"Quality of Service", "QCI 9"}})}))
                             .bytes()));
    }
    EXPECT_GT(replaced, 9);
}

}  // namespace
}  // namespace kelvo
