#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/socket.h>

#include <QAbstractEventDispatcher>
#include <cstring>
#include <ctime>
#include <vector>

#include "platform/host/HostMessagePorts.h"
#include "platform/system/Environment.h"
#include "tests/platform/host/RawPort.h"
#include "tests/support/EventLoop.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"

using namespace kelvo;
using test::datagram;
using test::rawConnect;
using test::rawReceive;
using test::rawSend;
using test::runUntil;
using test::settle;

namespace {

using Lines = std::vector<test::RecordingLog::Line>;

class HostLocalPortTest : public testing::Test {
protected:
    void open(MessageCallback callback) {
        _port = _ports.createLocal("p", std::move(callback)).port;
        _port->schedule();
    }
    void openRecorder() {
        open([this](std::int32_t, ByteView data) {
            _heard.emplace_back(textOf(data));
            return Bytes{};
        });
    }
    UniqueFd connect() { return rawConnect(_directory / "p.port"); }

    test::TemporaryDirectory _temporary;
    std::filesystem::path _directory = _temporary.path() / "ports";
    HostMessagePorts _ports{_directory};
    test::RecordingLog _log;
    Environment::Scope _scope{Environment{.log = &_log}};
    std::unique_ptr<LocalPort> _port;
    std::vector<std::string> _heard;
};

}  // namespace

TEST_F(HostLocalPortTest, KeepsWhatArrivesBeforeItIsScheduled) {
    _port = _ports
                .createLocal("p",
                             [&](std::int32_t, ByteView data) {
                                 _heard.emplace_back(textOf(data));
                                 return Bytes{};
                             })
                .port;
    const UniqueFd sender = connect();
    ASSERT_TRUE(rawSend(sender, datagram(1, 0, 0, 1, "early")));
    settle();
    EXPECT_TRUE(_heard.empty());
    _port->schedule();
    ASSERT_TRUE(runUntil([&] { return _heard.size() == 1; }));
    EXPECT_EQ(_heard[0], "early");
}

TEST_F(HostLocalPortTest, RepliesToASenderThatWaitsAndOnlyToThat) {
    open([](std::int32_t id, ByteView data) {
        Bytes reply(data.begin(), data.end());
        reply.push_back(static_cast<std::uint8_t>('0' + id));
        return reply;
    });
    const UniqueFd sender = connect();
    ASSERT_TRUE(rawSend(sender, datagram(1, 0, 1, 10, "silent")));
    ASSERT_TRUE(rawSend(sender, datagram(1, 1, 2, 11, "asked")));
    ASSERT_TRUE(runUntil([&] { return test::rawHasData(sender); }));
    EXPECT_EQ(rawReceive(sender), datagram(2, 0, 2, 11, "asked2"));
    settle();
    EXPECT_FALSE(test::rawHasData(sender));
}

TEST_F(HostLocalPortTest, CarriesTheLongestMessageAndAnEmptyOne) {
    std::vector<std::size_t> sizes;
    open([&](std::int32_t, ByteView data) {
        sizes.push_back(data.size());
        return Bytes{};
    });
    auto remote = _ports.openRemote("p");
    ASSERT_TRUE(remote->request(0, Bytes(kMaxMessageSize, 0x5A), {}, std::nullopt));
    ASSERT_TRUE(remote->request(0, {}, {}, std::nullopt));
    ASSERT_TRUE(runUntil([&] { return sizes.size() == 2; }));
    EXPECT_EQ(sizes, (std::vector<std::size_t>{131072, 0}));
}

TEST_F(HostLocalPortTest, DropsMalformedDatagramsWithOneLineEachAndGoesOn) {
    openRecorder();
    const UniqueFd sender = connect();
    Bytes wrongMagic = datagram(1, 0, 0, 1, "x");
    wrongMagic[0] ^= 1;
    Bytes reserved = datagram(1, 0, 0, 1, "x");
    reserved[6] = 1;
    Bytes wrongLength = datagram(1, 0, 0, 1, "x");
    wrongLength[16] = 2;
    for (const Bytes& bad : {wrongMagic, reserved, wrongLength, datagram(3, 0, 0, 1, "x"), datagram(1, 2, 0, 1, "x"),
                             datagram(2, 0, 0, 1, "x"), Bytes(19, 0), Bytes{},
                             datagram(1, 0, 0, 1, std::string(kMaxMessageSize + 1, 'x'))})
        ASSERT_TRUE(rawSend(sender, bad));
    ASSERT_TRUE(rawSend(sender, datagram(1, 0, 0, 2, "good")));
    ASSERT_TRUE(runUntil([&] { return !_heard.empty(); }));
    EXPECT_EQ(_heard, std::vector<std::string>{"good"});
    EXPECT_EQ(_log.lines(), (Lines{{3, "Port p dropped a message: it has an unknown format"},
                                   {3, "Port p dropped a message: it has an unknown format"},
                                   {3, "Port p dropped a message: its length is wrong"},
                                   {3, "Port p dropped a message: it is of unknown kind"},
                                   {3, "Port p dropped a message: it has unknown flags"},
                                   {3, "Port p dropped a message: nobody waits for a reply"},
                                   {3, "Port p dropped a message: it is shorter than a header"},
                                   {3, "Port p dropped a message: it is shorter than a header"},
                                   {3, "Port p dropped a message: it is too long"}}));
}

TEST_F(HostLocalPortTest, OutlivesRandomBytes) {
    openRecorder();
    const UniqueFd noisy = connect();
    std::uint32_t state = 12345;
    const auto random = [&state] { return state = state * 1664525U + 1013904223U; };
    for (int i = 0; i < 500; ++i) {
        Bytes bytes(random() % 200);
        for (std::uint8_t& byte : bytes) byte = static_cast<std::uint8_t>(random() >> 24);
        ASSERT_TRUE(runUntil([&] { return rawSend(noisy, bytes); }));
    }
    const UniqueFd sender = connect();
    ASSERT_TRUE(rawSend(sender, datagram(1, 0, 0, 1, "good")));
    ASSERT_TRUE(runUntil([&] { return !_heard.empty() && _log.lines().size() == 500; }));
    EXPECT_EQ(_heard, std::vector<std::string>{"good"});
}

TEST_F(HostLocalPortTest, TakesNoDescriptorsAlongWithAMessage) {
    openRecorder();
    const UniqueFd sender = connect();
    int ends[2];
    ASSERT_EQ(::pipe2(ends, O_CLOEXEC | O_NONBLOCK), 0);
    const UniqueFd readEnd(ends[0]);
    UniqueFd writeEnd(ends[1]);
    Bytes bytes = datagram(1, 0, 0, 1, "gift");
    iovec part{bytes.data(), bytes.size()};
    alignas(cmsghdr) char control[CMSG_SPACE(sizeof(int))] = {};
    msghdr message{};
    message.msg_iov = &part;
    message.msg_iovlen = 1;
    message.msg_control = control;
    message.msg_controllen = sizeof control;
    cmsghdr* gift = CMSG_FIRSTHDR(&message);
    gift->cmsg_level = SOL_SOCKET;
    gift->cmsg_type = SCM_RIGHTS;
    gift->cmsg_len = CMSG_LEN(sizeof(int));
    std::memcpy(CMSG_DATA(gift), &ends[1], sizeof(int));
    ASSERT_GT(::sendmsg(sender.get(), &message, 0), 0);
    ASSERT_TRUE(runUntil([&] { return _heard.size() == 1; }));
    writeEnd.reset();  // the only one, if none was taken
    char byte = 0;
    EXPECT_EQ(::read(readEnd.get(), &byte, 1), 0);
}

TEST_F(HostLocalPortTest, TakesABoundedNumberOfMessagesPerTurn) {
    openRecorder();
    const UniqueFd sender = connect();
    for (int i = 0; i < 500; ++i) ASSERT_TRUE(rawSend(sender, datagram(1, 0, 0, 1, "m")));
    std::size_t most = 0;
    while (_heard.size() < 500) {
        const std::size_t before = _heard.size();
        QCoreApplication::sendPostedEvents();
        QCoreApplication::eventDispatcher()->processEvents(QEventLoop::AllEvents);
        most = std::max(most, _heard.size() - before);
    }
    EXPECT_LE(most, 256U);
}

TEST_F(HostLocalPortTest, LetsNoSenderStarveAnother) {
    openRecorder();
    const UniqueFd loud = connect();
    for (int i = 0; i < 500; ++i) ASSERT_TRUE(rawSend(loud, datagram(1, 0, 0, 1, "loud")));
    const UniqueFd quiet = connect();
    ASSERT_TRUE(rawSend(quiet, datagram(1, 0, 0, 1, "quiet")));
    ASSERT_TRUE(runUntil([&] { return _heard.size() == 501; }));
    const auto place = std::find(_heard.begin(), _heard.end(), "quiet");
    EXPECT_LT(place - _heard.begin(), 300);  // the loud one has got a share of its 500 messages through
}

TEST_F(HostLocalPortTest, MayBeDestroyedByItsOwnMessage) {
    open([this](std::int32_t, ByteView data) {
        _heard.emplace_back(textOf(data));
        _port.reset();
        return Bytes{1};
    });
    const UniqueFd sender = connect();
    ASSERT_TRUE(rawSend(sender, datagram(1, 1, 0, 1, "first")));
    ASSERT_TRUE(rawSend(sender, datagram(1, 1, 0, 2, "second")));
    ASSERT_TRUE(runUntil([&] { return _port == nullptr; }));
    settle();
    EXPECT_EQ(_heard, std::vector<std::string>{"first"});
    EXPECT_FALSE(rawReceive(sender));  // the connection ended without an answer
}

TEST_F(HostLocalPortTest, MayBeInvalidatedByItsOwnMessageAndTellsOnce) {
    int told = 0;
    open([this](std::int32_t, ByteView data) {
        _heard.emplace_back(textOf(data));
        _port->invalidate();
        return Bytes{};
    });
    _port->setInvalidationCallback([&](LocalPort& port) {
        EXPECT_EQ(&port, _port.get());
        EXPECT_FALSE(port.isValid());
        ++told;
        _port.reset();
    });
    const UniqueFd sender = connect();
    ASSERT_TRUE(rawSend(sender, datagram(1, 0, 0, 1, "a")));
    ASSERT_TRUE(rawSend(sender, datagram(1, 0, 0, 2, "b")));
    ASSERT_TRUE(runUntil([&] { return told == 1; }));
    settle();
    EXPECT_EQ(_heard, std::vector<std::string>{"a"});
}

TEST_F(HostLocalPortTest, CallsNoCallbackThatWasRemovedNorWhenDestroyed) {
    int told = 0;
    openRecorder();
    _port->setInvalidationCallback([&](LocalPort&) { ++told; });
    _port->setInvalidationCallback({});
    _port->invalidate();
    _port->invalidate();
    EXPECT_FALSE(_port->isValid());
    _port->schedule();  // has no effect any more
    openRecorder();
    _port->setInvalidationCallback([&](LocalPort&) { ++told; });
    _port.reset();
    EXPECT_EQ(told, 0);
}

TEST_F(HostLocalPortTest, KeepsMessagesInOrderWhenACallbackRunsTheEventLoop) {
    open([this](std::int32_t, ByteView data) {
        const std::string before(textOf(data));
        settle();
        _heard.emplace_back(textOf(data));
        EXPECT_EQ(_heard.back(), before);
        return Bytes{};
    });
    const UniqueFd sender = connect();
    for (const char* text : {"1", "2", "3"}) ASSERT_TRUE(rawSend(sender, datagram(1, 0, 0, 1, text)));
    ASSERT_TRUE(runUntil([&] { return _heard.size() == 3; }));
    EXPECT_EQ(_heard, (std::vector<std::string>{"1", "2", "3"}));
}

TEST_F(HostLocalPortTest, DropsRepliesThatNobodyReadsWithOneLine) {
    int heard = 0;
    open([&](std::int32_t, ByteView) {
        ++heard;
        return Bytes(100'000);
    });
    const UniqueFd sender = connect();
    for (int i = 0; i < 100; ++i) ASSERT_TRUE(rawSend(sender, datagram(1, 1, 0, 1, "")));
    ASSERT_TRUE(runUntil([&] { return heard == 100; }));
    EXPECT_EQ(_log.lines(), (Lines{{3, "Port p dropped a reply: its sender reads none"}}));
}

TEST_F(HostLocalPortTest, SaysWhenAReplyIsTooLong) {
    open([](std::int32_t, ByteView) { return Bytes(kMaxMessageSize + 1); });
    const UniqueFd sender = connect();
    ASSERT_TRUE(rawSend(sender, datagram(1, 1, 0, 1, "")));
    ASSERT_TRUE(runUntil([&] { return !_log.lines().empty(); }));
    EXPECT_EQ(_log.lines(), (Lines{{3, "Port p dropped a reply: it is too long"}}));
}

TEST_F(HostLocalPortTest, RefusesMoreThan64SendersWithOneLineAndServesTheOthers) {
    openRecorder();
    std::vector<UniqueFd> senders;
    for (int i = 0; i < 80; ++i) {
        senders.push_back(connect());
        ASSERT_TRUE(senders.back());
        settle();
    }
    EXPECT_EQ(_log.lines(), (Lines{{3, "Port p has too many senders"}}));
    ASSERT_TRUE(rawSend(senders[63], datagram(1, 0, 0, 1, "last")));
    EXPECT_FALSE(rawSend(senders[64], datagram(1, 0, 0, 1, "refused")));
    ASSERT_TRUE(runUntil([&] { return !_heard.empty(); }));
    senders.clear();
    settle();
    const UniqueFd next = connect();
    ASSERT_TRUE(rawSend(next, datagram(1, 0, 0, 1, "next")));
    ASSERT_TRUE(runUntil([&] { return _heard.size() == 2; }));
}

TEST_F(HostLocalPortTest, WaitsWithoutSpinningWhenDescriptorsRunOut) {
#ifdef KELVO_SANITIZED
    GTEST_SKIP() << "the sanitizers look at objects through a pipe, which needs descriptors itself";
#endif
    openRecorder();
    rlimit before{};
    ASSERT_EQ(::getrlimit(RLIMIT_NOFILE, &before), 0);
    const UniqueFd sender = connect();
    ASSERT_TRUE(rawSend(sender, datagram(1, 0, 0, 1, "patient")));
    const rlimit none{static_cast<rlim_t>(sender.get()) + 1, before.rlim_max};
    ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &none), 0);
    ASSERT_TRUE(runUntil([&] { return !_log.lines().empty(); }));
    const std::clock_t begin = std::clock();
    QCoreApplication::eventDispatcher()->processEvents(QEventLoop::WaitForMoreEvents);  // until the pause is over
    QCoreApplication::eventDispatcher()->processEvents(QEventLoop::WaitForMoreEvents);
    EXPECT_LT(std::clock() - begin, CLOCKS_PER_SEC / 5);
    ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &before), 0);
    ASSERT_TRUE(runUntil([&] { return !_heard.empty(); }));
    EXPECT_EQ(_log.lines(), (Lines{{3, "Port p cannot accept a sender: Too many open files"}}));
}
