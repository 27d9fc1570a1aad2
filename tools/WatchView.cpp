#include "tools/WatchView.h"

#include <fmt/format.h>

#include <algorithm>
#include <initializer_list>

#include "tools/StandardOutput.h"

namespace kelvo {

namespace {

/// The status, and at the right edge the first of `hints` that leaves room for it.
std::string statusRow(const std::string& status, std::initializer_list<std::string> hints, std::size_t columns) {
    for (const std::string& hint : hints) {
        const std::size_t left = columns - std::min(columns, hint.size() + 1);
        if (status.size() < left) return fmt::format(" {:<{}}{}", status, left, hint);
    }
    return fmt::format(" {:<{}}", status, columns);
}

}  // namespace

void PrintedWatchView::showDisplay(std::vector<std::string> lines, const std::string& status) {
    std::string text = status + "\n";
    for (const std::string& line : lines) text.append(line).append("\n");
    writeToStandardOutput(text);
}

void PrintedWatchView::showStatus(const std::string& status) { writeToStandardOutput(status + "\n"); }

void TerminalWatchView::showDisplay(std::vector<std::string> lines, const std::string& status) {
    _lines = std::move(lines);
    _status = status;
    draw();
}

void TerminalWatchView::showStatus(const std::string& status) {
    _status = status;
    draw();
}

void TerminalWatchView::press(TerminalKey key) {
    const std::size_t page = _terminal.size().rows - 1;
    switch (key) {
        case TerminalKey::Up: _top -= std::min<std::size_t>(_top, 1); break;
        case TerminalKey::Down: _top += 1; break;
        case TerminalKey::PageUp: _top -= std::min(_top, page); break;
        case TerminalKey::PageDown: _top += page; break;
        case TerminalKey::Home: _top = 0; break;
        case TerminalKey::End: _top = _lines.size(); break;
        case TerminalKey::Quit: return;
    }
    draw();
}

void TerminalWatchView::redraw() {
    _terminal.forget();
    draw();
}

void TerminalWatchView::draw() {
    const auto [rows, columns] = _terminal.size();
    const std::size_t page = rows - 1;
    _top = std::min(_top, _lines.size() - std::min(_lines.size(), page));
    const auto first = _lines.begin() + static_cast<std::ptrdiff_t>(_top);
    const std::size_t count = std::min(page, _lines.size() - _top);
    std::vector<std::string> shown(first, first + static_cast<std::ptrdiff_t>(count));
    shown.resize(page);
    const std::string where =
        count < _lines.size() ? fmt::format("{}-{} of {} ", _top + 1, _top + count, _lines.size()) : "";
    shown.push_back(statusRow(_status, {where + " q quits ", where}, columns));
    _terminal.draw(shown, page);
}

}  // namespace kelvo
