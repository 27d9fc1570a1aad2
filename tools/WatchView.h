#pragma once

#include <memory>
#include <string>
#include <vector>

#include "tools/Terminal.h"
#include "tools/TerminalKeys.h"

namespace kelvo {

/// What stands under the live screens.
struct WatchStatus {
    std::string text;    ///< when the values are from
    std::string remark;  ///< why there are none, or for how long no records have come; empty: nothing to remark
};

/// What is known of one of the display's lines.
struct WatchNote {
    std::string text;    ///< the record that wrote its value last, "0xb17f #4711, 3 s"; empty for a line without one
    bool isOld = false;  ///< no record has written it for long
};

/// Where the live screens are shown. Main thread only.
class WatchView {
public:
    virtual ~WatchView() = default;
    /// Shows a new display, line by line, and the status that came with it.
    virtual void showDisplay(std::vector<std::string> lines, const WatchStatus& status) = 0;
    /// The display has aged, and nothing else: what is printed does not.
    virtual void showAged(std::vector<std::string> lines, const WatchStatus& status) = 0;
    /// Shows a new status; the display stays.
    virtual void showStatus(const WatchStatus& status) = 0;
    /// What is known of the lines, in their order: shown with the next display or status.
    virtual void setNotes(std::vector<WatchNote> notes) = 0;
};

/// Prints every display under its status line, for pipes and files, and terminals that can do no more.
class PrintedWatchView final : public WatchView {
public:
    void showDisplay(std::vector<std::string> lines, const WatchStatus& status) override;
    void showAged(std::vector<std::string>, const WatchStatus& status) override { showStatus(status); }
    void showStatus(const WatchStatus& status) override;
    void setNotes(std::vector<WatchNote>) override {}  // what is printed does not age

private:
    std::string _news;  // what the status printed last says, but for its number
};

/// A window on the display's lines, old ones faint; the status in the last row but one, place and keys in the last.
class TerminalWatchView final : public WatchView {
public:
    explicit TerminalWatchView(Terminal& terminal) : _terminal(terminal) {}

    void showDisplay(std::vector<std::string> lines, const WatchStatus& status) override;
    void showAged(std::vector<std::string> lines, const WatchStatus& status) override {
        showDisplay(std::move(lines), status);
    }
    void showStatus(const WatchStatus& status) override;
    void setNotes(std::vector<WatchNote> notes) override { _notes = std::move(notes); }
    /// Scrolls, and shows or hides the notes; Overview and Quit are for the caller.
    void press(TerminalKey key);
    /// What is shown next is another display, to be seen from its beginning.
    void goToTop() { _top = _left = 0; }
    /// Draws again with the terminal's size as it is now.
    void redraw();

private:
    void draw();
    std::size_t pageRows() const;
    std::vector<std::string> shownLines() const;

    Terminal& _terminal;
    std::vector<std::string> _lines;
    std::vector<WatchNote> _notes;
    bool _showsNotes = false;
    WatchStatus _status;
    std::size_t _top = 0;   // the first line shown
    std::size_t _left = 0;  // the first column shown
};

}  // namespace kelvo
