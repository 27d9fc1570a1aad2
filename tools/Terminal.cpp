#include "tools/Terminal.h"

#include <fmt/format.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>

#include "tools/TerminalText.h"

namespace kelvo {

namespace {

// Alternate screen, no cursor, no wrapping at the edge; and back in the other order.
constexpr std::string_view kEnter = "\x1b[?1049h\x1b[?25l\x1b[?7l\x1b[2J";
constexpr std::string_view kLeave = "\x1b[?7h\x1b[?25h\x1b[?1049l";

std::string looking(Terminal::Look look, std::string text) {
    switch (look) {
        case Terminal::Look::Plain: return text;
        case Terminal::Look::Faint: return "\x1b[2m" + text + "\x1b[0m";
        case Terminal::Look::Reverse: return "\x1b[7m" + text + "\x1b[0m";
    }
    return text;
}

}  // namespace

Terminal::Terminal(int input, int output) : _input(input), _output(output) { enter(); }

Terminal::~Terminal() { leave(); }

void Terminal::enter() {
    termios settings{};
    if (tcgetattr(_input, &settings) == 0) {
        _before = settings;
        settings.c_lflag &= ~static_cast<tcflag_t>(ICANON | ECHO);
        tcsetattr(_input, TCSADRAIN, &settings);
    }
    write(kEnter);
    _entered = true;
    _shown.clear();
}

void Terminal::leave() {
    if (!_entered) return;
    _entered = false;
    write(kLeave);
    if (_before) tcsetattr(_input, TCSADRAIN, &*_before);
}

Terminal::Size Terminal::size() const {
    winsize size{};
    if (ioctl(_output, TIOCGWINSZ, &size) != 0 || size.ws_row == 0 || size.ws_col == 0) return {24, 80};
    return {size.ws_row, size.ws_col};
}

void Terminal::forget() {
    write("\x1b[2J");
    _shown.clear();
}

void Terminal::draw(const std::vector<Row>& rows) {
    const std::size_t columns = size().columns;
    std::string out;
    std::vector<std::string> now;
    for (std::size_t i = 0; i < std::max(rows.size(), _shown.size()); ++i) {
        std::string row = i < rows.size() ? looking(rows[i].look, clipped(rows[i].text, 0, columns)) : std::string();
        // Erased first: after a full row the cursor stands on its last character.
        if (i >= _shown.size() || _shown[i] != row) out += fmt::format("\x1b[{};1H\x1b[K{}", i + 1, row);
        if (i < rows.size()) now.push_back(std::move(row));
    }
    _shown = std::move(now);
    write(out);  // in one piece, so that no half-drawn screen is seen
}

void Terminal::write(std::string_view text) const {
    while (!text.empty()) {
        const ssize_t count = ::write(_output, text.data(), text.size());
        if (count < 0 && errno != EINTR) return;  // the terminal is gone; its hangup ends the program
        text.remove_prefix(static_cast<std::size_t>(std::max<ssize_t>(count, 0)));
    }
}

}  // namespace kelvo
