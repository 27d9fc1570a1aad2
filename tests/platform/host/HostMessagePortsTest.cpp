#include "platform/host/HostMessagePorts.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <sys/wait.h>

#include <fstream>

#include "platform/host/HostPaths.h"
#include "platform/host/PortSocket.h"
#include "platform/host/PrivateDirectory.h"
#include "platform/system/Environment.h"
#include "tests/platform/host/RawPort.h"
#include "tests/support/EventLoop.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"

namespace fs = std::filesystem;
using namespace kelvo;
using test::runUntil;

namespace {

Bytes noReply(std::int32_t, ByteView) { return {}; }

class HostMessagePortsTest : public testing::Test {
protected:
    test::TemporaryDirectory _temporary;
    fs::path _directory = _temporary.path() / "ports";
    HostMessagePorts _ports{_directory};
    test::RecordingLog _log;
    Environment::Scope _scope{Environment{.log = &_log}};
};

}  // namespace

using HostMessagePortsNames = HostMessagePortsTest;
using HostMessagePortsDirectory = HostMessagePortsTest;

TEST_F(HostMessagePortsNames, MeetTheTwoEnds) {
    std::string heard;
    auto local = _ports.createLocal("com.zorvik.test", [&](std::int32_t id, ByteView data) {
        heard = std::to_string(id) + ":" + std::string(textOf(data));
        return Bytes{};
    });
    ASSERT_TRUE(local.port);
    EXPECT_FALSE(local.alreadyExisted);
    EXPECT_EQ(local.port->name(), "com.zorvik.test");
    local.port->schedule();
    auto remote = _ports.openRemote("com.zorvik.test");
    ASSERT_TRUE(remote);
    ASSERT_TRUE(remote->request(-7, bytesOf("hello"), {}, std::nullopt));
    ASSERT_TRUE(runUntil([&] { return !heard.empty(); }));
    EXPECT_EQ(heard, "-7:hello");
    EXPECT_TRUE(_log.lines().empty());
}

TEST_F(HostMessagePortsNames, SayThatALiveOwnerHasTheName) {
    const auto first = _ports.createLocal("taken", noReply);
    const auto second = _ports.createLocal("taken", noReply);
    EXPECT_TRUE(first.port);
    EXPECT_FALSE(second.port);
    EXPECT_TRUE(second.alreadyExisted);
    EXPECT_EQ(second.owner, ::getpid());
}

TEST_F(HostMessagePortsNames, AreFreeAgainAfterInvalidationAndLeaveNoFiles) {
    auto first = _ports.createLocal("again", noReply);
    first.port->invalidate();
    EXPECT_TRUE(fs::is_empty(_directory));
    EXPECT_TRUE(_ports.createLocal("again", noReply).port);
    EXPECT_TRUE(fs::is_empty(_directory));
}

TEST_F(HostMessagePortsNames, OfADeadOwnerAreRecovered) {
    const pid_t child = ::fork();
    if (child == 0) {
        const auto left = _ports.createLocal("orphan", noReply);
        ::_exit(left.port ? 0 : 1);  // without removing anything
    }
    int status = -1;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    ASSERT_EQ(status, 0);
    ASSERT_TRUE(fs::exists(_directory / "orphan.port"));
    EXPECT_FALSE(_ports.openRemote("orphan"));
    const auto recovered = _ports.createLocal("orphan", noReply);
    ASSERT_TRUE(recovered.port);
    EXPECT_TRUE(_ports.openRemote("orphan"));
}

TEST_F(HostMessagePortsNames, OfASocketThatSomebodyListensOnAreTaken) {
    auto owner = PortClaim::take(openPrivateDirectory(_directory).value(), "held");
    ASSERT_TRUE(owner);
    fs::remove(_directory / "held.lock");  // as before a service manager has started anybody
    const auto refused = _ports.createLocal("held", noReply);
    EXPECT_FALSE(refused.port);
    EXPECT_TRUE(refused.alreadyExisted);
    EXPECT_TRUE(fs::exists(_directory / "held.port"));
    EXPECT_FALSE(fs::exists(_directory / "held.lock"));
}

TEST_F(HostMessagePortsNames, OfASocketThatWasPassedServeItAndLeaveItBehind) {
    const auto holder = PortClaim::take(openPrivateDirectory(_directory).value(), "held");
    ASSERT_TRUE(holder);
    fs::remove(_directory / "held.lock");
    const auto early = _ports.openRemote("held");  // before there is anybody to answer
    ASSERT_TRUE(early);
    ::fcntl(holder->listener(), F_SETFL, 0);  // as a service manager passes it: accepting waits
    _ports.usePassedSocket("held", UniqueFd(::dup(holder->listener())));

    std::string heard;
    auto local = _ports.createLocal("held", [&](std::int32_t, ByteView data) {
        heard += textOf(data);
        return Bytes{};
    });
    ASSERT_TRUE(local.port);
    local.port->schedule();
    ASSERT_TRUE(early->request(0, bytesOf("hello"), {}, std::nullopt));
    ASSERT_TRUE(runUntil([&] { return heard == "hello"; }));
    EXPECT_TRUE(_ports.createLocal("held", noReply).alreadyExisted);
    local.port.reset();
    EXPECT_TRUE(fs::exists(_directory / "held.port"));
    EXPECT_FALSE(fs::exists(_directory / "held.lock"));
    EXPECT_TRUE(_ports.openRemote("held"));
    EXPECT_TRUE(_log.lines().empty());
}

TEST_F(HostMessagePortsNames, ThatAreNoNamesAreRefusedWithOneLine) {
    for (const std::string& name :
         {std::string(), std::string("../evil"), std::string("a/b"), std::string("a\nb"), std::string("a\0b", 3),
          std::string("\xC3\xA9"), std::string("a b"), std::string(81, 'x'), std::string(100'000, 'x')}) {
        _log.clear();
        const auto local = _ports.createLocal(name, noReply);
        EXPECT_FALSE(local.port);
        EXPECT_FALSE(local.alreadyExisted);
        EXPECT_FALSE(_ports.openRemote(name));
        const std::string line = "Not a port name (" + std::to_string(name.size()) + " characters)";
        EXPECT_EQ(_log.lines(), (std::vector<test::RecordingLog::Line>{{3, line}, {3, line}}));
    }
}

TEST_F(HostMessagePortsNames, MayHaveEightyCharactersInADirectoryOfAnyDepth) {
    const fs::path deep = _temporary.path() / std::string(120, 'd');
    fs::create_directory(deep);
    HostMessagePorts ports(deep / "ports");
    const std::string name(80, 'n');
    const auto local = ports.createLocal(name, noReply);
    ASSERT_TRUE(local.port);
    EXPECT_TRUE(ports.openRemote(name));
}

TEST_F(HostMessagePortsNames, DoNotCollideWithEachOthersLocks) {
    const auto plain = _ports.createLocal("a", noReply);
    const auto lock = _ports.createLocal("a.lock", noReply);
    const auto dots = _ports.createLocal("..", noReply);
    EXPECT_TRUE(plain.port);
    EXPECT_TRUE(lock.port);
    EXPECT_TRUE(dots.port);
}

TEST_F(HostMessagePortsNames, WithoutAListenerGiveNoneAndNoLine) {
    EXPECT_FALSE(_ports.openRemote("nobody"));
    EXPECT_TRUE(_log.lines().empty());
}

TEST_F(HostMessagePortsDirectory, IsMadeForTheUserAlone) {
    const auto local = _ports.createLocal("x", noReply);
    struct stat status {};
    ASSERT_EQ(::stat(_directory.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777U, 0700U);
}

TEST_F(HostMessagePortsDirectory, ThatIsASymbolicLinkIsRefusedWithOneLine) {
    fs::create_directory(_temporary.path() / "elsewhere");
    fs::permissions(_temporary.path() / "elsewhere", fs::perms::owner_all);
    fs::create_directory_symlink("elsewhere", _directory);
    EXPECT_FALSE(_ports.createLocal("x", noReply).port);
    ASSERT_EQ(_log.lines().size(), 1U);
    EXPECT_EQ(_log.lines()[0].second,
              "No message ports: cannot open directory " + _directory.string() + ": Not a directory");
    EXPECT_TRUE(fs::is_empty(_temporary.path() / "elsewhere"));
}

TEST_F(HostMessagePortsDirectory, ThatOthersMayEnterIsRefused) {
    fs::create_directory(_directory);
    fs::permissions(_directory, fs::perms(0750));
    EXPECT_FALSE(_ports.createLocal("x", noReply).port);
    EXPECT_FALSE(_ports.openRemote("x"));
    EXPECT_EQ(_log.lines().size(), 2U);
}

TEST_F(HostMessagePortsDirectory, UnderAParentThatOthersMayWriteIsRefused) {
    fs::create_directory(_temporary.path() / "open");
    fs::permissions(_temporary.path() / "open", fs::perms(0777));
    EXPECT_FALSE(HostMessagePorts(_temporary.path() / "open/ports").createLocal("x", noReply).port);
    fs::permissions(_temporary.path() / "open", fs::perms(01777));  // as /tmp is
    EXPECT_TRUE(HostMessagePorts(_temporary.path() / "open/ports").createLocal("x", noReply).port);
}

TEST_F(HostMessagePortsDirectory, OfAnotherUserIsRefused) {
    if (::geteuid() != 0) GTEST_SKIP() << "only root can make a directory for somebody else";
    fs::create_directory(_directory);
    fs::permissions(_directory, fs::perms::owner_all);
    ASSERT_EQ(::chown(_directory.c_str(), 12345, 12345), 0);
    EXPECT_FALSE(_ports.createLocal("x", noReply).port);
    fs::remove(_directory);
    ASSERT_EQ(::chown(_temporary.path().c_str(), 12345, 12345), 0);
    EXPECT_FALSE(_ports.createLocal("x", noReply).port);
    ASSERT_EQ(::chown(_temporary.path().c_str(), 0, 0), 0);
}

TEST_F(HostMessagePortsDirectory, StandsInTheRuntimeDirectoryWhenThatIsTheUsersOwn) {
    ::setenv("XDG_RUNTIME_DIR", _temporary.path().c_str(), 1);
    EXPECT_EQ(HostPaths::portDirectory(), _temporary.path() / "kelvo/ports");
    EXPECT_TRUE(HostMessagePorts().createLocal("x", noReply).port);
    const fs::path fallback = "/tmp/kelvo-" + std::to_string(::geteuid()) + "/ports";
    fs::permissions(_temporary.path(), fs::perms(0755));
    EXPECT_EQ(HostPaths::portDirectory(), fallback);
    ::setenv("XDG_RUNTIME_DIR", "relative", 1);
    EXPECT_EQ(HostPaths::portDirectory(), fallback);
    ::unsetenv("XDG_RUNTIME_DIR");
    EXPECT_EQ(HostPaths::portDirectory(), fallback);
    fs::permissions(_temporary.path(), fs::perms::owner_all);
}

TEST_F(HostMessagePortsTest, RefusesASenderOfAnotherUserWithOneLineAndServesTheOthers) {
    if (::geteuid() != 0) GTEST_SKIP() << "only root can become somebody else";
    int heard = 0;
    auto local = _ports.createLocal("guarded", [&](std::int32_t, ByteView) {
        ++heard;
        return Bytes{};
    });
    local.port->schedule();
    auto remote = _ports.openRemote("guarded");
    const pid_t child = ::fork();
    if (child == 0) {
        // Everything must be open to all for the stranger to get as far as the check of users.
        ::chmod((_directory / "guarded.port").c_str(), 0777);
        ::chmod(_directory.c_str(), 0777);
        ::chmod(_directory.parent_path().c_str(), 0777);
        if (::setresuid(12345, 12345, 12345) != 0) ::_exit(2);
        const UniqueFd stranger = test::rawConnect(_directory / "guarded.port");
        ::_exit(stranger && test::rawSend(stranger, test::datagram(1, 0, 0, 1, "evil")) ? 0 : 1);
    }
    int status = -1;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    ASSERT_EQ(status, 0);
    ASSERT_TRUE(runUntil([&] { return !_log.lines().empty(); }));
    ASSERT_TRUE(remote->request(0, bytesOf("good"), {}, std::nullopt));
    ASSERT_TRUE(runUntil([&] { return heard == 1; }));
    EXPECT_EQ(_log.lines(),
              (std::vector<test::RecordingLog::Line>{{3, "Port guarded refused another user's process"}}));
}

TEST_F(HostMessagePortsTest, DoesNotTalkToAListenerOfAnotherUser) {
    if (::geteuid() != 0) GTEST_SKIP() << "only root can become somebody else";
    (void)_ports.openRemote("foreign");  // makes the directory
    ASSERT_EQ(::seteuid(12345), 0);
    UniqueFd listener(::socket(AF_UNIX, SOCK_SEQPACKET | SOCK_CLOEXEC, 0));
    ASSERT_EQ(::seteuid(0), 0);
    const sockaddr_un address = test::rawAddress(_directory / "foreign.port");
    ASSERT_EQ(::bind(listener.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address), 0);
    ASSERT_EQ(::seteuid(12345), 0);  // the peer's user is that of the moment of listening
    ASSERT_EQ(::listen(listener.get(), 4), 0);
    ASSERT_EQ(::seteuid(0), 0);
    EXPECT_FALSE(_ports.openRemote("foreign"));
    EXPECT_EQ(_log.lines(),
              (std::vector<test::RecordingLog::Line>{{3, "Port foreign belongs to another user's process"}}));
}
