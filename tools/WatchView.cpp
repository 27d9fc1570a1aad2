#include "tools/WatchView.h"

#include <fmt/format.h>

#include <algorithm>
#include <string_view>

#include "tools/StandardOutput.h"
#include "tools/TerminalText.h"

namespace kelvo {

namespace {

constexpr std::size_t kStatusRows = 2;
constexpr std::string_view kKeys = "arrows, q quits";

std::string oneLine(const WatchStatus& status) {
    return status.remark.empty() ? status.text : status.text + "  " + status.remark;
}

/// What does not fit beside the status takes its place: it says why the values are old.
std::string statusRow(const WatchStatus& status, std::size_t columns) {
    const std::string whole = oneLine(status);
    const bool fits = columnsOf(whole) < columns || status.remark.empty();
    return fmt::format("{:<{}}", " " + (fits ? whole : status.remark), columns);
}

/// Where the window lies, and the keys at the right edge as long as there is room for both.
std::string placeRow(const std::string& place, std::size_t columns) {
    const std::size_t left = columns - std::min(columns, kKeys.size());
    const bool fits = place.size() + 1 < left;
    return fmt::format("{:<{}}{}", " " + place, fits ? left : columns, fits ? kKeys : std::string_view());
}

}  // namespace

void PrintedWatchView::showDisplay(std::vector<std::string> lines, const WatchStatus& status) {
    std::string text = oneLine(status) + "\n";
    for (const std::string& line : lines) text.append(line).append("\n");
    writeToStandardOutput(text);
    _news.clear();
}

void PrintedWatchView::showStatus(const WatchStatus& status) {
    const std::string news = status.text + status.remark.substr(0, status.remark.find_first_of("0123456789"));
    if (news == _news) return;  // only a number has gone up
    _news = news;
    writeToStandardOutput(oneLine(status) + "\n");
}

void TerminalWatchView::showDisplay(std::vector<std::string> lines, const WatchStatus& status) {
    _lines = std::move(lines);
    _status = status;
    draw();
}

void TerminalWatchView::showStatus(const WatchStatus& status) {
    _status = status;
    draw();
}

std::size_t TerminalWatchView::pageRows() const {
    const std::size_t rows = _terminal.size().rows;
    return rows - std::min(rows, kStatusRows);
}

void TerminalWatchView::press(TerminalKey key) {
    const std::size_t page = pageRows();
    const std::size_t aside = std::max<std::size_t>(_terminal.size().columns / 2, 1);
    switch (key) {
        case TerminalKey::Up: _top -= std::min<std::size_t>(_top, 1); break;
        case TerminalKey::Down: _top += 1; break;
        case TerminalKey::Left: _left -= std::min(_left, aside); break;
        case TerminalKey::Right: _left += aside; break;
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
    const std::size_t columns = _terminal.size().columns;
    const std::size_t page = pageRows();
    std::size_t widest = 0;
    for (const std::string& line : _lines) widest = std::max(widest, columnsOf(line));
    _top = std::min(_top, _lines.size() - std::min(_lines.size(), page));
    _left = std::min(_left, widest - std::min(widest, columns));

    const std::size_t count = std::min(page, _lines.size() - _top);
    std::vector<std::string> rows;
    for (std::size_t i = 0; i < count; ++i) rows.push_back(clipped(_lines[_top + i], _left, columns));
    rows.resize(page);
    rows.push_back(statusRow(_status, columns));
    rows.push_back(
        placeRow(count > 0 ? fmt::format("{}-{} of {}", _top + 1, _top + count, _lines.size()) : "", columns));
    _terminal.draw(rows, page);
}

}  // namespace kelvo
