#include <gtest/gtest.h>
#include <pty.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>

#include "tests/support/TemporaryDirectory.h"

namespace kelvo {
namespace {

/// The program in a terminal of its own, where no service runs.
struct WatchCommand : testing::Test {
    void start(const char* type = "xterm") {
        const winsize size{24, 80, 0, 0};
        child = forkpty(&screen, nullptr, nullptr, &size);
        ASSERT_GE(child, 0);
        if (child != 0) return;
        setenv("XDG_RUNTIME_DIR", directory.path().c_str(), 1);
        setenv("LC_ALL", "C", 1);
        setenv("TERM", type, 1);
        execl(KELVOCTL, KELVOCTL, "watch", nullptr);
        _exit(127);
    }
    /// Waits for `text` on the screen, or for its end.
    bool see(const std::string& text) {
        while (seen.find(text) == std::string::npos) {
            char byte = 0;
            if (::read(screen, &byte, 1) != 1) return false;
            seen += byte;
        }
        return true;
    }
    /// Reads what is left and says how the program ended.
    int status() {
        see("\x1b[?1049l");
        int status = 0;
        waitpid(child, &status, 0);
        child = -1;
        return status;
    }
    ~WatchCommand() override {
        if (child > 0) {
            kill(child, SIGKILL);
            waitpid(child, nullptr, 0);
        }
        if (screen >= 0) close(screen);
    }

    test::TemporaryDirectory directory;
    pid_t child = -1;
    int screen = -1;
    std::string seen;
};

constexpr const char* kGivenBack = "\x1b[?7h\x1b[?25h\x1b[?1049l";

TEST_F(WatchCommand, SaysThatItIsConnectingAndQuitsAtAKey) {
    start();
    ASSERT_TRUE(see("Connecting..."));
    EXPECT_EQ(seen.find("\x1b[?1049h"), 0U) << seen;  // nothing, no warning either, comes before the picture
    ASSERT_EQ(::write(screen, "q", 1), 1);
    EXPECT_EQ(status(), 0);
    EXPECT_NE(seen.find(kGivenBack), std::string::npos);
}

TEST_F(WatchCommand, GivesTheScreenBackWhenItIsTerminated) {
    for (const int signal : {SIGTERM, SIGINT, SIGHUP}) {
        start();
        ASSERT_TRUE(see("Connecting..."));
        kill(child, signal);
        EXPECT_EQ(status(), 0) << signal;
        EXPECT_NE(seen.find(kGivenBack), std::string::npos) << signal;
        close(screen);
        screen = -1;
        seen.clear();
    }
}

TEST_F(WatchCommand, TheInterruptKeyGivesTheScreenBack) {
    start();
    ASSERT_TRUE(see("Connecting..."));
    ASSERT_EQ(::write(screen, "\x03", 1), 1);
    EXPECT_EQ(status(), 0);
    EXPECT_NE(seen.find(kGivenBack), std::string::npos);
}

TEST_F(WatchCommand, SaysWhyThereIsNoConnection) {
    start();
    ASSERT_TRUE(see("No telephony service is running"));
}

TEST_F(WatchCommand, WritesNoEscapeCodesToADumbTerminal) {
    for (const char* type : {"dumb", ""}) {
        start(type);
        ASSERT_TRUE(see("Connecting...  No telephony service is running\r\n"));
        kill(child, SIGTERM);
        EXPECT_EQ(status(), 0);
        EXPECT_EQ(seen.find('\x1b'), std::string::npos) << seen;
        close(screen);
        screen = -1;
        seen.clear();
    }
}

}  // namespace
}  // namespace kelvo
