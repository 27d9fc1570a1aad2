#include "platform/host/HostSystemLog.h"

#include <gtest/gtest.h>
#include <spdlog/sinks/base_sink.h>

#include <sys/socket.h>
#include <sys/un.h>
#include <syslog.h>
#include <unistd.h>

#include <condition_variable>
#include <cstdlib>
#include <ctime>
#include <filesystem>
#include <memory>
#include <mutex>
#include <regex>
#include <string>
#include <vector>

#include "platform/host/SyslogSocket.h"
#include "platform/host/UniqueFd.h"
#include "tests/support/TemporaryDirectory.h"

using kelvo::HostSystemLog;
using kelvo::Level;

namespace {

using Lines = std::vector<std::string>;

// Keeps lines as "level: text"; stands still between hold() and release().
class KeepingSink final : public spdlog::sinks::base_sink<std::mutex> {
public:
    explicit KeepingSink(Lines& lines) : _lines(lines) {}

    void hold() { _held = true; }
    void release() {
        const std::lock_guard lock(_gate);
        _held = false;
        _changed.notify_all();
    }
    void awaitFirst() {
        std::unique_lock lock(_gate);
        _changed.wait(lock, [this] { return _busy; });
    }

private:
    void sink_it_(const spdlog::details::log_msg& line) override {
        std::unique_lock lock(_gate);
        _busy = true;
        _changed.notify_all();
        _changed.wait(lock, [this] { return !_held; });
        const auto name = spdlog::level::to_string_view(line.level);
        _lines.push_back(std::string(name.data(), name.size()) + ": " +
                         std::string(line.payload.data(), line.payload.size()));
    }
    void flush_() override {}

    Lines& _lines;
    std::mutex _gate;
    std::condition_variable _changed;
    bool _held = false;
    bool _busy = false;
};

}  // namespace

TEST(HostSystemLog, WritesEverythingInOrderBeforeItIsGone) {
    Lines lines;
    {
        HostSystemLog log(std::make_shared<KeepingSink>(lines));
        log.write(Level::Error, "three");
        log.write(Level::Warning, "four");
        log.write(Level::Notice, "five");
        log.write(Level::DlfWriter, "sixteen");
    }
    EXPECT_EQ(lines, (Lines{"error: three", "warning: four", "info: five", "error: sixteen"}));
}

TEST(HostSystemLog, DropsTrailingNewlines) {
    Lines lines;
    {
        HostSystemLog log(std::make_shared<KeepingSink>(lines));
        log.write(Level::Error, " a  b {} %s \n\n");
        log.write(Level::Error, "\n");
    }
    EXPECT_EQ(lines, (Lines{"error:  a  b {} %s ", "error: "}));
}

TEST(HostSystemLog, WritesOneLineWhateverATextHolds) {
    Lines lines;
    {
        HostSystemLog log(std::make_shared<KeepingSink>(lines));
        log.write(Level::Error, "Cell\n00:00:00 kelvo: all is well\r\x1b[2J\xc2\x9b\x7f – \xff");
    }
    EXPECT_EQ(lines, (Lines{"error: Cell\uFFFD00:00:00 kelvo: all is well\uFFFD\uFFFD[2J\uFFFD\uFFFD – \uFFFD"}));
}

TEST(HostSystemLog, PutsTheTimeAndTheProgramBeforeLinesOnStandardError) {
    testing::internal::CaptureStderr();
    HostSystemLog("kelvo", HostSystemLog::To::StandardError).write(Level::Warning, "Deallocing");
    const std::string line = testing::internal::GetCapturedStderr();
    ASSERT_GT(line.size(), 12U);
    EXPECT_EQ(line.substr(2, 1) + line.substr(5, 1) + line.substr(8, 1), "::.");  // 09:15:02.345
    EXPECT_EQ(line.substr(12), " kelvo: Deallocing\n");
}

/// A log daemon of the test's own.
class Syslog {
public:
    explicit Syslog(const std::filesystem::path& path) : _path(path) {
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        path.native().copy(address.sun_path, sizeof address.sun_path - 1);
        if (::bind(_socket.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0) std::abort();
    }
    ~Syslog() { std::filesystem::remove(_path); }

    /// What has come, without the time and the process: "<11> kelvo: text".
    Lines lines() {
        Lines lines;
        char datagram[1024];
        for (ssize_t size; (size = ::recv(_socket.get(), datagram, sizeof datagram, 0)) >= 0;) {
            const std::string line(datagram, static_cast<std::size_t>(size));
            const std::string process = "[" + std::to_string(::getpid()) + "]";
            const std::regex form(
                "(<[0-9]+>)[A-Z][a-z]{2} [ 1-3][0-9] [0-9]{2}:[0-9]{2}:[0-9]{2}( kelvo)\\[[0-9]+\\](.*)");
            EXPECT_NE(line.find(process), std::string::npos) << line;
            EXPECT_TRUE(std::regex_match(line, form)) << line;
            lines.push_back(std::regex_replace(line, form, "$1$2$3"));
        }
        return lines;
    }

private:
    const std::filesystem::path _path;
    kelvo::UniqueFd _socket{::socket(AF_UNIX, SOCK_DGRAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0)};
};

// Facility "user" (8) and the severities 3 (error), 4 (warning) and 5 (notice); the system has no level 16.
TEST(HostSystemLog, GivesTheSystemsLogEachLinesPriority) {
    const kelvo::test::TemporaryDirectory directory;
    Syslog syslog(directory.path() / "log");
    {
        HostSystemLog log("kelvo", HostSystemLog::To::System, directory.path() / "log");
        log.write(Level::Error, "three");
        log.write(Level::Warning, "four");
        log.write(Level::Notice, "five %s");
        log.write(Level::DlfWriter, "sixteen");
    }
    EXPECT_EQ(syslog.lines(),
              (Lines{"<11> kelvo: three", "<12> kelvo: four", "<13> kelvo: five %s", "<11> kelvo: sixteen"}));
}

TEST(HostSystemLog, WritesToStandardErrorWhereTheSystemHasNoLog) {
    const kelvo::test::TemporaryDirectory directory;
    testing::internal::CaptureStderr();
    HostSystemLog("kelvo", HostSystemLog::To::System, directory.path() / "log").write(Level::Error, "alone");
    EXPECT_NE(testing::internal::GetCapturedStderr().find(" kelvo: alone\n"), std::string::npos);
}

TEST(SyslogSocket, FindsADaemonThatHasStartedAnew) {
    const kelvo::test::TemporaryDirectory directory;
    auto syslog = std::make_unique<Syslog>(directory.path() / "log");
    kelvo::SyslogSocket socket(directory.path() / "log", "kelvo");
    std::tm time{};
    time.tm_mon = 2;
    time.tm_mday = 7;
    syslog.reset();
    socket.send(LOG_ERR, time, "lost");
    syslog = std::make_unique<Syslog>(directory.path() / "log");
    socket.send(LOG_ERR, time, "heard");
    EXPECT_EQ(syslog->lines(), (Lines{"<11> kelvo: heard"}));
}

TEST(SyslogSocket, LosesLinesThatHaveNowhereToGo) {
    std::tm time{};
    time.tm_mday = 1;
    kelvo::SyslogSocket(std::string(200, 'x'), "kelvo").send(LOG_ERR, time, "lost");
    kelvo::SyslogSocket("/nonexistent/log", "kelvo").send(LOG_ERR, time, "lost");
}

TEST(HostSystemLog, WantsWhatItWrites) {
    Lines lines;
    const HostSystemLog log(std::make_shared<KeepingSink>(lines));
    for (const Level level : {Level::Error, Level::Warning, Level::Notice, Level::DlfWriter})
        EXPECT_TRUE(log.wants(level));
}

TEST(HostSystemLog, NeverWaitsLosesTheOldestLinesAndCountsThem) {
    Lines lines;
    {
        const auto sink = std::make_shared<KeepingSink>(lines);
        sink->hold();
        HostSystemLog log(sink, 4);
        log.write(Level::Error, "first");
        sink->awaitFirst();  // taken off the queue and stuck
        for (int i = 0; i < 10; ++i) log.write(Level::Error, "line " + std::to_string(i));
        sink->release();
    }
    EXPECT_EQ(lines, (Lines{"error: first", "error: line 6", "error: line 7", "error: line 8", "error: line 9",
                            "error: 6 log lines were lost"}));
}
