#include "telephony/phone/PhoneRecords.h"

#include <gtest/gtest.h>

#include "platform/encodings/PropertyList.h"

namespace kelvo::phone {
namespace {

/// An LTE phone of which everything is told.
PhoneState ltePhone() {
    PhoneState phone;
    phone.family = Technology::LTE;
    phone.cells = {{.technology = MonitoredCell::Technology::LTE, .isServing = true, .pid = 301, .uarfcn = 1300}};
    phone.lte = {.rsrp = -100, .rsrq = -8, .rssi = -65};
    return phone;
}

Value listOf(const Content& content) { return readPropertyList(content.payload).value(); }

TEST(PhoneRecords, SayWhatIsKnownAndNothingElse) {
    EXPECT_TRUE(serviceContents({}).empty());
    PhoneState phone;
    phone.sim.iccid = "8900101";
    phone.cells = {{.technology = MonitoredCell::Technology::GSM, .isServing = true, .mcc = 1, .rssi = -50}};
    phone.contexts = {{.id = std::nullopt, .apn = "internet", .state = "Active"}};
    const auto contents = serviceContents(phone);
    ASSERT_EQ(contents.size(), 3U);
    EXPECT_EQ(contents[0].code, 0xFF0000U);
    EXPECT_EQ(listOf(contents[0]), Value(Dictionary::make({{"kSimFile_ICCID", "8900101"}})));
    EXPECT_EQ(contents[1].code, 0xFF0001U);
    EXPECT_EQ(listOf(contents[1]),
              Value(Array::make({Dictionary::make({
                  {"kPLCellMonitorCellRadioAccessTechnology", "kPLCellMonitorRadioAccessTechnologyGSM"},
                  {"kPLCellMonitorCellType", "kPLCellMonitorCellTypeServing"},
                  {"kPLCellMonitorMCC", 1},
                  {"kPLCellMonitorRSSI", -50},
              })})));
    EXPECT_EQ(contents[2].code, 0xFF0002U);
    EXPECT_EQ(listOf(contents[2]), Value(Array::make({Dictionary::make({{"APN", "internet"}, {"State", "Active"}})})));
}

TEST(PhoneRecords, SayThatThereIsNoCellAndNoContextWhereThatIsTold) {
    PhoneState phone;
    phone.cells.emplace();
    phone.contexts.emplace();
    const auto contents = serviceContents(phone);
    ASSERT_EQ(contents.size(), 2U);
    EXPECT_EQ(listOf(contents[0]), Value(Array::make({})));
    EXPECT_EQ(listOf(contents[1]), Value(Array::make({})));
}

TEST(PhoneRecords, BeginWithTypeLengthCodeAndTime) {
    const Bytes extended = recordOf({0xFF0002, {0xAA, 0xBB}}, 0x1122334455667788);
    EXPECT_EQ(extended, (Bytes{255, 14, 0, 2, 0, 0x88, 0x77, 0x66, 0x55, 0x44, 0x33, 0x22, 0x11, 0xAA, 0xBB}));
    const Bytes ordinary = recordOf({0xB17F, Bytes(300)}, 0);
    EXPECT_EQ(ordinary.size(), 313U);
    EXPECT_EQ(Bytes(ordinary.begin(), ordinary.begin() + 5), (Bytes{1, 0x38, 0x01, 0x7F, 0xB1}));
}

TEST(PhoneRecords, LeaveOutAListThatNoRecordCanHold) {
    PhoneState phone;
    phone.sim.iccid = std::string(70'000, '1');
    EXPECT_TRUE(serviceContents(phone).empty());
}

TEST(PhoneRecords, MeasureTheServingLteCell) {
    PhoneState phone = ltePhone();
    phone.cells->insert(phone.cells->begin(),
                        {.technology = MonitoredCell::Technology::LTE, .pid = 7, .uarfcn = 1});  // a neighbor
    const adaptation::ServingLevels expected{.earfcn = 1300, .pci = 301, .rsrp = -100, .rsrq = -8, .rssi = -65};
    EXPECT_EQ(servingLevels(phone), expected);
    EXPECT_EQ(missingLevels(phone), "");
    const Content content = measurementContent(expected, {});
    EXPECT_EQ(content.code, 0xB17FU);
    ASSERT_EQ(content.payload.size(), 20U);
    EXPECT_EQ(content.payload[8], 160);
}

TEST(PhoneRecords, AskWhatThePortLastSentOfTheCell) {
    adaptation::IdleCells::Payload last{};
    last[7] = 0x0A;  // priority 5
    const LastIdle lastIdle = [&](std::uint32_t earfcn, std::uint16_t pci) {
        return earfcn == 66586 && pci == 301 ? &last : nullptr;
    };
    EXPECT_EQ(measurementContent({.earfcn = 66586, .pci = 301}, lastIdle).payload[7], 0x0B);  // PCI's bit 8 beside it
    EXPECT_EQ(measurementContent({.earfcn = 65535, .pci = 301}, lastIdle).payload[7], 0x01);
}

TEST(PhoneRecords, MeasureNothingThatIsNotTold) {
    const auto without = [](auto change) {
        PhoneState phone = ltePhone();
        change(phone);
        EXPECT_FALSE(servingLevels(phone));
        return missingLevels(phone);
    };
    EXPECT_EQ(without([](PhoneState& phone) { phone.lte.rssi.reset(); }), "RSSI");
    EXPECT_EQ(without([](PhoneState& phone) { phone.lte.rsrq.reset(); }), "RSRQ");
    EXPECT_EQ(without([](PhoneState& phone) { phone.lte.rsrp.reset(); }), "RSRP");
    EXPECT_EQ(without([](PhoneState& phone) { (*phone.cells)[0].uarfcn.reset(); }), "its channel");
    EXPECT_EQ(without([](PhoneState& phone) { (*phone.cells)[0].pid = 504; }), "its physical cell identity");
    EXPECT_EQ(without([](PhoneState& phone) { phone.cells.reset(); }), "its channel, its physical cell identity");
    EXPECT_EQ(without([](PhoneState& phone) { phone.family = Technology::GSM; }), "");
}

TEST(PhoneRecords, ShortenIdentities) {
    EXPECT_EQ(shortened("8900101000000123456"), "…3456");
    EXPECT_EQ(shortened("12345678"), "…");
    EXPECT_EQ(shortened(""), "…");
}

}  // namespace
}  // namespace kelvo::phone
