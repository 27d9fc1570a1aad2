#include "platform/host/HostPreferences.h"

#include <gtest/gtest.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

#include <QProcess>
#include <cstring>
#include <fstream>
#include <sstream>

#include "platform/encodings/PropertyList.h"
#include "platform/host/UniqueFd.h"
#include "platform/system/Environment.h"
#include "tests/support/EventLoop.h"
#include "tests/support/PrivateBus.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"

namespace fs = std::filesystem;
using namespace kelvo;

namespace {

class HostPreferencesTest : public testing::Test {
protected:
    static std::string contents(const fs::path& path) {
        std::ifstream file(path);
        std::ostringstream text;
        text << file.rdbuf();
        return text.str();
    }
    Value stored() { return *readPropertyList(bytesOf(contents(_file))); }
    void write(const std::string& text) {
        fs::create_directories(_file.parent_path());
        std::ofstream(_file) << text;
    }

    test::TemporaryDirectory _temporary;
    fs::path _file = _temporary.path() / "config/preferences/com.zorvik.dockmere.plist";
    HostPreferences _preferences{_temporary.path() / "config"};
    test::RecordingLog _log;
    Environment::Scope _scope{Environment{.log = &_log}};
};

}  // namespace

TEST_F(HostPreferencesTest, MakesTheFileForTheUserAlone) {
    ASSERT_TRUE(_preferences.set("com.zorvik.dockmere", "DMShowGSMRSSI", Value(false)));
    EXPECT_EQ(stored(), Value(Dictionary::make({{"DMShowGSMRSSI", Value(false)}})));
    struct stat status {};
    ASSERT_EQ(::stat(_file.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777U, 0600U);
    EXPECT_TRUE(_log.lines().empty());
}

TEST_F(HostPreferencesTest, KeepsOtherKeysAndLeavesNothingElseBehind) {
    write(
        "<plist "
        "version=\"1.0\"><dict><key>Mine</key><integer>5</integer><key>DMShowGSMRSSI</key><true/></dict></plist>");
    ASSERT_TRUE(_preferences.set("com.zorvik.dockmere", "DMShowGSMRSSI", Value(false)));
    EXPECT_EQ(stored(), Value(Dictionary::make({{"Mine", Value(5)}, {"DMShowGSMRSSI", Value(false)}})));
    EXPECT_EQ(std::distance(fs::directory_iterator(_file.parent_path()), fs::directory_iterator()), 1);
}

TEST_F(HostPreferencesTest, LeavesAFileItCannotReadAloneWithOneLine) {
    write("<plist><dict>");
    EXPECT_FALSE(_preferences.set("com.zorvik.dockmere", "DMShowGSMRSSI", Value(false)));
    EXPECT_EQ(contents(_file), "<plist><dict>");
    EXPECT_EQ(_log.lines().size(), 1U);
    write("<plist version=\"1.0\"><array/></plist>");
    EXPECT_FALSE(_preferences.set("com.zorvik.dockmere", "DMShowGSMRSSI", Value(false)));
    ASSERT_EQ(_log.lines().size(), 2U);
    EXPECT_EQ(_log.lines()[1].second,
              "Could not write preference DMShowGSMRSSI: " + _file.string() + " is no dictionary");
}

TEST_F(HostPreferencesTest, FollowsNoSymbolicLink) {
    write("");
    fs::remove(_file);
    const fs::path target = _temporary.path() / "target";
    for (const bool dangling : {true, false}) {
        if (!dangling) std::ofstream(target) << "precious";
        if (!fs::is_symlink(_file)) fs::create_symlink(target, _file);
        _log.clear();
        EXPECT_FALSE(_preferences.set("com.zorvik.dockmere", "DMShowGSMRSSI", Value(false)));
        ASSERT_EQ(_log.lines().size(), 1U);
        EXPECT_EQ(_log.lines()[0].second,
                  "Could not write preference DMShowGSMRSSI: " + _file.string() + " is a symbolic link");
    }
    EXPECT_EQ(contents(target), "precious");
}

TEST_F(HostPreferencesTest, RefusesDomainsThatAreNoFileNames) {
    for (const std::string& domain : {std::string(), std::string("../x"), std::string("a/b"), std::string(".hidden"),
                                      std::string("a\0b", 3), std::string(129, 'x')}) {
        _log.clear();
        EXPECT_FALSE(_preferences.set(domain, "k", Value(1)));
        EXPECT_EQ(_log.lines().size(), 1U);
    }
    EXPECT_FALSE(fs::exists(_temporary.path() / "config"));
}

TEST_F(HostPreferencesTest, SaysWhenItCannotWrite) {
    std::ofstream(_temporary.path() / "config") << "a file where the directory belongs";
    EXPECT_FALSE(_preferences.set("com.zorvik.dockmere", "DMShowGSMRSSI", Value(false)));
    EXPECT_EQ(_log.lines().size(), 1U);
    EXPECT_FALSE(_preferences.set("com.zorvik.dockmere", "none", Value()));
    EXPECT_EQ(_log.lines().size(), 2U);
}

TEST_F(HostPreferencesTest, WithoutASessionBusWritesOneLine) {
    ::unsetenv("DBUS_SESSION_BUS_ADDRESS");
    ::unsetenv("XDG_RUNTIME_DIR");
    _preferences.broadcastChange("com.zorvik.dockmere", "DMShowGSMRSSI");
    EXPECT_EQ(_log.lines(),
              (std::vector<test::RecordingLog::Line>{
                  {3, "Could not tell that preference DMShowGSMRSSI of com.zorvik.dockmere changed: no session bus"}}));
}

TEST_F(HostPreferencesTest, WithABusThatDoesNotAnswerWritesOneLine) {
    ::setenv("DBUS_SESSION_BUS_ADDRESS", "unix:path=/nonexistent/bus", 1);
    _preferences.broadcastChange("com.zorvik.dockmere", "DMShowGSMRSSI");
    ::unsetenv("DBUS_SESSION_BUS_ADDRESS");
    EXPECT_EQ(_log.lines().size(), 1U);
}

TEST_F(HostPreferencesTest, TellsNothingToABusOfAnotherUser) {
    if (::geteuid() != 0) GTEST_SKIP() << "only root can give a file away";
    ::unsetenv("DBUS_SESSION_BUS_ADDRESS");
    ::setenv("XDG_RUNTIME_DIR", _temporary.path().c_str(), 1);
    const UniqueFd listener(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::strncpy(address.sun_path, (_temporary.path() / "bus").c_str(), sizeof address.sun_path - 1);
    ASSERT_EQ(::bind(listener.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address), 0);
    ASSERT_EQ(::listen(listener.get(), 4), 0);
    ASSERT_EQ(::chown((_temporary.path() / "bus").c_str(), 12345, 12345), 0);
    _preferences.broadcastChange("com.zorvik.dockmere", "DMShowGSMRSSI");
    EXPECT_EQ(_log.lines().size(), 1U);
    EXPECT_LT(::accept(listener.get(), nullptr, nullptr), 0);  // nobody came
}

TEST_F(HostPreferencesTest, TellsTheChangeOnTheSessionBus) {
    const test::PrivateBus bus;
    if (!bus) GTEST_SKIP() << "no bus is installed";
    QProcess monitor;
    monitor.start("dbus-monitor", {"--address", bus.address(), "interface='com.zorvik.Preferences'"});
    ASSERT_TRUE(monitor.waitForStarted());
    QByteArray seen;
    ASSERT_TRUE(test::runUntil([&] {  // told until the monitor listens, too
        _preferences.broadcastChange("com.zorvik.dockmere", "DMShowGSMRSSI");
        seen += monitor.readAllStandardOutput();
        return seen.contains("member=Changed") && seen.contains("string \"DMShowGSMRSSI\"");
    }));
    EXPECT_TRUE(seen.contains("path=/com/zorvik/Preferences; interface=com.zorvik.Preferences; member=Changed"));
    EXPECT_TRUE(seen.contains("string \"com.zorvik.dockmere\""));
    EXPECT_TRUE(_log.lines().empty());
    monitor.kill();
    monitor.waitForFinished();
}
