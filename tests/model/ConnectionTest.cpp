#include "model/Connection.h"

#include "platform/telephony/TelephonyProtocol.h"
#include "tests/model/MonitoredModel.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using State = Connection::State;
using Error = RemotePort::Error;

std::string textAfter(std::chrono::nanoseconds silence, State state = State::Receiving) {
    return connectionText({.state = state, .silence = silence});
}

TEST(ConnectionText, TellsTheLengthOfASilenceFromTenSecondsOn) {
    EXPECT_EQ(textAfter(0s), "");
    EXPECT_EQ(textAfter(10s - 1ns), "");
    EXPECT_EQ(textAfter(10s), "No records for 10 s");
    EXPECT_EQ(textAfter(25s - 1ns), "No records for 24 s");
    EXPECT_EQ(textAfter(120s - 1ns), "No records for 119 s");
    EXPECT_EQ(textAfter(120s), "No records for 2 min");
    EXPECT_EQ(textAfter(100h - 1ns), "No records for 5999 min");
}

TEST(ConnectionText, WaitsForTheFirstRecord) {
    EXPECT_EQ(connectionText({}), "Waiting for the modem");
    EXPECT_EQ(textAfter(10s - 1ns, State::NoRecordYet), "Waiting for the modem");
    EXPECT_EQ(textAfter(24s, State::NoRecordYet), "No records for 24 s");
}

TEST(ConnectionText, NamesTheObstacle) {
    EXPECT_EQ(connectionText({State::NoPort}), "Kelvo cannot open its port");
    EXPECT_EQ(connectionText({State::PortTaken}), "Kelvo is already open");
    EXPECT_EQ(connectionText({State::NoService}), "No telephony service is running");
    EXPECT_EQ(connectionText({State::Refused}), "The telephony service refuses the connection");
    EXPECT_EQ(connectionText({State::NoAnswer}), "The telephony service does not answer");
    EXPECT_EQ(connectionText({State::UnknownTechnology}), "The modem's technology is unknown");
}

TEST(WaitingText, NamesAModemThatSendsNothingFromTheStart) {
    EXPECT_EQ(waitingText({}), "Waiting for the modem");
    EXPECT_EQ(waitingText({State::NoRecordYet, 10s - 1ns}), "Waiting for the modem");
    EXPECT_EQ(waitingText({State::NoRecordYet, 10s}), "The modem sends nothing");
    EXPECT_EQ(waitingText({State::Receiving, 0s}), "Waiting for the modem");  // for the refresh that shows it
    EXPECT_EQ(waitingText({State::Receiving, 60s}), "Waiting for the modem");
}

TEST(WaitingText, NamesTheObstacle) {
    EXPECT_EQ(waitingText({State::NoService}), "No telephony service is running");
    EXPECT_EQ(waitingText({State::PortTaken}), "Kelvo is already open");
    EXPECT_EQ(waitingText({State::NoAnswer}), "The telephony service does not answer");
}

TEST(StatusText, IsTheUpdateMessageWhileConnected) {
    EXPECT_EQ(statusText(true, "Updated 2011-03-04 at 09:15:02"), "Updated 2011-03-04 at 09:15:02");
    EXPECT_EQ(statusText(false, "Updated 2011-03-04 at 09:15:02"), "Connecting...");
}

class KelvoModelConnection : public test::MonitoredModel {
protected:
    State stateAfterStart() {
        model = newModel();
        model->restartMonitor();
        EXPECT_EQ(model->connection().silence, 0s);
        EXPECT_EQ(model->connection().isConnected(), model->isConnected());
        return model->connection().state;
    }
    State stateAfterAnswer(const test::FakePorts::Answer& answer) {
        ports.onRequest = [answer](const test::FakePorts::Sent&) { return answer; };
        return stateAfterStart();
    }
};

TEST_F(KelvoModelConnection, HasNotBegunBeforeTheStart) {
    EXPECT_EQ(model->connection().state, State::NotStarted);
    queue.advance(60s);
    EXPECT_EQ(told, Texts());
}

TEST_F(KelvoModelConnection, KnowsWhyThereIsNoLocalPort) {
    ports.taken.insert(kLocalPort);
    EXPECT_EQ(stateAfterStart(), State::PortTaken);
    ports.refusesLocalPorts = true;
    EXPECT_EQ(stateAfterStart(), State::NoPort);
}

TEST_F(KelvoModelConnection, KnowsThatNoServiceIsThere) {
    telephony.reachable = false;
    EXPECT_EQ(stateAfterStart(), State::NoService);
}

TEST_F(KelvoModelConnection, TellsARefusalFromSilence) {
    telephony.answer = {.error = {.domain = kPLErrorDomainService, .error = 45}, .portName = ""};
    EXPECT_EQ(stateAfterStart(), State::Refused);
    telephony.answer = {.error = {.domain = kPLErrorDomainClient, .error = kPLErrorNoAnswer}, .portName = ""};
    EXPECT_EQ(stateAfterStart(), State::NoAnswer);
    telephony.answer = {.error = {}, .portName = ""};
    EXPECT_EQ(stateAfterStart(), State::Refused);
    telephony.answer = {.error = {}, .portName = "gone"};
    EXPECT_EQ(stateAfterStart(), State::NoAnswer);
}

TEST_F(KelvoModelConnection, KnowsThatTheQueryOrTheStartCommandCameToNothing) {
    EXPECT_EQ(stateAfterAnswer(Error::ReplyTimedOut), State::NoAnswer);
    EXPECT_EQ(stateAfterAnswer(Bytes()), State::NoAnswer);
    ports.onRequest = [](const test::FakePorts::Sent& message) -> test::FakePorts::Answer {
        if (message.replyLimit) return test::technologyAnswer(kLte);
        return Error::SendTimedOut;
    };
    EXPECT_EQ(stateAfterStart(), State::NoAnswer);
}

TEST_F(KelvoModelConnection, KnowsThatTheTechnologyIsUnknown) {
    EXPECT_EQ(stateAfterAnswer(test::technologyAnswer("Semaphore")), State::UnknownTechnology);
    EXPECT_EQ(stateAfterAnswer(Bytes(3, 'x')), State::UnknownTechnology);
    const std::string_view empty = "<plist version=\"1.0\"><dict/></plist>";
    EXPECT_EQ(stateAfterAnswer(Bytes(empty.begin(), empty.end())), State::UnknownTechnology);
}

TEST_F(KelvoModelConnection, KnowsWhenTheLastRecordCame) {
    startLte();
    EXPECT_EQ(model->connection().state, State::NoRecordYet);
    queue.advance(3s);
    EXPECT_EQ(model->connection().state, State::NoRecordYet);
    EXPECT_EQ(model->connection().silence, 3s);
    deliver(servingCell(301));
    EXPECT_EQ(model->connection().state, State::Receiving);
    EXPECT_EQ(model->connection().silence, 0s);
    queue.advance(7s);
    EXPECT_EQ(model->connection().silence, 7s);
    deliver(servingCell(301), 7);  // no record: its id is another
    EXPECT_EQ(model->connection().silence, 7s);
    model->restartMonitor();
    EXPECT_EQ(model->connection().state, State::NoRecordYet);
    EXPECT_EQ(model->connection().silence, 0s);
}

TEST_F(KelvoModelConnection, TellsFromTheQueueWhenItComes) {
    startLte();
    EXPECT_EQ(told, Texts());
    queue.run();
    EXPECT_EQ(told, Texts{"Waiting for the modem"});
    queue.advance(2s);
    EXPECT_EQ(told.size(), 1U);
    deliver(servingCell(301));
    queue.advance(2s);
    EXPECT_EQ(told, (Texts{"Waiting for the modem", ""}));
}

TEST_F(KelvoModelConnection, TellsOnceWhatKeepsItFromComing) {
    telephony.reachable = false;
    model->restartMonitor();
    queue.advance(100s);
    EXPECT_EQ(told, Texts{"No telephony service is running"});
    telephony.reachable = true;
    ports.taken.insert(kLocalPort);
    queue.advance(100s);
    EXPECT_EQ(told, (Texts{"No telephony service is running", "Kelvo is already open"}));
}

TEST_F(KelvoModelConnection, TellsAtEveryTickOfASilenceAndWhenItEnds) {
    startLte();
    deliver(servingCell(301));
    queue.advance(8s);
    told.clear();
    queue.advance(6s);
    EXPECT_EQ(told, (Texts{"No records for 10 s", "No records for 12 s", "No records for 14 s"}));
    deliver(servingCell(301));
    told.clear();
    queue.advance(2s);
    EXPECT_EQ(told, Texts{""});
}

TEST_F(KelvoModelConnection, TellsNobodyAfterItsEnd) {
    startLte();
    model.reset();
    queue.advance(60s);
    EXPECT_EQ(told, Texts());
}

TEST_F(KelvoModelConnection, NeedsNobodyToTell) {
    KelvoModel alone({.queue = queue, .ports = ports, .telephony = telephony, .updateViewControllerFromModel = [] {}});
    ports.onRequest = test::speaking(kLte);
    alone.restartMonitor();
    queue.advance(60s);
    EXPECT_EQ(connectionText(alone.connection()), "No records for 60 s");
}

}  // namespace
}  // namespace kelvo
