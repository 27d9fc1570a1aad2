#include "platform/encodings/PropertyList.h"
#include "tests/model/MonitoredModel.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using Error = RemotePort::Error;

Bytes bytes(std::string_view text) {
    const ByteView view = bytesOf(text);
    return {view.begin(), view.end()};
}

class KelvoModelStart : public test::MonitoredModel {
protected:
    /// Starts a new model into a failure: nothing is left behind, and the next try comes after five seconds, not
    /// before.
    Texts errorsOfFailedStart() {
        model = newModel();
        model->restartMonitor();
        EXPECT_FALSE(model->isConnected());
        EXPECT_EQ(ports.openLocals(), 0U);
        EXPECT_EQ(ports.openRemotes(), 0U);
        EXPECT_EQ(telephony.openConnections, 0);
        Texts texts = errors();
        queue.advance(5s - 1ns);
        EXPECT_EQ(errors(), Texts());
        queue.advance(1ns);
        EXPECT_EQ(errors(), texts);
        return texts;
    }
    /// The same for a technology query that is answered with `answer`.
    Texts errorsOfAnswer(const test::FakePorts::Answer& answer) {
        ports.onRequest = [answer](const test::FakePorts::Sent&) { return answer; };
        Texts texts = errorsOfFailedStart();
        EXPECT_EQ(texts.front(), " ***** Created ports (send=%p, recv=%p)");
        EXPECT_EQ(texts.back(), "No log generator technology works");
        return {texts.begin() + 1, texts.end() - 1};
    }
};

TEST_F(KelvoModelStart, DoesNotConnectBeforeItIsTold) {
    queue.advance(60s);
    EXPECT_FALSE(model->isConnected());
    EXPECT_TRUE(telephony.askedFor.empty());
    EXPECT_TRUE(log.lines().empty());
}

TEST_F(KelvoModelStart, AsksForALogChannelToItsPort) {
    ports.onRequest = test::speaking(kLte);
    model->restartMonitor();
    EXPECT_STREQ(KelvoModel::kLogChannelPortName, "com.zorvik.BasebandStateReport.LogChannel");
    EXPECT_EQ(telephony.askedFor, Texts{"com.zorvik.BasebandStateReport.LogChannel"});
    EXPECT_NE(ports.local("com.zorvik.BasebandStateReport.LogChannel"), nullptr);
    EXPECT_EQ(telephony.openConnections, 0);  // released at once
    EXPECT_TRUE(model->isConnected());
}

TEST_F(KelvoModelStart, UsesThePortNameItIsGiven) {
    KelvoModel second({.queue = queue,
                       .ports = ports,
                       .telephony = telephony,
                       .updateViewControllerFromModel = [] {},
                       .portName = "another.watcher"});
    ports.onRequest = test::speaking(kLte);
    second.restartMonitor();
    EXPECT_EQ(telephony.askedFor, Texts{"another.watcher"});
    EXPECT_NE(ports.local("another.watcher"), nullptr);
}

TEST_F(KelvoModelStart, TellsTheTwoPortsApart) {
    ports.onRequest = test::speaking(kLte);
    model->restartMonitor();
    const std::string receiving = fmt::sprintf("recv=%p)", static_cast<const void*>(ports.local(kLocalPort)));
    const std::string invalidated =
        fmt::sprintf(" ***** INVALIDATED %p *****", static_cast<const void*>(ports.local(kLocalPort)));
    ports.killPeer();
    queue.advance(2s);
    std::vector<std::string> addressed;
    for (const auto& [level, text] : log.lines()) {
        if (text.ends_with(receiving) || text == invalidated) addressed.push_back(withoutAddresses(text));
    }
    EXPECT_EQ(addressed, (Texts{" ***** Created ports (send=%p, recv=%p)", " ***** INVALIDATED %p *****"}));
}

TEST_F(KelvoModelStart, LogsItsWayToTheStream) {
    ports.onRequest = test::speaking(kLte);
    model->restartMonitor();
    Texts texts = errors();
    ASSERT_GE(texts.size(), 3U);
    EXPECT_EQ(texts.front(), " ***** Created ports (send=%p, recv=%p)");
    EXPECT_EQ(texts[texts.size() - 2], "Got log generated: %p");
    EXPECT_EQ(texts.back(), "Starting the display update timer");
}

TEST_F(KelvoModelStart, SendsTheTechnologyQueryAndWaitsASecondForItsReply) {
    ports.onRequest = test::speaking(kLte);
    model->restartMonitor();
    ASSERT_EQ(ports.sent.size(), 2U);
    const test::FakePorts::Sent& query = ports.sent[0];
    EXPECT_EQ(query.portName, "service");
    EXPECT_EQ(query.id, 0);
    EXPECT_EQ(query.sendLimit, 1s);
    EXPECT_EQ(query.replyLimit, 1s);
    EXPECT_TRUE(textOf(query.data).starts_with("<?xml"));
    const Result<Value> content = readPropertyList(query.data);
    ASSERT_TRUE(content);
    EXPECT_EQ(*content, Value(Dictionary::make({{"GetTechnology", "GetTechnology"}})));
}

TEST_F(KelvoModelStart, SendsTheStartCommandWithoutWaitingForAReply) {
    ports.onRequest = test::speaking(kLte);
    model->restartMonitor();
    ASSERT_EQ(ports.sent.size(), 2U);
    const test::FakePorts::Sent& command = ports.sent[1];
    EXPECT_EQ(command.portName, "service");
    EXPECT_EQ(command.id, 0);
    EXPECT_EQ(command.sendLimit, 1s);
    EXPECT_EQ(command.replyLimit, std::nullopt);
    EXPECT_TRUE(textOf(command.data).starts_with("<?xml"));
    const Result<Value> content = readPropertyList(command.data);
    ASSERT_TRUE(content && content->dictionary());
    const Dictionary& entries = *content->dictionary();
    EXPECT_EQ(entries.size(), 3U);
    EXPECT_EQ(entries["SetState"], Value("Streaming"));
    EXPECT_TRUE(entries["SetOskraLogCodes"].array());
    EXPECT_TRUE(entries["SetPlExtraCodes"].array());
}

TEST_F(KelvoModelStart, RetriesWhenNoLocalPortCanBeMade) {
    ports.refusesLocalPorts = true;
    EXPECT_EQ(errorsOfFailedStart(),
              (Texts{"Could not create local message port", "Could not create the ports necessary"}));
    EXPECT_TRUE(telephony.askedFor.empty());
}

TEST_F(KelvoModelStart, RetriesWhileASecondInstanceHoldsThePortName) {
    ports.taken.insert(kLocalPort);
    EXPECT_EQ(errorsOfFailedStart(),
              (Texts{"Local messsage port already exists", "Could not create the ports necessary"}));
    ports.taken.clear();
    ports.onRequest = test::speaking(kLte);
    queue.advance(5s);
    EXPECT_TRUE(model->isConnected());
}

TEST_F(KelvoModelStart, RetriesWithoutATelephonyServer) {
    telephony.reachable = false;
    EXPECT_EQ(errorsOfFailedStart(),
              (Texts{"Could not create PLServerConnection", "Could not create the ports necessary"}));
}

TEST_F(KelvoModelStart, RetriesWhenTheLogChannelIsRefused) {
    telephony.answer = {.error = {.domain = 1, .error = 45}, .portName = "service"};
    EXPECT_EQ(errorsOfFailedStart(), (Texts{"_PLServerConnectionNetworkMonitorCreateLogChannel returns error: 45!",
                                            "Could not create the ports necessary"}));
}

TEST_F(KelvoModelStart, TakesAnErrorPairForAnErrorByItsSecondPartAlone) {
    telephony.answer = {.error = {.domain = 1, .error = 0}, .portName = "service"};
    ports.onRequest = test::speaking(kLte);
    model->restartMonitor();
    EXPECT_TRUE(model->isConnected());
}

TEST_F(KelvoModelStart, RetriesWhenTheLogChannelHasNoName) {
    telephony.answer = {.error = {}, .portName = ""};
    EXPECT_EQ(errorsOfFailedStart(), (Texts{"Could not create a log channel (PL returned null port)!",
                                            "Could not create the ports necessary"}));
}

TEST_F(KelvoModelStart, RetriesWhenNobodyListensOnTheLogChannel) {
    telephony.answer = {.error = {}, .portName = "gone"};
    EXPECT_EQ(errorsOfFailedStart(),
              (Texts{"Could not create the remote port!", "Could not create the ports necessary"}));
}

TEST_F(KelvoModelStart, RetriesWhenTheQueryCannotBeSent) {
    EXPECT_EQ(errorsOfAnswer(Error::SendTimedOut),
              Texts{" ***** Could not send the GetTechnology command (got error=-1)"});
    EXPECT_EQ(errorsOfAnswer(Error::Invalid), Texts{" ***** Could not send the GetTechnology command (got error=-3)"});
}

TEST_F(KelvoModelStart, RetriesWhenTheServiceNeverAnswersTheQuery) {
    EXPECT_EQ(errorsOfAnswer(Error::ReplyTimedOut),
              Texts{" ***** Could not send the GetTechnology command (got error=-2)"});
    EXPECT_EQ(queries(), ports.sent.size());  // no start command
}

TEST_F(KelvoModelStart, RetriesOnAnEmptyReply) {
    EXPECT_EQ(errorsOfAnswer(Bytes()), Texts{" ***** No response to GetTechnology; cannot configure"});
}

TEST_F(KelvoModelStart, RetriesOnAReplyThatDoesNotParse) {
    EXPECT_EQ(errorsOfAnswer(bytes("<plist><dict>")),
              Texts{" ***** Could not parse reply to GetTechnology; cannot configure"});
}

TEST_F(KelvoModelStart, RetriesOnAReplyWithoutAnAnswer) {
    const Texts expected = {" ***** Reply to GetTechnology had no answer; cannot configure"};
    EXPECT_EQ(errorsOfAnswer(bytes("<plist version=\"1.0\"><dict/></plist>")), expected);
    EXPECT_EQ(errorsOfAnswer(bytes("<plist version=\"1.0\"><string>GetTechnology</string></plist>")), expected);
}

TEST_F(KelvoModelStart, RetriesOnATechnologyItDoesNotKnow) {
    const Texts expected = {"Got log generated: (nil)"};
    EXPECT_EQ(errorsOfAnswer(test::technologyAnswer("Semaphore")), expected);
    EXPECT_EQ(errorsOfAnswer(test::technologyAnswer("")), expected);
    EXPECT_EQ(errorsOfAnswer(bytes("<plist version=\"1.0\"><dict><key>GetTechnology</key><integer>3</integer>"
                                   "</dict></plist>")),
              expected);
}

TEST_F(KelvoModelStart, TakesAnAnswerThatSaysMore) {
    ports.onRequest = [](const test::FakePorts::Sent& message) -> test::FakePorts::Answer {
        if (!message.replyLimit) return Bytes();
        return bytes(
            "<plist version=\"1.0\"><dict><key>Version</key><integer>2</integer><key>GetTechnology</key>"
            "<string>kPLLogChannelTechnology_Oskra_LTE</string></dict></plist>");
    };
    model->restartMonitor();
    EXPECT_TRUE(model->isConnected());
}

TEST_F(KelvoModelStart, RetriesWhenTheStartCommandCannotBeSent) {
    ports.onRequest = [](const test::FakePorts::Sent& message) -> test::FakePorts::Answer {
        if (message.replyLimit) return test::technologyAnswer(kLte);
        return Error::SendTimedOut;
    };
    const Texts texts = errorsOfFailedStart();
    EXPECT_EQ(texts.back(), " ***** Could not send the START command (got error=-1)");
    EXPECT_EQ(std::count(texts.begin(), texts.end(), "Starting the display update timer"), 0);
}

/// Encodes every message but those that have `key`.
auto encodesAllBut(const char* key) {
    return [key](const Value& message) -> Result<Bytes> {
        if (message.dictionary()->find(key) != nullptr) return Failure{"not today"};
        return writeXmlPropertyList(message);
    };
}

TEST_F(KelvoModelStart, RetriesWhenTheQueryCannotBeEncoded) {
    ports.onRequest = test::speaking(kLte);
    encode = encodesAllBut("GetTechnology");
    EXPECT_EQ(errorsOfFailedStart(), (Texts{" ***** Created ports (send=%p, recv=%p)",
                                            " Could not generate GetTechnology command; cannot configure",
                                            "No log generator technology works"}));
    EXPECT_TRUE(ports.sent.empty());
}

TEST_F(KelvoModelStart, RetriesWhenTheStartCommandCannotBeEncoded) {
    ports.onRequest = test::speaking(kLte);
    encode = encodesAllBut("SetState");
    const Texts texts = errorsOfFailedStart();
    EXPECT_EQ(texts.back(), " Could not generate PLIST");
    EXPECT_EQ(ports.sent.size(), queries());  // the query alone, at each try
}

TEST_F(KelvoModelStart, RetriesWithoutLimitAndWithoutBackingOff) {
    telephony.reachable = false;
    model->restartMonitor();
    queue.advance(500s);
    EXPECT_EQ(errors().size(), 2U * 101U);
    telephony.reachable = true;
    ports.onRequest = test::speaking(kLte);
    queue.advance(5s);
    EXPECT_TRUE(model->isConnected());
    queue.advance(60s);
    EXPECT_EQ(queries(), 1U);
}

TEST_F(KelvoModelStart, DoesNothingWhileItRuns) {
    startLte();
    model->startMonitor();
    EXPECT_TRUE(log.lines().empty());
    EXPECT_TRUE(ports.sent.empty());
}

TEST_F(KelvoModelStart, LeavesARetryThatHasBecomeNeedlessWithoutEffect) {
    telephony.reachable = false;
    model->restartMonitor();
    telephony.reachable = true;
    startLte();
    queue.advance(60s);
    EXPECT_TRUE(ports.sent.empty());
    EXPECT_TRUE(model->isConnected());
}

TEST_F(KelvoModelStart, IgnoresARetryAfterItsEnd) {
    telephony.reachable = false;
    model->restartMonitor();
    model.reset();
    errors();
    queue.advance(60s);
    EXPECT_TRUE(log.lines().empty());
}

TEST_F(KelvoModelStart, KeepsTheGeneratorOfAnEarlierAnswerWhenTheQueryFails) {
    startLte();
    ports.onRequest = [](const test::FakePorts::Sent& message) -> test::FakePorts::Answer {
        if (message.replyLimit) return Error::ReplyTimedOut;
        return Bytes();
    };
    model->restartMonitor();
    EXPECT_TRUE(model->isConnected());
    EXPECT_EQ(errors(), (Texts{" ***** Created ports (send=%p, recv=%p)",
                               " ***** Could not send the GetTechnology command (got error=-2)",
                               "Starting the display update timer"}));
    EXPECT_EQ(ports.sent.size(), 2U);
}

TEST_F(KelvoModelStart, LosesTheGeneratorToAnAnswerItDoesNotKnow) {
    startLte();
    ports.onRequest = test::speaking("Semaphore");
    model->restartMonitor();
    EXPECT_FALSE(model->isConnected());
    EXPECT_EQ(errors(), (Texts{" ***** Created ports (send=%p, recv=%p)", "Got log generated: (nil)",
                               "No log generator technology works"}));
}

TEST_F(KelvoModelStart, ReplacesAGeneratorWithoutReleasingIt) {
    startLte();
    model->restartMonitor();
    EXPECT_TRUE(model->isConnected());
    EXPECT_EQ(output.text(), "");
    model.reset();
    EXPECT_EQ(output.text(),
              "Deallocing LTEClassIndex\nDeallocing ClassIndex\n"
              "Deallocing LTEClassIndex\nDeallocing ClassIndex\n");
}

}  // namespace
}  // namespace kelvo
