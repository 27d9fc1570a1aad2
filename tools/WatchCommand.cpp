#include "tools/WatchCommand.h"

#include <fmt/format.h>
#include <langinfo.h>
#include <unistd.h>

#include <QCoreApplication>
#include <array>
#include <clocale>
#include <csignal>
#include <cstdlib>
#include <functional>
#include <memory>
#include <optional>

#include "model/KelvoModel.h"
#include "platform/host/FdWatcher.h"
#include "platform/host/HostEventLoop.h"
#include "platform/host/HostMainQueue.h"
#include "platform/host/HostMessagePorts.h"
#include "platform/host/HostSystemLog.h"
#include "platform/host/HostTelephonyClient.h"
#include "platform/host/UnixSignals.h"
#include "platform/system/Environment.h"
#include "tools/Command.h"
#include "tools/DisplayText.h"
#include "tools/OverviewText.h"
#include "tools/RetryLog.h"
#include "tools/WatchView.h"

namespace kelvo {

namespace {

using overview::LiveOverview;

/// The model and what the view shows of it.
class Watch {
public:
    struct Options {
        bool overview = false;   ///< shows it first
        bool hasBlocks = false;  ///< the terminal can
    };

    Watch(MainQueue& queue, MessagePorts& ports, TelephonyClient& telephony, WatchView& view, RetryLog* log,
          const Options& options)
        : _view(view),
          _log(log),
          _showsOverview(options.overview),
          _model({.queue = queue,
                  .ports = ports,
                  .telephony = telephony,
                  .updateViewControllerFromModel = [this] { update(); },
                  .portName = fmt::format("{}.watch.{}", KelvoModel::kLogChannelPortName, getpid()),
                  .connectionChanged = [this] { connectionChanged(); }}),
          _overview(_model),
          _overviewText(_overview, options.hasBlocks) {
        queue.post([this] { _model.restartMonitor(); });
        _ageTimer = queue.repeat(kAgesEvery, [this] { age(); });
        updateStatus();
    }

    /// From the screens to the overview, or back.
    void switchOverview() {
        _showsOverview = !_showsOverview;
        _view.setNotes(notes());
        _view.showAged(lines(), status());
    }

private:
    void update() {
        _overview.refreshed();
        if (!_model.isConnected()) return updateStatus();
        _root = _model.topLevelNodes();
        const std::tm now = clock().local(clock().now());
        std::array<char, 64> text{};
        std::strftime(text.data(), text.size(), "Updated %Y-%m-%d at %H:%M:%S", &now);
        _updateMessage = text.data();
        _lines = _root ? displayLines(*_root) : std::vector<DisplayLine>();
        _view.setNotes(notes());
        _view.showDisplay(lines(), status());
    }

    void connectionChanged() {
        _overview.connectionChanged();
        updateStatus();
    }

    /// The overview's texts tell ages, the screens' notes do.
    void age() {
        _overview.letPass();
        if (!_showsOverview) return updateStatus();
        _view.showAged(lines(), status());
    }

    std::vector<std::string> lines() {
        if (_showsOverview) return _root ? _overviewText.lines() : std::vector<std::string>();
        std::vector<std::string> texts;
        for (const DisplayLine& line : _lines) texts.push_back(line.text);
        return texts;
    }

    void updateStatus() {
        if (_log != nullptr) _log->setConnected(_model.isConnected());
        _view.setNotes(notes());
        _view.showStatus(status());
    }

    std::vector<WatchNote> notes() const {
        std::vector<WatchNote> notes;
        if (_showsOverview) return notes;
        for (const DisplayLine& line : _lines) {
            const auto provenance = _model.provenance(*line.node);
            notes.push_back(provenance ? noteOf(*provenance) : WatchNote());
        }
        return notes;
    }
    static WatchNote noteOf(const Provenance& provenance) {
        const std::string code = provenance.code ? fmt::format("0x{:04x} ", *provenance.code) : "";
        const auto seconds = std::chrono::floor<std::chrono::seconds>(provenance.age);
        return {fmt::format("{}#{}, {} s", code, provenance.record, seconds.count()), provenance.age >= kOld};
    }

    WatchStatus status() const {
        return {statusText(_model.isConnected(), _updateMessage), connectionText(_model.connection())};
    }

    static constexpr auto kAgesEvery = std::chrono::seconds(2);
    static constexpr auto kOld = std::chrono::seconds(30);

    WatchView& _view;
    NodeRef _root;                    // which the lines show
    std::vector<DisplayLine> _lines;  // of the last update
    RetryLog* const _log;             // none: there is no log
    bool _showsOverview;
    std::string _updateMessage = statusText(false, {});  // until the first update
    KelvoModel _model;
    LiveOverview _overview;  // which goes on while the screens are shown
    LiveOverviewText _overviewText;
    std::unique_ptr<RepeatingTimer> _ageTimer;  // values age while nothing comes
};

/// Qt complains on standard error about a locale that is not UTF-8, which a bare shell on a router board has. Whether
/// it was one: then the terminal shows more than ASCII.
bool ensureUtf8Locale() {
    std::setlocale(LC_ALL, "");
    if (std::string_view(nl_langinfo(CODESET)) == "UTF-8") return true;
    setenv("LC_ALL", "C.UTF-8", 1);
    return false;
}

/// The terminal's part in a watch: keys scroll and quit, signals resize, suspend and quit.
class TerminalControl {
public:
    TerminalControl() {
        if (isatty(STDIN_FILENO) != 0) {
            _input.emplace(STDIN_FILENO, FdWatcher::For::Reading, [this] { readKeys(); });
        }
    }

    TerminalWatchView& view() { return _view; }
    /// What to do when the overview is asked for.
    void setSwitchOverview(std::function<void()> work) { _switchOverview = std::move(work); }
    void resized() { _view.redraw(); }
    void suspend() {
        _terminal.leave();
        std::raise(SIGSTOP);  // returns when the user takes the program to the front again
        _terminal.enter();
        _view.redraw();
    }

private:
    void readKeys() {
        std::array<char, 256> bytes{};
        const ssize_t count = ::read(STDIN_FILENO, bytes.data(), bytes.size());
        if (count <= 0) return QCoreApplication::quit();
        for (const TerminalKey key : _keys.feed({bytes.data(), static_cast<std::size_t>(count)})) {
            if (key == TerminalKey::Quit) return QCoreApplication::quit();
            if (key == TerminalKey::Overview && _switchOverview) {
                _view.goToTop();
                _switchOverview();
            }
            _view.press(key);
        }
    }

    Terminal _terminal{STDIN_FILENO, STDOUT_FILENO};
    TerminalWatchView _view{_terminal};
    TerminalKeys _keys;
    std::function<void()> _switchOverview;
    std::optional<FdWatcher> _input;
};

/// A terminal that is none, or says that it obeys nothing, gets plain text.
bool canBeDrawnOn(int output) {
    const char* type = std::getenv("TERM");
    return isatty(output) != 0 && type != nullptr && type[0] != '\0' && std::string_view(type) != "dumb";
}

void watch(bool showsOverview) {
    const bool hasBlocks = ensureUtf8Locale();
    std::string name = "kelvoctl";
    std::array<char*, 2> arguments{name.data(), nullptr};
    int count = 1;
    const QCoreApplication application(count, arguments.data());

    // The log would write into the picture, unless it is sent elsewhere.
    std::optional<HostSystemLog> log;
    if (isatty(STDERR_FILENO) == 0) log.emplace("kelvoctl", HostSystemLog::To::StandardError);
    std::optional<RetryLog> retryLog;
    if (log) retryLog.emplace(*log);
    Environment environment = Environment::current();
    environment.log = retryLog ? &*retryLog : nullptr;
    const Environment::Scope scope(environment);

    std::optional<TerminalControl> terminal;
    if (canBeDrawnOn(STDOUT_FILENO)) terminal.emplace();
    PrintedWatchView printed;
    WatchView& view = terminal ? static_cast<WatchView&>(terminal->view()) : printed;

    const UnixSignals unixSignals({SIGINT, SIGTERM, SIGHUP, SIGWINCH, SIGTSTP}, [&terminal](int signal) {
        if (signal == SIGTSTP) {
            terminal ? terminal->suspend() : static_cast<void>(std::raise(SIGSTOP));
        } else if (signal != SIGWINCH) {
            QCoreApplication::quit();
        } else if (terminal) {
            terminal->resized();
        }
    });
    HostMainQueue queue;
    HostMessagePorts ports;
    HostTelephonyClient telephony(ports);
    Watch watch(queue, ports, telephony, view, retryLog ? &*retryLog : nullptr,
                {.overview = showsOverview, .hasBlocks = hasBlocks});
    if (terminal) terminal->setSwitchOverview([&watch] { watch.switchOverview(); });
    HostEventLoop::run(QCoreApplication::exec);
    if (terminal) terminal->setSwitchOverview(nullptr);
}

}  // namespace

void addWatchCommand(CLI::App& app) {
    CLI::App& command = addCommand(app, "watch", "Shows the live screens, refreshed every two seconds");
    const auto overview = std::make_shared<bool>(false);
    command.add_flag("--overview", *overview,
                     "Shows the overview first: the serving cell, the cells around, what happened");
    command.footer(
        "On a terminal: arrows, PageUp, PageDown, Home and End scroll, q quits. What does not fit ends with \"…\"; "
        "Left\n"
        "and Right lead to it. p shows which record wrote each value last (its code, its number, how long ago), and\n"
        "hides it. A value that no record has written for 30 seconds is drawn faint. o leads to the overview and "
        "back;\n"
        "what happens is listed there whether it is shown or not. Its lines of two minutes need a UTF-8 locale.\n"
        "Elsewhere, and with TERM=dumb, every refresh is printed under its status line; the log goes to standard "
        "error\n"
        "when that is no terminal.\n\n"
        "Examples:\n"
        "  kelvoctl watch\n"
        "  kelvoctl watch --overview\n"
        "  kelvoctl watch 2>watch.log\n"
        "  kelvoctl watch | grep 'Physical Cell ID'\n");
    command.callback([overview] { watch(*overview); });
}

}  // namespace kelvo
