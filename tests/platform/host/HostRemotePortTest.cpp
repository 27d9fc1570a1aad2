#include <gtest/gtest.h>

#include <QThread>
#include <atomic>
#include <thread>

#include "platform/host/HostMessagePorts.h"
#include "platform/system/Environment.h"
#include "tests/platform/host/RawPort.h"
#include "tests/support/EventLoop.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"

using namespace kelvo;
using namespace std::chrono_literals;
using test::datagram;
using test::rawReceive;
using test::rawSend;
using test::runUntil;
using test::settle;
using Error = RemotePort::Error;

namespace {

using Lines = std::vector<test::RecordingLog::Line>;

class HostRemotePortTest : public testing::Test {
protected:
    void SetUp() override {
        (void)_ports.openRemote("peer");  // makes the directory
        _listener = test::rawListen(_directory / "peer.port");
        _remote = _ports.openRemote("peer");
        ASSERT_TRUE(_remote);
        _peer = UniqueFd(::accept(_listener.get(), nullptr, nullptr));
    }
    Result<Bytes, Error> ask(std::string_view text, std::chrono::nanoseconds replyLimit = 10s) {
        return _remote->request(0, bytesOf(text), 1s, replyLimit);
    }

    test::TemporaryDirectory _temporary;
    std::filesystem::path _directory = _temporary.path() / "ports";
    HostMessagePorts _ports{_directory};
    test::RecordingLog _log;
    Environment::Scope _scope{Environment{.log = &_log}};
    UniqueFd _listener;
    UniqueFd _peer;
    std::unique_ptr<RemotePort> _remote;
};

}  // namespace

TEST_F(HostRemotePortTest, SendsWithoutWaitingWhenNoReplyIsAskedFor) {
    const auto sent = _remote->request(-2, bytesOf("go"), 0s, std::nullopt);
    ASSERT_TRUE(sent);
    EXPECT_TRUE(sent->empty());
    EXPECT_EQ(rawReceive(_peer), datagram(1, 0, -2, 1, "go"));
}

TEST_F(HostRemotePortTest, WaitsForItsReplyAndIgnoresOlderOnes) {
    ASSERT_TRUE(_remote->request(0, bytesOf("one"), 0s, std::nullopt));
    std::thread peer([&] {
        EXPECT_EQ(rawReceive(_peer), datagram(1, 0, 0, 1, "one"));
        EXPECT_EQ(rawReceive(_peer), datagram(1, 1, 0, 2, "two"));
        rawSend(_peer, datagram(2, 0, 0, 1, "late answer to one"));
        rawSend(_peer, datagram(2, 0, 0, 2, "answer to two"));
    });
    const auto reply = ask("two");
    peer.join();
    ASSERT_TRUE(reply);
    EXPECT_EQ(textOf(*reply), "answer to two");
    EXPECT_TRUE(_log.lines().empty());
}

TEST_F(HostRemotePortTest, TakesAnEmptyReply) {
    std::thread peer([&] {
        rawReceive(_peer);
        rawSend(_peer, datagram(2, 0, 0, 1, ""));
    });
    const auto reply = ask("?");
    peer.join();
    ASSERT_TRUE(reply);
    EXPECT_TRUE(reply->empty());
}

TEST_F(HostRemotePortTest, GivesUpOnAReplyAndIgnoresItWhenItComesAfterAll) {
    const auto timedOut = ask("slow", 1ms);
    ASSERT_FALSE(timedOut);
    EXPECT_EQ(timedOut.error(), Error::ReplyTimedOut);
    EXPECT_TRUE(_remote->isValid());
    rawSend(_peer, datagram(2, 0, 0, 1, "too late"));
    rawSend(_peer, datagram(2, 0, 0, 2, "in time"));
    const auto reply = ask("again");
    ASSERT_TRUE(reply);
    EXPECT_EQ(textOf(*reply), "in time");
}

TEST_F(HostRemotePortTest, SkipsGarbageAmongRepliesWithOneLineEach) {
    rawSend(_peer, Bytes{1, 2, 3});
    rawSend(_peer, datagram(1, 0, 0, 1, "no reply"));
    rawSend(_peer, datagram(2, 0, 0, 1, std::string(kMaxMessageSize + 1, 'x')));
    rawSend(_peer, datagram(2, 0, 0, 1, "answer"));
    const auto reply = ask("?");
    ASSERT_TRUE(reply);
    EXPECT_EQ(textOf(*reply), "answer");
    EXPECT_EQ(_log.lines(), (Lines{{3, "Port peer dropped a reply: it is shorter than a header"},
                                   {3, "Port peer dropped a reply: it is too long"}}));
}

TEST_F(HostRemotePortTest, DropsWhatComesUnaskedAndTellsOfGarbage) {
    rawSend(_peer, datagram(2, 0, 0, 1, "late"));
    rawSend(_peer, Bytes{1, 2, 3});
    rawSend(_peer, datagram(2, 0, 0, 1, "later"));
    ASSERT_TRUE(runUntil([&] { return !_log.lines().empty(); }));
    settle();
    EXPECT_EQ(_log.lines(), (Lines{{3, "Port peer dropped a reply: it is shorter than a header"}}));
    EXPECT_TRUE(_remote->isValid());
    ASSERT_FALSE(ask("?", 1ms));  // nothing of it is an answer to this
}

TEST_F(HostRemotePortTest, EndsTheWaitInTimeUnderAFloodOfStaleReplies) {
    std::atomic<bool> stop = false;
    std::thread peer([&] {
        while (!stop)
            if (!rawSend(_peer, datagram(2, 0, 0, 999, "flood"))) std::this_thread::yield();
    });
    const auto reply = ask("?", 20ms);
    stop = true;
    peer.join();
    ASSERT_FALSE(reply);
    EXPECT_EQ(reply.error(), Error::ReplyTimedOut);
}

TEST_F(HostRemotePortTest, IsInvalidAtOnceWhenThePeerDiesDuringTheWait) {
    std::thread peer([&] {
        rawReceive(_peer);
        _peer.reset();
    });
    const auto begin = std::chrono::steady_clock::now();
    const auto reply = ask("?", 600s);
    peer.join();
    ASSERT_FALSE(reply);
    EXPECT_EQ(reply.error(), Error::Invalid);
    EXPECT_LT(std::chrono::steady_clock::now() - begin, 60s);
    EXPECT_FALSE(_remote->isValid());
}

TEST_F(HostRemotePortTest, StillGivesTheReplyOfAPeerThatDiedAfterIt) {
    rawSend(_peer, datagram(2, 0, 0, 1, "last words"));
    std::thread peer([&] {
        rawReceive(_peer);
        _peer.reset();
    });
    const auto reply = ask("?");
    peer.join();
    ASSERT_TRUE(reply);
    EXPECT_EQ(textOf(*reply), "last words");
}

TEST_F(HostRemotePortTest, KnowsAtOnceThatThePeerHasGoneAndRaisesNoSignal) {
    EXPECT_TRUE(_remote->isValid());
    _peer.reset();
    EXPECT_FALSE(_remote->isValid());
    const auto sent = _remote->request(0, bytesOf("x"), 1s, std::nullopt);
    ASSERT_FALSE(sent);
    EXPECT_EQ(sent.error(), Error::Invalid);
    EXPECT_FALSE(_remote->isValid());
}

TEST_F(HostRemotePortTest, KnowsThatAListenerDiedBeforeItAccepted) {
    auto second = _ports.openRemote("peer");
    ASSERT_TRUE(second);
    ASSERT_TRUE(second->request(0, bytesOf("x"), 0s, std::nullopt));
    _listener.reset();
    EXPECT_FALSE(second->isValid());
}

TEST_F(HostRemotePortTest, CallsItsInvalidationCallbackOnceFromTheQueue) {
    int told = 0;
    _remote->setInvalidationCallback([&](RemotePort& port) {
        EXPECT_EQ(&port, _remote.get());
        EXPECT_FALSE(port.isValid());
        ++told;
        _remote.reset();
    });
    _peer.reset();
    EXPECT_FALSE(_remote->isValid());
    EXPECT_EQ(told, 0);
    ASSERT_TRUE(runUntil([&] { return told == 1; }));
    settle();
    EXPECT_EQ(told, 1);
}

TEST_F(HostRemotePortTest, CallsNoCallbackThatWasRemovedNorWhenDestroyed) {
    int told = 0;
    _remote->setInvalidationCallback([&](RemotePort&) { ++told; });
    _remote->setInvalidationCallback({});
    _remote->invalidate();
    _remote->invalidate();
    EXPECT_FALSE(_remote->isValid());
    EXPECT_EQ(_remote->request(0, {}, 0s, std::nullopt).error(), Error::Invalid);
    auto other = _ports.openRemote("peer");
    other->setInvalidationCallback([&](RemotePort&) { ++told; });
    other.reset();
    settle();
    EXPECT_EQ(told, 0);
}

TEST_F(HostRemotePortTest, RefusesAMessageThatIsTooLongAndSendsNothing) {
    const auto sent = _remote->request(0, Bytes(kMaxMessageSize + 1), 0s, std::nullopt);
    ASSERT_FALSE(sent);
    EXPECT_EQ(sent.error(), Error::TooLong);
    EXPECT_FALSE(test::rawHasData(_peer));
    EXPECT_TRUE(_remote->isValid());
}

TEST_F(HostRemotePortTest, TimesOutOnAPeerThatReadsNothingAndTellsWhenItDoes) {
    int sent = 0;
    bool writable = false;
    const Bytes record(1000, 1);
    Result<Bytes, Error> last = Bytes{};
    while ((last = _remote->request(0, record, 0s, std::nullopt))) ++sent;
    EXPECT_EQ(last.error(), Error::SendTimedOut);
    EXPECT_EQ(_remote->request(0, record, 1ms, 10s).error(), Error::SendTimedOut);
    EXPECT_TRUE(_remote->isValid());
    _remote->notifyWhenWritable([&] { writable = true; });
    settle();
    EXPECT_FALSE(writable);
    for (int i = 0; i < sent; ++i) ASSERT_TRUE(rawReceive(_peer));
    EXPECT_FALSE(test::rawHasData(_peer));  // what timed out was not delivered
    ASSERT_TRUE(runUntil([&] { return writable; }));
    EXPECT_TRUE(_remote->request(0, record, 0s, std::nullopt));
}

TEST_F(HostRemotePortTest, MayBeDestroyedByItsWritableCallback) {
    bool writable = false;
    _remote->notifyWhenWritable([&] {
        _remote.reset();
        writable = true;
    });
    ASSERT_TRUE(runUntil([&] { return writable; }));
    settle();
}

TEST_F(HostRemotePortTest, AsksALocalPortThatRunsOnAnotherEventLoop) {
    const auto local =
        _ports.createLocal("echo", [](std::int32_t, ByteView data) { return Bytes(data.rbegin(), data.rend()); });
    local.port->schedule();
    std::atomic<bool> done = false;
    std::string answer;
    const std::unique_ptr<QThread> client(QThread::create([&] {
        const auto remote = HostMessagePorts(_directory).openRemote("echo");
        for (int i = 0; i < 100; ++i) {
            const auto reply = remote->request(0, bytesOf("abc" + std::to_string(i)), 10s, 10s);
            answer = reply ? std::string(textOf(*reply)) : "none";
        }
        done = true;
    }));
    client->start();
    EXPECT_TRUE(runUntil([&] { return done.load(); }));
    client->wait();
    EXPECT_EQ(answer, "99cba");
}
