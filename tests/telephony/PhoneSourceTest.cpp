#include "telephony/PhoneSource.h"

#include <gtest/gtest.h>

#include "platform/system/Environment.h"
#include "telephony/PhoneStatus.h"
#include "tests/support/ManualQueue.h"
#include "tests/support/RecordingLog.h"
#include "tests/telephony/FakePhone.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using Codes = std::vector<LogCode>;

const Codes kAll = {0xFF0000, 0xFF0001, 0xFF0002, 0xB17F};

class PhoneSourceTest : public testing::Test {
protected:
    void stream() {
        source.start(sink);
        source.clientsWant({.streaming = true, .ordinary = {}});
    }
    void know(const phone::PhoneState& state) {
        phone.state = state;
        phone.change();
    }

    test::ManualQueue queue;
    test::RecordingLog log;
    Environment::Scope scope{Environment{.log = &log}};
    test::FakePhone& phone = *new test::FakePhone;
    PhoneSource source{std::unique_ptr<phone::PhoneService>(&phone), queue, [this] { return queue.now(); }};
    test::KeepingSink sink;
};

TEST_F(PhoneSourceTest, WritesWhatIsKnownWhenSomebodyStreams) {
    know(test::ltePhone());
    EXPECT_TRUE(sink.records.empty());
    stream();
    EXPECT_EQ(phone.measures, std::vector{true});
    EXPECT_EQ(sink.codes(), kAll);
    source.clientsWant({});
    EXPECT_EQ(phone.measures, (std::vector{true, false}));
    queue.advance(30s);
    EXPECT_TRUE(sink.records.empty());
}

TEST_F(PhoneSourceTest, WritesWhatHasChangedAtOnceAndTheRestEveryTenSeconds) {
    know(test::ltePhone());
    stream();
    sink.codes();
    queue.advance(4s);
    phone.change();  // nothing new
    EXPECT_TRUE(sink.records.empty());
    phone.state.lte.rsrp = -101;
    phone.change();
    EXPECT_EQ(sink.codes(), Codes{0xB17F});
    queue.advance(5s);
    EXPECT_TRUE(sink.records.empty());
    queue.advance(1s);
    EXPECT_EQ(sink.codes(), (Codes{0xFF0000, 0xFF0001, 0xFF0002}));
    queue.advance(4s);
    EXPECT_EQ(sink.codes(), Codes{0xB17F});
}

TEST_F(PhoneSourceTest, WritesEverythingAnewForAClientWhoComes) {
    know(test::ltePhone());
    stream();
    sink.codes();
    queue.advance(2s);
    source.feed();
    EXPECT_EQ(sink.codes(), kAll);
    source.feed();  // a slow one that catches up gets no flood
    EXPECT_TRUE(sink.records.empty());
}

TEST_F(PhoneSourceTest, WritesNothingThatIsNotTold) {
    know({.modem = "0"});
    stream();
    queue.advance(30s);
    EXPECT_TRUE(sink.records.empty());
    EXPECT_EQ(source.technology(), std::nullopt);
}

TEST_F(PhoneSourceTest, KeepsItsTechnologyOutOfReachAndForgetsItWithTheModem) {
    know(test::ltePhone());
    EXPECT_EQ(source.technology(), Technology::LTE);
    phone.state.family.reset();
    phone.change();
    EXPECT_EQ(source.technology(), Technology::LTE);
    know({});
    EXPECT_EQ(source.technology(), std::nullopt);
    know({.modem = "1", .access = "GSM", .family = Technology::GSM});
    EXPECT_EQ(source.technology(), Technology::GSM);
}

TEST_F(PhoneSourceTest, TellsOnceThatThePhoneIsOnSomethingElseNow) {
    know(test::ltePhone());
    phone.state.family = Technology::GSM;
    phone.change();  // nobody streams: nobody is told
    EXPECT_TRUE(log.lines().empty());
    know(test::ltePhone());
    stream();
    phone.state.family = Technology::GSM;
    phone.state.access = "GSM, EDGE";
    phone.change();
    phone.change();
    ASSERT_EQ(log.lines().size(), 1U);
    EXPECT_EQ(log.lines()[0].second,
              "The phone is on GSM now (GSM, EDGE): clients that stream keep their screens of LTE");
    EXPECT_EQ(source.technology(), Technology::GSM);
    sink.codes();
    queue.advance(10s);
    EXPECT_EQ(sink.codes(), (Codes{0xFF0000, 0xFF0001, 0xFF0002}));  // the channel stays; LTE is not measured
}

TEST_F(PhoneSourceTest, EndsWhenTheServiceHasLeft) {
    bool done = false;
    source.end([&] { done = true; });
    EXPECT_FALSE(done);
    phone.released();
    EXPECT_TRUE(done);
}

TEST_F(PhoneSourceTest, TellsItsStatusWithIdentitiesShortened) {
    phone::PhoneState state = test::ltePhone();
    state.model = "Maker Model";
    state.equipment = "860000000000012";
    state.condition = "registered";
    state.registration = "home";
    state.network = "Test\nNetwork";
    state.simOperator = "Provider";
    state.sim.msisdn = "+15550123";
    state.lte.rssi.reset();
    phone.whatLacks = {"cell information: it says no"};
    know(state);
    EXPECT_EQ(phoneStatusText(*source.phoneStatus()),
              "\n"
              "ModemManager\n"
              "  Modem                     0\n"
              "  Model                     Maker Model\n"
              "  Equipment                 …0012\n"
              "  It is                     registered\n"
              "  On                        LTE\n"
              "  Registered                home\n"
              "  Network                   Test\xEF\xBF\xBDNetwork\n"
              "  SIM                       …3456\n"
              "  SIM operator              Provider\n"
              "  Cells                     1 cell\n"
              "  Data contexts             0 contexts\n"
              "  lacks cell information: it says no\n"
              "  lacks LTE serving cell measurements: not told: RSSI\n");
    EXPECT_EQ(phoneStatusText(*phoneStatus(test::FakePhone())), "\nModemManager\n");
}

TEST_F(PhoneSourceTest, CountsTheRecordsThatItDerivesOfLevels) {
    know(test::ltePhone());
    EXPECT_EQ(phoneStatusText(*source.phoneStatus()).find("Derived"), std::string::npos);
    stream();
    phone.state.lte.rsrp = -101;
    phone.change();
    sink.wantsAny = false;
    phone.state.lte.rsrp = -102;
    phone.change();
    EXPECT_NE(
        phoneStatusText(*source.phoneStatus())
            .find("  Derived                   2 (0xb17f of the levels: priority, limits, thresholds and rules are "
                  "not told)\n"),
        std::string::npos);
}

TEST_F(PhoneSourceTest, SaysWhatIsWrong) {
    phone.whatIsWrong = "ModemManager does not run";
    EXPECT_EQ(source.state(), "ModemManager does not run");
    EXPECT_EQ(source.description(), "a phone");
}

}  // namespace
}  // namespace kelvo
