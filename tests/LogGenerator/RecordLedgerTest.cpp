#include "LogGenerator/RecordLedger.h"

#include <gtest/gtest.h>

#include "LogGenerator/Factory.h"
#include "platform/encodings/PropertyList.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"
#include "tests/support/CellArray.h"
#include "tests/support/Record.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using test::Record;

/// The record with a time of its own, `seconds` after 1980-01-06: 800 ticks of 1.25 ms a second, from bit 16 on.
Bytes at(std::uint32_t seconds, Record record) { return record.u16(5, 0).u32(7, 800 * seconds).bytes(); }

/// A generator whose records are counted, as the model and the command line do.
struct Counted : testing::Test {
    void start(std::string_view technology) { generator = generatorFromTechnology(technology); }
    void feed(const Bytes& message, RecordLedger::Arrival arrival = 0s) {
        const ByteView packet = generator->takesPackets() ? RecordLedger::packetOf(message) : ByteView();
        const RecordLedger::Counted counted(records, packet, arrival);
        generator->updateState(state, message);
    }
    void feed(const Record& record, RecordLedger::Arrival arrival = 0s) { feed(record.bytes(), arrival); }
    /// The value under these keys; numbers lead into lists.
    const Value& shown(std::initializer_list<std::string_view> keys) {
        const Value* value = &state["Display"];
        for (const std::string_view key : keys) {
            value = value->array() ? &(*value->array())[static_cast<std::size_t>(key[0] - '0')]
                                   : &(*value->dictionary())[key];
        }
        return *value;
    }
    std::uint64_t recordOf(std::initializer_list<std::string_view> keys) { return shown(keys).record(); }
    Place placeOf(std::initializer_list<std::string_view> keys) { return shown(keys).reading()->place; }
    RecordLedger::StreamTime ageOf(std::uint64_t number, RecordLedger::Arrival now) {
        return records.streamTime(now) - records.find(number)->stream;
    }

    DirectoryResources resources{KELVO_RESOURCE_DIR};
    Environment::Scope environment{{.resources = &resources}};
    std::unique_ptr<LogGenerator> generator;
    Dictionary state;
    RecordLedger records;
};

TEST_F(Counted, EveryMessageHasANumberAndWhatItShowsBearsIt) {
    start(kPLLogChannelTechnology_Oskra_LTE);
    feed(Record(0xB0C2, 38).u16(14, 7));
    feed(Bytes{1, 2, 3});      // no packet, and counted all the same
    feed(Record(0x1234, 20));  // nobody shows it
    feed(Record(0xB17F, 33));
    EXPECT_EQ(records.count(), 4U);
    EXPECT_EQ(recordOf({"Serving Cell Info", "Physical Cell ID"}), 1U);
    EXPECT_EQ(recordOf({"Serving Cell Info", "Freq Band Indicator"}), 1U);
    EXPECT_EQ(recordOf({"Serving Cell Measurements", "Physical Cell ID"}), 4U);
    EXPECT_EQ(recordOf({"Serving Cell Measurements", "P_Max"}), 4U);
    EXPECT_EQ(recordOf({"Serving Cell Info", "Num Tx Antennas"}), 0U);  // still as the template has it
    EXPECT_EQ(records.find(1)->code, 0xB0C2U);
    EXPECT_EQ(records.find(2)->code, 0U);
    EXPECT_EQ(records.find(4)->code, 0xB17FU);
    EXPECT_EQ(records.find(5), nullptr);
}

TEST_F(Counted, AValueThatIsNotWrittenAgainKeepsItsNumber) {
    start(kPLLogChannelTechnology_Oskra_LTE);
    feed(Record(0xB0C2, 38).u16(14, 7));
    feed(Record(0xB0C2, 37).u16(14, 8));  // too short
    EXPECT_EQ(recordOf({"Serving Cell Info", "Physical Cell ID"}), 1U);
    feed(Record(0xB0C2, 38).u16(14, 7));  // the same value, written again
    EXPECT_EQ(recordOf({"Serving Cell Info", "Physical Cell ID"}), 3U);
}

TEST_F(Counted, WithoutALedgerNothingIsCounted) {
    start(kPLLogChannelTechnology_Oskra_LTE);
    feed(Record(0xB0C2, 38));
    generator->updateState(state, Record(0xB0C2, 38).bytes());
    EXPECT_EQ(recordOf({"Serving Cell Info", "Physical Cell ID"}), 0U);
}

TEST_F(Counted, FieldsTellTheirBits) {
    start(kPLLogChannelTechnology_Oskra_LTE);
    feed(Record(0xB17F, 33));
    EXPECT_EQ(placeOf({"Serving Cell Measurements", "E-ARFCN"}), Place(17, 2, 0, 16, false));
    EXPECT_EQ(placeOf({"Serving Cell Measurements", "Average RSRQ"}), Place(21, 4, 25, 7, false));
    feed(Record(0xB180, 61).u16(19, 1 << 6));  // two cells, 20 bytes each, from 21 on
    EXPECT_EQ(recordOf({"Neighbor Cells List", "1", "Srxlev"}), 2U);
    EXPECT_EQ(placeOf({"Neighbor Cells List", "1", "Srxlev"}), Place(21 + 20 + 4, 4, 23, 7, false));
}

TEST_F(Counted, ValuesOfSeveralFieldsAndOfPropertyListsTellNone) {
    start(kPLLogChannelTechnology_Oskra_GSM);
    feed(Record(0x417A, 75).u8(15, 1));
    EXPECT_EQ(recordOf({"02;UMTS Cells", "Active Set", "0", "RSCP"}), 1U);
    EXPECT_FALSE(placeOf({"02;UMTS Cells", "Active Set", "0", "RSCP"}));
    EXPECT_EQ(placeOf({"02;UMTS Cells", "Active Set", "0", "Scrambling Code"}), Place(23, 2, 0, 13, false));
    feed(test::cellArray({test::cell("GSM", "Serving", {{"kPLCellMonitorLAC", 77}})}));
    EXPECT_EQ(recordOf({"01;Registration and Network", "Serving PLMN", "Location Area Code"}), 2U);
    EXPECT_FALSE(placeOf({"01;Registration and Network", "Serving PLMN", "Location Area Code"}));
    EXPECT_EQ(records.find(2)->code, 0xFF0001U);
}

TEST_F(Counted, TextsAndCellsBearTheNumberToo) {
    start(kPLLogChannelTechnology_Oskra_GSM);
    feed(Record(0x7135, 32));
    feed(Record(0x51F8, 19).u8(14, 2));
    feed(test::payload(0xFF0000, Dictionary::make({{"kSimFile_ICCID", "8900"}})));
    feed(test::payload(0xFF0002, Array::make({Dictionary::make({{"APN", "internet"}})})));
    EXPECT_EQ(recordOf({"01;Registration and Network", "Serving PLMN", "Mobile Country Code"}), 1U);
    EXPECT_EQ(placeOf({"01;Registration and Network", "Serving PLMN", "Location Area Code"}),
              Place(18, 2, 0, 16, true));
    EXPECT_EQ(recordOf({"04;GSM Cell and Neighbours", "Mobile Allocation", "ARFCNs", "1"}), 2U);
    EXPECT_EQ(placeOf({"04;GSM Cell and Neighbours", "Mobile Allocation", "ARFCNs", "1"}), Place(17, 2, 0, 16, false));
    EXPECT_EQ(recordOf({"06;SIM and Data Contexts", "SIM Info", "EF-ICCID"}), 3U);
    EXPECT_EQ(recordOf({"06;SIM and Data Contexts", "PDP Context Info", "0", "APN"}), 4U);
}

TEST_F(Counted, ACellMonitorsTreeHasANumberAndNoCode) {
    start(kPLLogChannelTechnology_IFX);
    const Value tree = Dictionary::make({{"Cell", Dictionary::make({{"MCC", "001"}, {"MNC", "01"}})}});
    feed(*writeXmlPropertyList(tree), 3s);
    feed(*writeXmlPropertyList(tree), 5s);
    EXPECT_EQ(recordOf({"Cell", "MNC"}), 2U);
    EXPECT_EQ(records.find(2)->code, 0U);
    EXPECT_TRUE(records.bytesOf(*records.find(2)).empty());
    EXPECT_EQ(ageOf(1, 6s), 3s);
}

TEST_F(Counted, TheTextsOfCDMABearItEverywhereTheyAreShown) {
    start(kPLLogChannelTechnology_Oskra_CDMA);
    feed(Record(0x1183, 50));  // device state 0: the second chain shows "N/A"
    EXPECT_EQ(*shown({"2;EV-DO", "08;Rx1 AGC"}).string(), "N/A");
    EXPECT_EQ(recordOf({"2;EV-DO", "08;Rx1 AGC"}), 1U);
    EXPECT_EQ(placeOf({"2;EV-DO", "11;UATI24"}), Place(38, 4, 0, 24, false));
    feed(Record(0x12B6, 37).u8(15, 1).u16(25, 12).u16(27, 512));
    EXPECT_EQ(recordOf({"2;EV-DO", "03;Active Set", "0;12"}), 2U);
    EXPECT_EQ(recordOf({"3;Rates and Errors", "1;EV-DO Forward Rate"}), 0U);
}

TEST_F(Counted, HistoryAndSavedContentsAreAsWithoutALedger) {
    start(kPLLogChannelTechnology_Oskra_LTE);
    const auto saved = [&](bool counts) {
        state.remove("History");
        state.remove("Display");
        counts ? feed(Record(0xB0C2, 38)) : generator->updateState(state, Record(0xB0C2, 38).bytes());
        generator->generateLogUsingState(state);
        const Dictionary& taken = *(*state["History"].array())[0].dictionary();
        return *writeXmlPropertyList(taken["Display"]);
    };
    EXPECT_EQ(saved(true), saved(false));
}

TEST_F(Counted, KeepsTheBytesOfTheLastRecordOfACodeThatShowedSomething) {
    start(kPLLogChannelTechnology_Oskra_LTE);
    const Bytes first = Record(0xB0C2, 38).u16(14, 1).bytes();
    Bytes prefixed = {0x81, 0};
    const Bytes second = Record(0xB0C2, 40).u16(14, 2).bytes();
    prefixed.insert(prefixed.end(), second.begin(), second.end());
    feed(first);
    EXPECT_TRUE(std::ranges::equal(records.bytesOf(*records.find(1)), first));
    feed(prefixed);
    feed(Record(0xB0C2, 37));  // too short: shows nothing
    feed(Record(0xB17F, 33));
    EXPECT_TRUE(records.bytesOf(*records.find(1)).empty());
    EXPECT_TRUE(std::ranges::equal(records.bytesOf(*records.find(2)), second));
    EXPECT_TRUE(records.bytesOf(*records.find(3)).empty());
    EXPECT_EQ(records.bytesOf(*records.find(4)).size(), 33U);
}

TEST_F(Counted, RemembersARecordForAsLongAsAValueComesFromIt) {
    start(kPLLogChannelTechnology_Oskra_LTE);
    feed(at(1000, Record(0xB17F, 33)));
    feed(at(1001, Record(0xB0C1, 22)));
    for (std::uint32_t i = 0; i < 3 * RecordLedger::kCapacity; ++i) {
        if (records.isFull()) records.forgetAllBut(state["Display"]);
        feed(at(1002, Record(0xB0C2, 38)));
    }
    ASSERT_NE(records.find(1), nullptr);
    EXPECT_EQ(records.find(1)->code, 0xB17FU);
    EXPECT_EQ(records.find(2)->code, 0xB0C1U);
    EXPECT_EQ(records.find(3), nullptr);  // its values were written anew
    EXPECT_EQ(ageOf(1, 0s), 2s);
    EXPECT_EQ(records.bytesOf(*records.find(1)).size(), 33U);
}

TEST_F(Counted, ForgetsTheOldestWhenNobodySaysWhatIsStillShown) {
    start(kPLLogChannelTechnology_Oskra_LTE);
    for (std::size_t i = 0; i <= RecordLedger::kCapacity; ++i) feed(Record(0xB0C2, 38));
    EXPECT_EQ(records.find(1), nullptr);
    EXPECT_NE(records.find(records.count()), nullptr);
}

TEST_F(Counted, AgesGoByTheRecordsOwnTimes) {
    start(kPLLogChannelTechnology_Oskra_LTE);
    feed(at(5000, Record(0xB0C2, 38)), 100s);
    feed(at(5010, Record(0xB17F, 33)), 101s);  // a replay at ten times the speed
    EXPECT_EQ(ageOf(1, 101s), 10s);
    EXPECT_EQ(ageOf(2, 101s), 0s);
    EXPECT_EQ(ageOf(2, 104s), 3s);  // nothing comes any more
}

TEST_F(Counted, AClockThatIsSetOrAReplayThatBeginsAnewMakesNothingOlder) {
    start(kPLLogChannelTechnology_Oskra_LTE);
    feed(at(10, Record(0xB0C2, 38)), 100s);
    feed(at(1'400'000, Record(0xB0C1, 22)), 102s);  // sixteen days on: the modem has learned the time
    EXPECT_EQ(ageOf(1, 102s), 2s);
    feed(at(1'400'005, Record(0xB0C1, 22)), 107s);
    EXPECT_EQ(ageOf(1, 107s), 7s);
    feed(at(1'300'000, Record(0xB0C1, 22)), 108s);  // back to the beginning
    EXPECT_EQ(ageOf(1, 108s), 8s);
    feed(at(1'300'001, Record(0xB0C1, 22)), 109s);
    EXPECT_EQ(ageOf(1, 109s), 9s);
}

TEST_F(Counted, RecordsALittleOutOfOrderAndWithoutATimeDoNotMoveTheClock) {
    start(kPLLogChannelTechnology_Oskra_LTE);
    feed(at(5000, Record(0xB0C2, 38)), 100s);
    feed(at(4999, Record(0xB0C1, 22)), 100s);
    EXPECT_EQ(ageOf(1, 100s), 0s);
    feed(Record(0xB17F, 33), 101s);
    EXPECT_EQ(ageOf(1, 101s), 1s);
    feed(at(5003, Record(0xB0C1, 22)), 103s);
    EXPECT_EQ(ageOf(1, 103s), 3s);
}

}  // namespace
}  // namespace kelvo
