#include "tools/WatchView.h"

#include <fmt/format.h>

#include <algorithm>
#include <array>
#include <string_view>

#include "tools/StandardOutput.h"
#include "tools/TerminalText.h"

namespace kelvo {

namespace {

constexpr std::size_t kStatusRows = 2;
constexpr std::size_t kWidestBesideNotes = 60;  // one long value does not push all notes away
constexpr std::array<std::string_view, 2> kKeys = {"o overview, p ages, q quits", "p ages, q quits"};

std::string oneLine(const WatchStatus& status) {
    return status.remark.empty() ? status.text : status.text + "  " + status.remark;
}

/// What does not fit beside the status takes its place: it says why the values are old.
std::string statusRow(const WatchStatus& status, std::size_t columns) {
    const std::string whole = oneLine(status);
    const bool fits = columnsOf(whole) < columns || status.remark.empty();
    return fmt::format("{:<{}}", " " + (fits ? whole : status.remark), columns);
}

/// Where the window lies, and at the right edge the keys, as many as there is room for.
std::string placeRow(const std::string& place, std::size_t columns) {
    for (const std::string_view keys : kKeys) {
        const std::size_t left = columns - std::min(columns, keys.size());
        if (place.size() + 1 < left) return fmt::format("{:<{}}{}", " " + place, left, keys);
    }
    return fmt::format("{:<{}}", " " + place, columns);
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
        case TerminalKey::Provenance: _showsNotes = !_showsNotes; break;
        case TerminalKey::Overview:
        case TerminalKey::Quit: return;
    }
    draw();
}

void TerminalWatchView::redraw() {
    _terminal.forget();
    draw();
}

/// The lines, and with the notes these in a column of their own.
std::vector<std::string> TerminalWatchView::shownLines() const {
    std::vector<std::string> lines = _lines;
    if (!_showsNotes) return lines;
    std::size_t widest = 0;
    for (const std::string& line : lines) widest = std::max(widest, std::min(columnsOf(line), kWidestBesideNotes));
    for (std::size_t i = 0; i < std::min(lines.size(), _notes.size()); ++i) {
        if (_notes[i].text.empty()) continue;
        const std::size_t columns = columnsOf(lines[i]);
        lines[i].append(widest - std::min(widest, columns), ' ').append("  ").append(_notes[i].text);
    }
    return lines;
}

void TerminalWatchView::draw() {
    const std::vector<std::string> lines = shownLines();
    const std::size_t columns = _terminal.size().columns;
    const std::size_t page = pageRows();
    std::size_t widest = 0;
    for (const std::string& line : lines) widest = std::max(widest, columnsOf(line));
    _top = std::min(_top, lines.size() - std::min(lines.size(), page));
    _left = std::min(_left, widest - std::min(widest, columns));

    const std::size_t count = std::min(page, lines.size() - _top);
    std::vector<Terminal::Row> rows;
    for (std::size_t i = _top; i < _top + count; ++i) {
        const bool isOld = i < _notes.size() && _notes[i].isOld;
        rows.push_back({clipped(lines[i], _left, columns), isOld ? Terminal::Look::Faint : Terminal::Look::Plain});
    }
    rows.resize(page);
    rows.push_back({statusRow(_status, columns), Terminal::Look::Reverse});
    const std::string place = count > 0 ? fmt::format("{}-{} of {}", _top + 1, _top + count, lines.size()) : "";
    rows.push_back({placeRow(place, columns), Terminal::Look::Reverse});
    _terminal.draw(rows);
}

}  // namespace kelvo
