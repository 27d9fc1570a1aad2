#include <fcntl.h>
#include <gtest/gtest.h>
#include <poll.h>
#include <signal.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <QProcess>
#include <QTcpSocket>
#include <algorithm>
#include <filesystem>

#include "platform/host/UniqueFd.h"
#include "tests/support/EventLoop.h"
#include "tests/support/RunProgram.h"
#include "tests/support/TemporaryDirectory.h"

using namespace kelvo;
using test::runUntil;

namespace {

const Bytes kAskVersion{0x00, 0x78, 0xF0, 0x7E};

// The program itself, and what it says.
class ModemProgramTest : public testing::Test {
protected:
    void start(QStringList arguments) {
        _modem.setProgram(KELVO_MODEM);
        _modem.setArguments(QStringList{"--simulate", "lte"} + arguments);
        _modem.start();
        ASSERT_TRUE(runUntil([this] { return _modem.canReadLine() || _modem.state() == QProcess::NotRunning; }));
        _place = nextLine();
    }
    std::string nextLine() {
        return runUntil([this] { return _modem.canReadLine(); }) ? _modem.readLine().trimmed().toStdString() : "";
    }
    void signal(int number) const { ::kill(static_cast<pid_t>(_modem.processId()), number); }
    void stop() {
        _modem.terminate();
        ASSERT_TRUE(_modem.waitForFinished(10'000));
        EXPECT_EQ(_modem.exitStatus(), QProcess::NormalExit);
        EXPECT_EQ(_modem.exitCode(), 0);
    }
    static UniqueFd open(const std::string& path) {
        return UniqueFd(::open(path.c_str(), O_RDWR | O_NOCTTY | O_NONBLOCK | O_CLOEXEC));
    }
    static UniqueFd connectTo(const std::string& path) {
        UniqueFd socket(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
        sockaddr_un address{AF_UNIX, {}};
        path.copy(address.sun_path, sizeof address.sun_path - 1);
        if (::connect(socket.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0) return {};
        ::fcntl(socket.get(), F_SETFL, O_NONBLOCK);
        return socket;
    }
    // Whether the modem answers with a frame of its version: 55 bytes, none of which is escaped, and three more.
    static bool answers(const UniqueFd& port) {
        if (::write(port.get(), kAskVersion.data(), kAskVersion.size()) != 4) return false;
        Bytes answer;
        return runUntil([&] {
                   std::uint8_t bytes[256];
                   const ssize_t count = ::read(port.get(), bytes, sizeof bytes);
                   if (count > 0) answer.insert(answer.end(), bytes, bytes + count);
                   return answer.size() >= 58 || count == 0;  // it may have turned this reader away
               }) &&
               answer.size() >= 58 && answer.front() == 0x00 && answer.back() == 0x7E;
    }
    static bool hasEnded(const UniqueFd& port) {
        return runUntil([&] {
            std::uint8_t byte = 0;
            const ssize_t count = ::read(port.get(), &byte, 1);
            return count == 0 || (count < 0 && errno != EAGAIN);
        });
    }

    test::TemporaryDirectory _directory;
    QProcess _modem;
    std::string _place;
};

}  // namespace

TEST_F(ModemProgramTest, AnswersOnThePseudoTerminalThatItPrints) {
    start({});
    ASSERT_TRUE(_place.starts_with("/dev/pts/"));
    for (int reader = 0; reader < 3; ++reader) EXPECT_TRUE(answers(open(_place)));  // one after the other
    stop();
    EXPECT_FALSE(open(_place));
}

TEST_F(ModemProgramTest, MakesALinkWhereOneIsAskedForAndTakesItAway) {
    const std::string link = _directory.file("modem");
    std::filesystem::create_symlink("/dev/pts/99999", link);  // of one that was killed
    start({"--on", QString::fromStdString(link)});
    EXPECT_EQ(_place, link);
    EXPECT_TRUE(answers(open(link)));
    stop();
    EXPECT_FALSE(std::filesystem::is_symlink(link));
}

TEST_F(ModemProgramTest, ReplacesNothingButALinkOfItsOwnKind) {
    const std::string file = _directory.write("file", bytesOf("mine"));
    const std::string link = _directory.file("link");
    std::filesystem::create_symlink(file, link);
    for (const std::string& taken : {file, link}) {
        const auto done = test::run(KELVO_MODEM, {"--simulate", "lte", "--on", taken});
        EXPECT_EQ(done.status, 1);
        EXPECT_EQ(done.errors, "kelvo-modem: " + taken + " is there and no link to a modem that is played\n");
    }
    const auto done = test::run(KELVO_MODEM, {"--simulate", "lte", "--on", "unix:" + file});
    EXPECT_EQ(done.status, 1);
    EXPECT_EQ(done.errors, "kelvo-modem: " + file + " is there and no socket that a modem has left\n");
    EXPECT_EQ(test::contentsOf(file), "mine");
    EXPECT_EQ(std::filesystem::read_symlink(link), file);
}

TEST_F(ModemProgramTest, AnswersOneReaderAtATimeOnAUnixSocket) {
    const std::string path = _directory.file("socket");
    start({"--on", QString::fromStdString("unix:" + path)});
    EXPECT_EQ(_place, "unix:" + path);
    UniqueFd reader = connectTo(path);
    EXPECT_TRUE(answers(reader));
    EXPECT_TRUE(hasEnded(connectTo(path)));
    EXPECT_TRUE(answers(reader));
    const auto second = test::run(KELVO_MODEM, {"--simulate", "lte", "--on", "unix:" + path});
    EXPECT_EQ(second.errors, "kelvo-modem: " + path + " is there and no socket that a modem has left\n");
    EXPECT_TRUE(answers(reader));
    reader.reset();
    EXPECT_TRUE(runUntil([&] { return answers(connectTo(path)); }));
    stop();
    EXPECT_FALSE(std::filesystem::exists(path));
}

TEST_F(ModemProgramTest, TakesOverASocketOnWhichNobodyListens) {
    const std::string path = _directory.file("socket");
    start({"--on", QString::fromStdString("unix:" + path)});
    _modem.kill();
    ASSERT_TRUE(_modem.waitForFinished(10'000));
    ASSERT_TRUE(std::filesystem::exists(path));
    start({"--on", QString::fromStdString("unix:" + path)});
    EXPECT_TRUE(answers(connectTo(path)));
    stop();
}

TEST_F(ModemProgramTest, AnswersOnATcpPortOfThisMachine) {
    start({"--on", "tcp:0"});
    ASSERT_TRUE(_place.starts_with("tcp:127.0.0.1:")) << _place;
    QTcpSocket socket;
    socket.connectToHost("127.0.0.1", static_cast<quint16>(std::stoi(_place.substr(14))));
    ASSERT_TRUE(runUntil([&] { return socket.state() == QAbstractSocket::ConnectedState; }));
    socket.write(reinterpret_cast<const char*>(kAskVersion.data()), 4);
    EXPECT_TRUE(runUntil([&] { return socket.bytesAvailable() == 58; }));
    stop();
    EXPECT_TRUE(runUntil([&] { return socket.state() == QAbstractSocket::UnconnectedState; }));
}

TEST_F(ModemProgramTest, IsPulledOutAndPutBackByASignal) {
    const std::string link = _directory.file("modem");
    start({"--on", QString::fromStdString(link)});
    const UniqueFd before = open(link);
    EXPECT_TRUE(answers(before));
    signal(SIGUSR1);
    EXPECT_TRUE(hasEnded(before));
    EXPECT_TRUE(runUntil([&] { return !std::filesystem::is_symlink(link); }));
    signal(SIGUSR1);
    EXPECT_EQ(nextLine(), link);
    EXPECT_TRUE(answers(open(link)));
    stop();
}

TEST_F(ModemProgramTest, SaysInOneLineWhatIsWrongWithItsCommandLine) {
    const std::string empty = _directory.write("empty.frames", {});
    for (const std::vector<std::string>& arguments :
         std::vector<std::vector<std::string>>{{},
                                               {"--simulate", "ifx"},
                                               {"--simulate", "nmt"},
                                               {"--simulate", "lte", "--replay", empty},
                                               {"--simulate", "lte", "--faults", "nose"},
                                               {"--simulate", "lte", "--seed", "-1"},
                                               {"--simulate", "lte", "--generation", "2012"},
                                               {"--simulate", "utran", "--generation", "2014"},
                                               {"--replay", empty, "--generation", "2014"},
                                               {"--simulate", "lte", "--on", "tcp:70000"},
                                               {"--simulate", "lte", "--on", "tcp:"},
                                               {"--simulate", "lte", "--on", "unix:"},
                                               {"--simulate", "lte", "--on", "/nowhere/at/all"},
                                               {"--replay", empty},
                                               {"--replay", _directory.file("missing.pcap")},
                                               {"--replay", _directory.file("missing.frames")}}) {
        const auto done = test::run(KELVO_MODEM, arguments);
        EXPECT_EQ(done.status, 1);
        EXPECT_EQ(std::ranges::count(done.errors, '\n'), 1) << done.errors;
        EXPECT_TRUE(done.errors.starts_with("kelvo-modem: ")) << done.errors;
        EXPECT_EQ(done.output, "");
    }
}

TEST_F(ModemProgramTest, ListsItsFaultsInItsHelp) {
    const auto done = test::run(KELVO_MODEM, {"--help"});
    EXPECT_EQ(done.status, 0);
    EXPECT_EQ(done.errors, "");
    for (const char* fault :
         {"noise",           "flipped-bits", "cut-frames",      "bad-escapes", "lying-lengths",  "oversized-frames",
          "asynchronous",    "slow-answers", "missing-answers", "bad-command", "bad-parameter",  "bad-length",
          "bad-mode",        "locked",       "security",        "transaction", "smaller-ranges", "smaller-masks",
          "earlier-session", "encrypted",    "two-sims",        "clock-1980",  "hang-up",        "at-port",
          "silent",          "flood"})
        EXPECT_NE(done.output.find(std::string("\n  ") + fault + " "), std::string::npos) << fault;
}
