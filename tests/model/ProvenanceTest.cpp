#include "model/Provenance.h"

#include "tests/model/MonitoredModel.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using test::Record;

constexpr const char* kAntennas = "/Serving Cell Info/Num Tx Antennas";

class ProvenanceTest : public test::MonitoredModel {
protected:
    std::optional<Provenance> provenance(const std::string& path = kCellPath) {
        const NodeRef node = model->nodeAtPath(path);
        return node ? model->provenance(*node) : std::nullopt;
    }
    /// The screens as after a tick.
    void refresh() { queue.advance(2s); }
};

TEST_F(ProvenanceTest, TellsTheRecordThatWroteAValue) {
    startLte();
    deliver(Record(0xB0C1, 22).u8(20, 2).bytes());
    queue.advance(1s);
    // 2023-12-06 04:04:26.2273, 72659535985485082, from offset 5 on.
    const Bytes cell = Record(0xB0C2, 38).u32(5, 0x87F5A51A).u32(9, 0x01022376).u16(14, 301).bytes();
    deliver(cell);
    const auto found = provenance();
    ASSERT_TRUE(found);
    EXPECT_EQ(found->record, 2U);
    EXPECT_EQ(found->code, 0xB0C2U);
    EXPECT_EQ(describe(*found), "0xb0c2  LTE serving cell, identity");
    ASSERT_TRUE(found->modemTime);
    EXPECT_EQ(std::chrono::floor<std::chrono::milliseconds>(*found->modemTime),
              std::chrono::sys_days(std::chrono::year(2023) / 12 / 6) + 4h + 4min + 26s + 227ms);
    EXPECT_EQ(found->place, Place(14, 2, 0, 16, false));
    EXPECT_TRUE(std::ranges::equal(found->bytes, cell));
    EXPECT_EQ(found->age, 0s);
    EXPECT_EQ(found->arrival, queue.now());
    ASSERT_TRUE(provenance(kAntennas));
    EXPECT_EQ(provenance(kAntennas)->record, 1U);
    EXPECT_FALSE(provenance(kAntennas)->modemTime);  // the record has none
    EXPECT_EQ(provenance(kAntennas)->age, 1s);
}

TEST_F(ProvenanceTest, KnowsNothingOfWhatNoRecordHasWritten) {
    startLte();
    deliver(servingCell(301));
    EXPECT_FALSE(provenance(kAntennas));
    EXPECT_FALSE(provenance("/Serving Cell Info"));
}

TEST_F(ProvenanceTest, NodesHaveTheNumberInItsUnit) {
    startLte();
    deliver(Record(0xB17F, 33).u32(21, 179).bytes());  // 179 / 4 - 140
    const NodeRef node = model->nodeAtPath("/Serving Cell Measurements/Measured RSRP");
    ASSERT_TRUE(node->measurement());
    EXPECT_EQ(node->measurement()->number, -95.25);
    EXPECT_EQ(node->measurement()->unit, "dBm");
    EXPECT_FALSE(model->nodeAtPath(kAntennas)->measurement());
}

TEST_F(ProvenanceTest, CountsOnOverRefreshesAndKeepsWhatIsNotWrittenAnew) {
    startLte();
    deliver(Record(0xB0C1, 22).u8(20, 2).bytes());
    deliver(servingCell(301));
    model->topLevelNodes();
    refresh();
    deliver(servingCell(302));
    refresh();
    EXPECT_EQ(provenance()->record, 3U);
    EXPECT_EQ(provenance(kAntennas)->record, 1U);
    EXPECT_EQ(provenance(kAntennas)->age, 4s);
}

TEST_F(ProvenanceTest, CountsOnOverAReconnectionAndAGeneratorThatTakesOver) {
    startLte();
    deliver(Record(0xB0C1, 22).u8(20, 2).bytes());
    deliver(servingCell(301));
    ports.killPeer();
    refresh();
    ASSERT_FALSE(model->isConnected());
    queue.advance(40s);
    EXPECT_EQ(provenance()->record, 2U);
    EXPECT_EQ(provenance()->age, 42s);  // what is lost ages
    ports.listening = {"service"};
    queue.advance(5s);
    ASSERT_TRUE(model->isConnected());
    deliver(servingCell(302));  // another generator, the same display
    refresh();
    EXPECT_EQ(shown(), "302");
    EXPECT_EQ(provenance()->record, 3U);
    EXPECT_EQ(provenance()->code, 0xB0C2U);
    EXPECT_EQ(provenance(kAntennas)->record, 1U);
    EXPECT_EQ(provenance(kAntennas)->bytes.size(), 22U);
}

TEST_F(ProvenanceTest, ValuesOfATechnologyThatHasGoneAgeAndKeepTheirRecord) {
    startLte();
    deliver(servingCell(301));
    ports.onRequest = test::speaking("kPLLogChannelTechnology_Oskra_GSM");
    model->restartMonitor();
    queue.advance(10s);
    deliver(Record(0x7135, 32).bytes());
    refresh();
    EXPECT_EQ(shown(), "301");
    EXPECT_EQ(provenance()->record, 1U);
    EXPECT_EQ(provenance()->age, 12s);
}

TEST_F(ProvenanceTest, AReplaysValuesAgeInTheStreamsTime) {
    startLte();
    const auto at = [](std::uint32_t seconds, Record record) { return record.u32(7, 800 * seconds).bytes(); };
    deliver(at(5000, Record(0xB0C2, 38)));
    deliver(at(5035, Record(0xB0C1, 22)));  // at once: as fast as it goes
    EXPECT_EQ(provenance()->age, 35s);
    EXPECT_EQ(model->streamTime() - provenance()->stream, 35s);
    queue.advance(1s);
    EXPECT_EQ(provenance()->age, 36s);
}

TEST_F(ProvenanceTest, StaysWithAValueUnderAFloodOfOthers) {
    startLte();
    deliver(Record(0xB0C1, 22).u8(20, 2).bytes());
    for (int i = 0; i < 20'000; ++i) deliver(servingCell(301));
    refresh();
    EXPECT_EQ(provenance()->record, 20'001U);
    EXPECT_EQ(provenance(kAntennas)->record, 1U);
}

}  // namespace
}  // namespace kelvo
