#include "tests/telephony/wire/SessionFixture.h"

using namespace kelvo;
using namespace kelvo::test;

namespace {

/// A session that listens to what the phone is camped on.
class SessionTechnologyTest : public SessionTest {
protected:
    SessionTechnologyTest() { make({.technology = {}, .subscription = {}}); }
    // The modem has been asked for the signs of every technology.
    void listen() {
        run();
        while (!sent.empty()) agree();
    }
};

}  // namespace

TEST_F(SessionTechnologyTest, IsWhatIsAskedForWithoutListening) {
    make({.technology = Technology::CDMA, .subscription = {}});
    EXPECT_EQ(session->technology(), Technology::CDMA);
    run();
    EXPECT_TRUE(sent.empty());
    EXPECT_FALSE(session->deadline());
}

TEST_F(SessionTechnologyTest, IsThatOfTheRecordsThatCome) {
    listen();
    EXPECT_FALSE(session->technology());
    say(recordOf(0x5134));
    EXPECT_FALSE(session->technology());
    pass(499ms);
    EXPECT_FALSE(session->technology());
    pass(1ms);
    EXPECT_EQ(session->technology(), Technology::GSM);
    EXPECT_EQ(lines(), std::vector<std::string>{"port: the phone is camped on GSM"});
    EXPECT_EQ(session->counts().forNobody + session->counts().delivered, 1U);
}

TEST_F(SessionTechnologyTest, IsAskedForWithSignsOfEveryTechnologyThatTheModemHas) {
    run();
    std::vector<int> equipment;
    while (!sent.empty()) {
        equipment.push_back(plainBody(sent.back())[8]);
        agree();
    }
    EXPECT_EQ(equipment, (std::vector<int>{1, 4, 5, 0xB}));
    EXPECT_TRUE(log.lines().empty());  // that it lacks 0xd is no client's matter
}

TEST_F(SessionTechnologyTest, WaitsThreeSecondsForASign) {
    listen();
    pass(2s);
    say(recordOf(0x119C));
    EXPECT_EQ(session->technology(), Technology::CDMA);
}

TEST_F(SessionTechnologyTest, IsTheNewestThatTheModemHasWhenNothingComes) {
    listen();
    pass(2999ms);
    EXPECT_FALSE(session->technology());
    EXPECT_EQ(session->deadline(), now + 1ms);
    pass(1ms);
    EXPECT_EQ(session->technology(), Technology::LTE);
}

TEST_F(SessionTechnologyTest, IsTheOneThatIsHeardMost) {
    listen();
    say(recordOf(0x1183));
    say(recordOf(0xB0C2));
    say(recordOf(0xB17F));
    pass(500ms);
    EXPECT_EQ(session->technology(), Technology::LTE);
}

TEST_F(SessionTechnologyTest, SaysWhatThePhoneHasChangedTo) {
    listen();
    say(recordOf(0xB0C2));
    pass(500ms);
    pass(100s);
    say(recordOf(0x4127));
    EXPECT_EQ(session->technology(), Technology::LTE);
    pass(5s);
    EXPECT_EQ(session->technology(), Technology::GSM);
    EXPECT_EQ(lines(),
              (std::vector<std::string>{"port: the phone is camped on LTE", "port: the phone has changed to GSM"}));
}

TEST_F(SessionTechnologyTest, DoesNotChangeWhileTheOldOneIsHeard) {
    listen();
    say(recordOf(0xB0C2));
    pass(500ms);
    for (int i = 0; i < 20; ++i) {
        say(recordOf(0x5137));
        pass(1s);
        say(recordOf(0xB17F));
        pass(1s);
    }
    EXPECT_EQ(session->technology(), Technology::LTE);
    EXPECT_EQ(log.lines().size(), 1U);
}

TEST_F(SessionTechnologyTest, StaysWhenTheModemComesBackAndIsForgottenWhenNobodyCares) {
    listen();
    say(recordOf(0x5134));
    pass(500ms);
    session->lose();
    EXPECT_EQ(session->technology(), Technology::GSM);
    listen();
    EXPECT_EQ(session->technology(), Technology::GSM);
    session->end();
    pass(200ms);
    session->forgetTechnology();
    EXPECT_FALSE(session->technology());
}

TEST_F(SessionTechnologyTest, RecordsOfItAreDeliveredToWhoeverWantsThemAndElseNoLoss) {
    want({0xB0C2});
    run();
    while (!sent.empty()) agree();
    say(recordOf(0xB0C2));
    hasClient = false;
    say(recordOf(0xB0C1));
    EXPECT_EQ(session->counts().delivered, 1U);
    EXPECT_EQ(session->counts().listenedTo, 1U);
    EXPECT_EQ(session->counts().forNobody, 0U);
}
