#include <gtest/gtest.h>

#include "telephony/simulation/GSMUMTS/Records.h"
#include "telephony/simulation/GSMUMTS/Registration.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::simulation::gsm;
using namespace std::chrono_literals;

namespace {

constexpr Area kHome{0x1101, 1};
constexpr Area kNext{0x1102, 1};
constexpr Area kSameLocation{0x1101, 2};

/// Registered in kHome, one second after the beginning.
Registration settled() {
    Registration registration;
    registration.step(0ms, {.area = kHome, .isLinkOpen = true});
    registration.step(1s, {.area = kHome, .isLinkOpen = true});
    return registration;
}

}  // namespace

TEST(Registration, SearchesUntilThereIsACell) {
    Registration registration;
    registration.step(1s, {});
    EXPECT_EQ(registration.mobility().registration, RegistrationState::AutomaticSearch);
    EXPECT_EQ(registration.mobility().service, ServiceType::None);
    EXPECT_FALSE(registration.wantsLink());
}

TEST(Registration, AsksForAConnectionAndTakesItsTimeOverIt) {
    Registration registration;
    registration.step(0ms, {.area = kHome});
    EXPECT_TRUE(registration.wantsLink());
    EXPECT_EQ(registration.mobility().mm, MmState::WaitForRrConnectionLu);
    EXPECT_EQ(registration.mobility().gmm, GmmState::RegisteredInitiated);
    registration.step(200ms, {.area = kHome, .isLinkOpen = true});
    EXPECT_EQ(registration.mobility().mm, MmState::LocationUpdateInitiated);
    EXPECT_EQ(registration.mobility().service, ServiceType::Limited);
    registration.step(700ms, {.area = kHome, .isLinkOpen = true});
    EXPECT_EQ(registration.registered(), kHome);
    EXPECT_EQ(registration.mobility().mm, MmState::Idle);
    EXPECT_EQ(registration.mobility().service, ServiceType::CsAndPs);
    EXPECT_FALSE(registration.wantsLink());
}

TEST(Registration, LeavesTheCircuitDomainAloneWhenOnlyTheRoutingAreaChanges) {
    Registration registration = settled();
    registration.step(2s, {.area = kSameLocation});
    EXPECT_EQ(registration.mobility().gmm, GmmState::RoutingAreaUpdateInitiated);
    EXPECT_EQ(registration.mobility().gmmSub, GmmSubState::UpdateNeeded);
    EXPECT_EQ(registration.mobility().mm, MmState::Idle);
    EXPECT_TRUE(registration.mobility().isLocationUpdated);
}

TEST(Registration, WaitsForTheEndOfACall) {
    Registration registration = settled();
    registration.step(2s, {.area = kNext, .isLinkOpen = true, .activity = Activity::Talking});
    EXPECT_FALSE(registration.wantsLink());
    EXPECT_EQ(registration.mobility().mm, MmState::ConnectionActive);
    EXPECT_EQ(registration.mobility().mmSub, MmSubState::LocationUpdateNeeded);
    registration.step(3s, {.area = kNext, .isLinkOpen = true});
    EXPECT_EQ(registration.mobility().mm, MmState::LocationUpdateInitiated);
}

TEST(Registration, GivesUpWhenThePhoneIsBackBeforeItBegan) {
    Registration registration = settled();
    registration.step(2s, {.area = kNext});
    registration.step(3s, {.area = kHome});
    EXPECT_FALSE(registration.wantsLink());
    EXPECT_EQ(registration.mobility().mm, MmState::Idle);
}

TEST(Registration, SuspendsPacketDataDuringACallInGsmOnly) {
    Registration registration = settled();
    registration.step(2s, {.area = kHome, .isLinkOpen = true, .activity = Activity::Talking});
    EXPECT_EQ(registration.mobility().gmmSub, GmmSubState::Suspended);
    EXPECT_EQ(registration.mobility().service, ServiceType::CsOnly);
    registration.step(3s, {.area = kHome, .rat = Rat::UMTS, .isLinkOpen = true, .activity = Activity::Talking});
    EXPECT_EQ(registration.mobility().gmmSub, GmmSubState::NormalService);
    EXPECT_EQ(registration.mobility().service, ServiceType::CsAndPs);
}

TEST(SearcherRecord, TellsTheSetOfEachCellAboveThirteenBitsOfItsCode) {
    const SearchedCell cells[] = {{.scramblingCode = Psc(0x1ab), .set = CellSet::Active, .ecNo = 0},
                                  {.scramblingCode = Psc(0x0cd), .set = CellSet::VirtualActive, .ecNo = -10}};
    const Bytes message = searcherRecord(0s, -70, cells);
    const ByteView record = ByteView(message).subspan(2);
    ASSERT_EQ(record.size(), 16U + 2 * 15 + 2 * 44);
    EXPECT_EQ(record[13] | record[14] << 8, (-70 + 106) * 10 - 512 + 0x10000);
    EXPECT_EQ(record[15], 2);
    EXPECT_EQ(record[16 + 7], 0xab);
    EXPECT_EQ(record[16 + 8], 0x01);
    EXPECT_EQ(record[31 + 7], 0xcd);
    EXPECT_EQ(record[31 + 8], 3 << 5);
    EXPECT_EQ(record[46 + 34], 8);  // 524288, 0 dB
    EXPECT_EQ(record[90 + 32] | record[90 + 33] << 8 | record[90 + 34] << 16, 52429);
}

TEST(TransmitPowerRecord, TellsAPowerThatLooksLikeOffAsItsNeighbor) {
    const std::optional<double> slots[] = {-18.8, std::nullopt};
    const Bytes message = transmitPowerRecord(0s, slots);
    EXPECT_EQ(message[2 + 14], 2);
    EXPECT_EQ(message[2 + 16 + 4], 1);
    EXPECT_EQ(message[2 + 30 + 4], 0);
}
