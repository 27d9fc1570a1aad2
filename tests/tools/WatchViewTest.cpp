#include "tools/WatchView.h"

#include <gtest/gtest.h>
#include <pty.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <clocale>
#include <optional>

#include "platform/host/UniqueFd.h"
#include "tests/support/RecordingLog.h"
#include "tools/RetryLog.h"
#include "tools/TerminalText.h"

namespace kelvo {
namespace {

using Keys = std::vector<TerminalKey>;

TEST(TerminalKeys, KnowsBothFormsOfTheArrows) {
    EXPECT_EQ(TerminalKeys().feed("\x1b[A\x1bOB"), (Keys{TerminalKey::Up, TerminalKey::Down}));
    EXPECT_EQ(TerminalKeys().feed("\x1b[5~\x1b[6~\x1b[H\x1bOF"),
              (Keys{TerminalKey::PageUp, TerminalKey::PageDown, TerminalKey::Home, TerminalKey::End}));
    EXPECT_EQ(TerminalKeys().feed("\x1b[D\x1bOC"), (Keys{TerminalKey::Left, TerminalKey::Right}));
    EXPECT_EQ(TerminalKeys().feed("op"), (Keys{TerminalKey::Overview, TerminalKey::Provenance}));
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

/// A terminal of 5 rows and 20 columns, for a page of 3 rows, and what was written to it.
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
    view.showDisplay({"one", "two"}, {"status", ""});
    written();
    view.showDisplay({"one", "2"}, {"status", ""});
    EXPECT_EQ(written(), "\x1b[2;1H\x1b[K2");
    view.showDisplay({"one", "2"}, {"status", ""});
    EXPECT_EQ(written(), "");
    view.showStatus({"new", ""});
    EXPECT_EQ(written(), "\x1b[4;1H\x1b[K\x1b[7m new                \x1b[0m");
}

TEST_F(View, AnnouncesWhatItCutsOff) {
    written();
    terminal->draw({Terminal::Row{"ääääääääääääääääääääXY"}});
    EXPECT_EQ(written(), "\x1b[1;1H\x1b[Käääääääääääääääääää…");
    terminal->draw({Terminal::Row{"äääääääääääääääääääZ"}});
    EXPECT_EQ(written(), "\x1b[1;1H\x1b[KäääääääääääääääääääZ");
}

TEST_F(View, ScrollsWithinTheDisplay) {
    TerminalWatchView view(*terminal);
    view.showDisplay({"a", "b", "c", "d", "e"}, {"s", ""});
    EXPECT_NE(written().find("1-3 of 5"), std::string::npos);
    view.press(TerminalKey::Down);
    EXPECT_EQ(written().substr(0, 14), "\x1b[1;1H\x1b[Kb\x1b[2;");
    view.press(TerminalKey::PageDown);
    EXPECT_NE(written().find("3-5 of 5"), std::string::npos);
    view.press(TerminalKey::Down);
    EXPECT_EQ(written(), "");
    view.press(TerminalKey::Home);
    EXPECT_NE(written().find("1-3 of 5"), std::string::npos);
    view.press(TerminalKey::End);
    EXPECT_NE(written().find("3-5 of 5"), std::string::npos);
    view.showDisplay({"a"}, {"s", ""});
    EXPECT_NE(written().find("\x1b[1;1H\x1b[Ka"), std::string::npos);
}

TEST_F(View, ScrollsAsideToWhatDoesNotFit) {
    TerminalWatchView view(*terminal);
    view.showDisplay({"Address  2001:db8:0:1:2:3:4:5", "  Cell  00000102"}, {"s", ""});
    EXPECT_NE(written().find("\x1b[1;1H\x1b[KAddress  2001:db8:0…\x1b[2;1H\x1b[K  Cell  00000102"), std::string::npos);
    view.press(TerminalKey::Left);
    EXPECT_EQ(written(), "");
    view.press(TerminalKey::Right);  // as far as there is something: 29 columns, 20 of them in sight
    EXPECT_EQ(written(), "\x1b[1;1H\x1b[K…001:db8:0:1:2:3:4:5\x1b[2;1H\x1b[K…000102");
    view.press(TerminalKey::Right);
    EXPECT_EQ(written(), "");
    view.press(TerminalKey::Left);
    EXPECT_EQ(written(), "\x1b[1;1H\x1b[KAddress  2001:db8:0…\x1b[2;1H\x1b[K  Cell  00000102");
}

TEST_F(View, DrawsWhatIsOldFaintAndAKeyShowsTheRecords) {
    const winsize size{5, 40, 0, 0};
    ioctl(_program.get(), TIOCSWINSZ, &size);
    TerminalWatchView view(*terminal);
    view.setNotes({{}, {"0xb17f #4711, 3 s", false}, {"0xb0c2 #12, 40 s", true}});
    view.showDisplay({"Cell", "  Srxlev  12", "  PCI  7"}, {"s", ""});
    EXPECT_NE(written().find("\x1b[1;1H\x1b[KCell\x1b[2;1H\x1b[K  Srxlev  12\x1b[3;1H\x1b[K\x1b[2m  PCI  7\x1b[0m"),
              std::string::npos);
    view.press(TerminalKey::Provenance);
    EXPECT_EQ(written(),
              "\x1b[2;1H\x1b[K  Srxlev  12  0xb17f #4711, 3 s"
              "\x1b[3;1H\x1b[K\x1b[2m  PCI  7      0xb0c2 #12, 40 s\x1b[0m");
    view.setNotes({{}, {"0xb17f #4711, 30 s", true}, {"0xb0c2 #13, 0 s", false}});
    view.showStatus({"s", ""});
    EXPECT_EQ(written(),
              "\x1b[2;1H\x1b[K\x1b[2m  Srxlev  12  0xb17f #4711, 30 s\x1b[0m"
              "\x1b[3;1H\x1b[K  PCI  7      0xb0c2 #13, 0 s");
    view.press(TerminalKey::Provenance);
    EXPECT_EQ(written(), "\x1b[2;1H\x1b[K\x1b[2m  Srxlev  12\x1b[0m\x1b[3;1H\x1b[K  PCI  7");
}

TEST_F(View, KeepsPlaceAndKeysInSightFrom34ColumnsOn) {
    const winsize size{5, 34, 0, 0};
    ioctl(_program.get(), TIOCSWINSZ, &size);
    TerminalWatchView view(*terminal);
    view.showDisplay(std::vector<std::string>(1450, "a"), {"Updated 2026-11-22 at 06:00:00", ""});
    EXPECT_NE(written().find("\x1b[4;1H\x1b[K\x1b[7m Updated 2026-11-22 at 06:00:00   \x1b[0m"
                             "\x1b[5;1H\x1b[K\x1b[7m 1-3 of 1450       p ages, q quits\x1b[0m"),
              std::string::npos);
    view.press(TerminalKey::End);
    EXPECT_NE(written().find("\x1b[7m 1448-1450 of 1450 p ages, q quits\x1b[0m"), std::string::npos);
}

TEST_F(View, HasAllKeysWhereThereIsRoom) {
    const winsize size{5, 60, 0, 0};
    ioctl(_program.get(), TIOCSWINSZ, &size);
    TerminalWatchView view(*terminal);
    view.showDisplay({"a"}, {"s", ""});
    EXPECT_NE(written().find(" 1-1 of 1" + std::string(24, ' ') + "o overview, p ages, q quits"), std::string::npos);
}

TEST_F(View, AnotherDisplayIsSeenFromItsBeginning) {
    TerminalWatchView view(*terminal);
    view.showDisplay({"a", "b", "c", "d", "e"}, {"s", ""});
    view.press(TerminalKey::End);
    written();
    view.goToTop();
    view.showAged({"1", "2", "3", "4"}, {"s", ""});
    EXPECT_NE(written().find("\x1b[1;1H\x1b[K1\x1b[2;1H\x1b[K2"), std::string::npos);
}

TEST_F(View, DropsTheKeysBeforeThePlaceInFewerColumns) {
    TerminalWatchView view(*terminal);
    view.showDisplay({"a"}, {"Updated 2026-11-22 at 06:00:00", ""});
    EXPECT_NE(written().find("\x1b[4;1H\x1b[K\x1b[7m Updated 2026-11-22…\x1b[0m"
                             "\x1b[5;1H\x1b[K\x1b[7m 1-1 of 1           \x1b[0m"),
              std::string::npos);
}

TEST_F(View, ARemarkStandsBesideTheStatusOrInItsPlace) {
    TerminalWatchView view(*terminal);
    view.showStatus({"Now", "No records"});
    EXPECT_NE(written().find("\x1b[7m Now  No records    \x1b[0m"), std::string::npos);
    view.showStatus({"Updated", "No records for 24 s"});
    EXPECT_NE(written().find("\x1b[7m No records for 24 s\x1b[0m"), std::string::npos);
}

TEST_F(View, DrawsEverythingAgainAfterAChangeOfSize) {
    TerminalWatchView view(*terminal);
    view.showDisplay({"a", "b", "c"}, {"s", ""});
    const winsize size{4, 30, 0, 0};
    ioctl(_program.get(), TIOCSWINSZ, &size);
    written();
    view.redraw();
    const std::string drawn = written();
    EXPECT_EQ(drawn.find("\x1b[2J\x1b[1;1H\x1b[Ka\x1b[2;1H\x1b[Kb\x1b[3;1H\x1b[K\x1b[7m s"), 0U);
    EXPECT_NE(drawn.find("1-2 of 3"), std::string::npos);
}

/// What the printed view writes in `work`.
template <class Work>
std::string printed(Work work) {
    testing::internal::CaptureStdout();
    work();
    return testing::internal::GetCapturedStdout();
}

TEST(PrintedView, PrintsEveryDisplayUnderItsStatus) {
    PrintedWatchView view;
    EXPECT_EQ(printed([&] {
                  view.showStatus({"Connecting...", "No telephony service is running"});
                  view.showDisplay({"a  1", "b  2"}, {"Updated", ""});
                  view.showDisplay({"a  1"}, {"Updated", ""});
              }),
              "Connecting...  No telephony service is running\nUpdated\na  1\nb  2\nUpdated\na  1\n");
}

TEST(PrintedView, WhatIsPrintedDoesNotAge) {
    PrintedWatchView view;
    EXPECT_EQ(printed([&] {
                  view.showDisplay({"RSRP  -90.00 dBm, 0 s ago"}, {"Updated", ""});
                  view.showAged({"RSRP  -90.00 dBm, 2 s ago"}, {"Updated", ""});
              }),
              "Updated\nRSRP  -90.00 dBm, 0 s ago\nUpdated\n");
}

TEST(PrintedView, TellsOnceThatNoRecordsCome) {
    PrintedWatchView view;
    EXPECT_EQ(printed([&] {
                  view.showStatus({"Updated", "No records for 10 s"});
                  view.showStatus({"Updated", "No records for 12 s"});
                  view.showStatus({"Connecting...", "No telephony service is running"});
                  view.showStatus({"Connecting...", "No telephony service is running"});
              }),
              "Updated  No records for 10 s\nConnecting...  No telephony service is running\n");
}

TEST(ClippedText, ShowsWhatFitsAndMarksTheEdgesItGoesBeyond) {
    EXPECT_EQ(clipped("0123456789", 0, 10), "0123456789");
    EXPECT_EQ(clipped("0123456789", 0, 9), "01234567…");
    EXPECT_EQ(clipped("0123456789", 3, 5), "…456…");
    EXPECT_EQ(clipped("0123456789", 5, 5), "…6789");
    EXPECT_EQ(clipped("0123456789", 12, 5), "…");
    EXPECT_EQ(clipped("    value", 4, 5), "value");  // nothing but blanks lies before
    EXPECT_EQ(clipped("", 0, 5), "");
    EXPECT_EQ(clipped("0123456789", 3, 1), "…");
    EXPECT_EQ(clipped("0123456789", 3, 0), "");
}

TEST(ClippedText, CountsColumnsNotBytes) {
    const std::string before = std::setlocale(LC_CTYPE, nullptr);
    ASSERT_NE(std::setlocale(LC_CTYPE, "C.UTF-8"), nullptr);
    EXPECT_EQ(columnsOf("äöü"), 3U);
    EXPECT_EQ(columnsOf("中国移动"), 8U);
    EXPECT_EQ(clipped("中国移动", 0, 8), "中国移动");
    EXPECT_EQ(clipped("中国移动", 0, 6), "中国 …");
    std::setlocale(LC_CTYPE, before.c_str());
}

TEST(RetryLog, TellsOfAFailedStartOnceUntilTheConnectionHasBeenThere) {
    test::RecordingLog log;
    RetryLog retry(log);
    const auto tryToStart = [&] { retry.write(Level::Error, "Could not create PLServerConnection"); };
    tryToStart();
    tryToStart();
    EXPECT_EQ(log.lines().size(), 1U);
    retry.setConnected(true);
    retry.write(Level::Warning, "LTE Serving Cell Info");
    retry.write(Level::Warning, "LTE Serving Cell Info");
    EXPECT_EQ(log.lines().size(), 3U);
    retry.setConnected(false);
    tryToStart();
    tryToStart();
    EXPECT_EQ(log.lines().size(), 4U);
}

}  // namespace
}  // namespace kelvo
