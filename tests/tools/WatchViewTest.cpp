#include "tools/WatchView.h"

#include <gtest/gtest.h>
#include <pty.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <optional>

#include "platform/host/UniqueFd.h"

namespace kelvo {
namespace {

using Keys = std::vector<TerminalKey>;

TEST(TerminalKeys, KnowsBothFormsOfTheArrows) {
    EXPECT_EQ(TerminalKeys().feed("\x1b[A\x1bOB"), (Keys{TerminalKey::Up, TerminalKey::Down}));
    EXPECT_EQ(TerminalKeys().feed("\x1b[5~\x1b[6~\x1b[H\x1bOF"),
              (Keys{TerminalKey::PageUp, TerminalKey::PageDown, TerminalKey::Home, TerminalKey::End}));
}

TEST(TerminalKeys, PutsASequenceTogetherFromPieces) {
    TerminalKeys keys;
    EXPECT_EQ(keys.feed("\x1b"), Keys());
    EXPECT_EQ(keys.feed("[6"), Keys());
    EXPECT_EQ(keys.feed("~q"), (Keys{TerminalKey::PageDown, TerminalKey::Quit}));
}

TEST(TerminalKeys, DropsWhatIsNoKey) {
    EXPECT_EQ(TerminalKeys().feed("x\x1b[1;5C\x1bx\x1b[23~q"), (Keys{TerminalKey::Quit}));
    TerminalKeys endless;
    EXPECT_EQ(endless.feed("\x1b[" + std::string(100, '0')), Keys());
    EXPECT_EQ(endless.feed("q"), (Keys{TerminalKey::Quit}));
}

/// A terminal of 5 rows and 20 columns and what was written to it.
struct View : testing::Test {
    View() {
        int user = -1;
        int program = -1;
        const winsize size{5, 20, 0, 0};
        EXPECT_EQ(openpty(&user, &program, nullptr, nullptr, &size), 0);
        _user = UniqueFd(user);
        _program = UniqueFd(program);
        terminal.emplace(program, program);
    }
    /// What has been written since the last call.
    std::string written() {
        constexpr char kMark = '\x05';  // a terminal passes bytes on in its own time, but in order
        EXPECT_EQ(::write(_program.get(), &kMark, 1), 1);
        std::string text;
        char byte = 0;
        while (::read(_user.get(), &byte, 1) == 1 && byte != kMark) text += byte;
        return text;
    }

    UniqueFd _user;
    UniqueFd _program;
    std::optional<Terminal> terminal;
};

TEST_F(View, GivesTheScreenBack) {
    EXPECT_EQ(written(), "\x1b[?1049h\x1b[?25l\x1b[?7l\x1b[2J");
    termios settings{};
    tcgetattr(_program.get(), &settings);
    EXPECT_EQ(settings.c_lflag & (ICANON | ECHO), 0U);
    terminal.reset();
    EXPECT_EQ(written(), "\x1b[?7h\x1b[?25h\x1b[?1049l");
    tcgetattr(_program.get(), &settings);
    EXPECT_EQ(settings.c_lflag & (ICANON | ECHO), static_cast<tcflag_t>(ICANON | ECHO));
}

TEST_F(View, WritesOnlyTheRowsThatChanged) {
    TerminalWatchView view(*terminal);
    view.showDisplay({"one", "two"}, "status");
    written();
    view.showDisplay({"one", "2"}, "status");
    EXPECT_EQ(written(), "\x1b[2;1H2\x1b[K");
    view.showDisplay({"one", "2"}, "status");
    EXPECT_EQ(written(), "");
    view.showStatus("new");
    EXPECT_EQ(written(), "\x1b[5;1H\x1b[7m new        q quits \x1b[0m\x1b[K");
}

TEST_F(View, CutsRowsAtTheEdgeByCharacters) {
    terminal->draw({"ääääääääääääääääääääXY"}, 1);
    EXPECT_EQ(written().find('X'), std::string::npos);
    terminal->draw({"äääääääääääääääääääZ"}, 1);
    EXPECT_NE(written().find('Z'), std::string::npos);
}

TEST_F(View, ScrollsWithinTheDisplay) {
    TerminalWatchView view(*terminal);
    view.showDisplay({"a", "b", "c", "d", "e", "f"}, "s");
    EXPECT_NE(written().find("1-4 of 6"), std::string::npos);
    view.press(TerminalKey::Down);
    EXPECT_EQ(written().substr(0, 14), "\x1b[1;1Hb\x1b[K\x1b[2;");
    view.press(TerminalKey::PageDown);
    EXPECT_NE(written().find("3-6 of 6"), std::string::npos);
    view.press(TerminalKey::Down);
    EXPECT_EQ(written(), "");
    view.press(TerminalKey::Home);
    EXPECT_NE(written().find("1-4 of 6"), std::string::npos);
    view.press(TerminalKey::End);
    EXPECT_NE(written().find("3-6 of 6"), std::string::npos);
    view.showDisplay({"a"}, "s");
    EXPECT_NE(written().find("\x1b[1;1Ha\x1b[K"), std::string::npos);
}

TEST_F(View, DropsHintsBeforeTheStatus) {
    TerminalWatchView view(*terminal);
    view.showDisplay({"a", "b", "c", "d", "e", "f"}, "Updating");
    EXPECT_NE(written().find(" Updating  1-4 of 6 "), std::string::npos);
    view.showStatus("Connecting...");
    EXPECT_NE(written().find("\x1b[7m Connecting...      \x1b[0m"), std::string::npos);
}

TEST_F(View, DrawsEverythingAgainAfterAChangeOfSize) {
    TerminalWatchView view(*terminal);
    view.showDisplay({"a", "b", "c"}, "s");
    const winsize size{3, 30, 0, 0};
    ioctl(_program.get(), TIOCSWINSZ, &size);
    written();
    view.redraw();
    const std::string drawn = written();
    EXPECT_EQ(drawn.find("\x1b[2J\x1b[1;1Ha\x1b[K\x1b[2;1Hb\x1b[K\x1b[3;1H\x1b[7m s"), 0U);
    EXPECT_NE(drawn.find("1-2 of 3"), std::string::npos);
}

}  // namespace
}  // namespace kelvo
