#include "telephony/ServiceManager.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>

#include <cstring>

#include "platform/host/PrivateDirectory.h"
#include "tests/support/ManualQueue.h"
#include "tests/telephony/DaemonFixture.h"

using namespace kelvo;
using namespace std::chrono_literals;

namespace {

constexpr const char* kPort = "com.zorvik.TelephonyService.port";

/// A socket of this kind under this path; its owner removes no file.
UniqueFd boundSocket(int kind, const std::string& path) {
    UniqueFd made(::socket(AF_UNIX, kind | SOCK_CLOEXEC, 0));
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::memcpy(address.sun_path, path.c_str(), path.size() + 1);
    EXPECT_EQ(::bind(made.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address), 0) << path;
    return made;
}

/// The end of a service manager that hears what the service says of itself.
class Listener {
public:
    explicit Listener(const std::string& path) : _socket(boundSocket(SOCK_DGRAM, path)) {}
    /// The next thing it says; waits for it.
    std::string next() const {
        pollfd ready{_socket.get(), POLLIN, 0};
        if (::poll(&ready, 1, 20'000) != 1) return "nothing";
        char text[1000];
        const ssize_t size = ::recv(_socket.get(), text, sizeof text, 0);
        return {text, static_cast<std::size_t>(std::max<ssize_t>(size, 0))};
    }

private:
    UniqueFd _socket;
};

/// The service as a service manager starts it: with a socket that listens already, told where to report.
class ManagedServiceTest : public test::DaemonFixture {
protected:
    void startManaged(const std::filesystem::path& socketDirectory, const QStringList& arguments) {
        openPrivateDirectory(socketDirectory).value();
        _socket = boundSocket(SOCK_SEQPACKET, socketDirectory / kPort);
        ASSERT_EQ(::listen(_socket.get(), 8), 0);
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert("XDG_RUNTIME_DIR", QString::fromStdString(_temporary.path()));
        environment.insert("NOTIFY_SOCKET", QString::fromStdString(_temporary.file("notify")));
        environment.insert("LISTEN_FDS", "1");
        _daemon.setProcessEnvironment(environment);
        _daemon.setChildProcessModifier([listener = _socket.get()] {
            if (listener == 3) {
                ::fcntl(3, F_SETFD, 0);
            } else {
                ::dup2(listener, 3);
            }
        });
        // The process that sockets are meant for is known by its number.
        _daemon.start("/bin/sh", QStringList{"-c", "LISTEN_PID=$$ exec \"$0\" \"$@\"", KELVO_TELEPHONYD} + arguments);
    }

    Listener _listener{_temporary.file("notify")};
    UniqueFd _socket;
};

}  // namespace

TEST(ServiceManagerTest, HearsTwiceInEveryIntervalWhileTheQueueRuns) {
    test::ManualQueue queue;
    std::vector<std::string> told;
    {
        ServiceManager manager([&](const std::string& state) { told.push_back(state); }, 30s);
        queue.advance(60s);
        EXPECT_TRUE(told.empty());  // before it is ready nobody waits for it
        manager.tellReady("Serving\nnothing", queue);
        EXPECT_EQ(told, std::vector<std::string>{"READY=1\nSTATUS=Serving nothing"});
        told.clear();
        queue.advance(14'999ms);
        EXPECT_TRUE(told.empty());
        queue.advance(1ms);
        EXPECT_EQ(told, std::vector<std::string>{"WATCHDOG=1"});
        queue.advance(30s);
        EXPECT_EQ(told.size(), 3U);
        manager.tellEnding();
        EXPECT_EQ(told.back(), "STOPPING=1");
    }
    told.clear();
    queue.advance(60s);
    EXPECT_TRUE(told.empty());
}

TEST(ServiceManagerTest, ThatDoesNotWatchHearsNoMoreThanItMust) {
    test::ManualQueue queue;
    std::vector<std::string> told;
    ServiceManager manager([&](const std::string& state) { told.push_back(state); }, std::nullopt);
    manager.tellReady("Serving a capture", queue);
    queue.advance(1h);
    EXPECT_EQ(told, std::vector<std::string>{"READY=1\nSTATUS=Serving a capture"});
}

TEST(ServiceManagerTest, ThatIsNotThereHasPassedNothing) {
    const auto passed = ServiceManager::passedSocket("/run/user/1/kelvo/ports/x.port");
    ASSERT_TRUE(passed);
    EXPECT_FALSE(*passed);
}

TEST_F(ManagedServiceTest, AnswersWhoeverHasAskedBeforeItWasThere) {
    std::filesystem::create_directories(_temporary.path() / "kelvo");
    startManaged(_directory, {"--simulate", "gsm", "--seed", "3"});
    _connection = _client.createServerConnection({});  // meets the manager's socket, not yet the service
    ASSERT_TRUE(_connection);
    EXPECT_EQ(_listener.next(), "READY=1\nSTATUS=Serving a simulated GSM modem, seed 3");
    run({"--status"});
    EXPECT_EQ(_output.rfind("Source      a simulated GSM modem, seed 3\n", 0), 0U) << _output;
    EXPECT_EQ(run({"--simulate", "lte"}).first, 1);

    _daemon.terminate();
    EXPECT_EQ(_listener.next(), "STOPPING=1");
    ASSERT_TRUE(_daemon.waitForFinished(20'000));
    EXPECT_EQ(_daemon.exitCode(), 0);
    EXPECT_TRUE(std::filesystem::exists(_directory / kPort));  // the manager's
}

TEST_F(ManagedServiceTest, RefusesASocketOfAnotherPlaceInOneLine) {
    std::filesystem::create_directories(_temporary.path() / "elsewhere");
    startManaged(_temporary.path() / "elsewhere/ports", {"--simulate", "gsm"});
    ASSERT_TRUE(_daemon.waitForFinished(20'000));
    EXPECT_EQ(_daemon.exitCode(), 1);
    EXPECT_EQ(
        _daemon.readAllStandardError().toStdString(),
        "kelvo-telephonyd: the socket that was passed does not listen at " + (_directory / kPort).string() + "\n");
}
