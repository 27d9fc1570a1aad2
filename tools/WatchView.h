#pragma once

#include <memory>
#include <string>
#include <vector>

#include "tools/Terminal.h"
#include "tools/TerminalKeys.h"

namespace kelvo {

/// Where the live screens are shown. Main thread only.
class WatchView {
public:
    virtual ~WatchView() = default;
    /// Shows a new display, line by line, and the status that came with it.
    virtual void showDisplay(std::vector<std::string> lines, const std::string& status) = 0;
    /// Shows a new status; the display stays.
    virtual void showStatus(const std::string& status) = 0;
};

/// Prints every display under its status line, for pipes and files.
class PrintedWatchView final : public WatchView {
public:
    void showDisplay(std::vector<std::string> lines, const std::string& status) override;
    void showStatus(const std::string& status) override;
};

/// A window on the display's lines, and the status in the last row.
class TerminalWatchView final : public WatchView {
public:
    explicit TerminalWatchView(Terminal& terminal) : _terminal(terminal) {}

    void showDisplay(std::vector<std::string> lines, const std::string& status) override;
    void showStatus(const std::string& status) override;
    /// Scrolls; Quit is for the caller.
    void press(TerminalKey key);
    /// Draws again with the terminal's size as it is now.
    void redraw();

private:
    void draw();

    Terminal& _terminal;
    std::vector<std::string> _lines;
    std::string _status;
    std::size_t _top = 0;  // the first line shown
};

}  // namespace kelvo
