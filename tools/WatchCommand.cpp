#include "tools/WatchCommand.h"

#include <fmt/format.h>
#include <langinfo.h>
#include <unistd.h>

#include <QCoreApplication>
#include <array>
#include <clocale>
#include <csignal>
#include <cstdlib>
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
#include "tools/RetryLog.h"
#include "tools/WatchView.h"

namespace kelvo {

namespace {

/// The model and what the view shows of it.
class Watch {
public:
    Watch(MainQueue& queue, MessagePorts& ports, TelephonyClient& telephony, WatchView& view, RetryLog* log)
        : _view(view),
          _log(log),
          _model({.queue = queue,
                  .ports = ports,
                  .telephony = telephony,
                  .updateViewControllerFromModel = [this] { update(); },
                  .portName = fmt::format("{}.watch.{}", KelvoModel::kLogChannelPortName, getpid()),
                  .connectionChanged = [this] { updateStatus(); }}) {
        queue.post([this] { _model.restartMonitor(); });
        _ageTimer = queue.repeat(kAgesEvery, [this] { updateStatus(); });
        updateStatus();
    }

private:
    void update() {
        if (!_model.isConnected()) return updateStatus();
        _root = _model.topLevelNodes();
        const std::tm now = clock().local(clock().now());
        std::array<char, 64> text{};
        std::strftime(text.data(), text.size(), "Updated %Y-%m-%d at %H:%M:%S", &now);
        _updateMessage = text.data();
        _lines = _root ? displayLines(*_root) : std::vector<DisplayLine>();
        std::vector<std::string> texts;
        for (const DisplayLine& line : _lines) texts.push_back(line.text);
        _view.setNotes(notes());
        _view.showDisplay(std::move(texts), status());
    }

    void updateStatus() {
        if (_log != nullptr) _log->setConnected(_model.isConnected());
        _view.setNotes(notes());
        _view.showStatus(status());
    }

    std::vector<WatchNote> notes() const {
        std::vector<WatchNote> notes;
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
    NodeRef _root;                                       // which the lines show
    std::vector<DisplayLine> _lines;                     // of the last update
    RetryLog* const _log;                                // none: there is no log
    std::string _updateMessage = statusText(false, {});  // until the first update
    KelvoModel _model;
    std::unique_ptr<RepeatingTimer> _ageTimer;  // values age while nothing comes
};

/// Qt complains on standard error about a locale that is not UTF-8, which a bare shell on a router board has.
void ensureUtf8Locale() {
    std::setlocale(LC_ALL, "");
    if (std::string_view(nl_langinfo(CODESET)) != "UTF-8") setenv("LC_ALL", "C.UTF-8", 1);
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
            _view.press(key);
        }
    }

    Terminal _terminal{STDIN_FILENO, STDOUT_FILENO};
    TerminalWatchView _view{_terminal};
    TerminalKeys _keys;
    std::optional<FdWatcher> _input;
};

/// A terminal that is none, or says that it obeys nothing, gets plain text.
bool canBeDrawnOn(int output) {
    const char* type = std::getenv("TERM");
    return isatty(output) != 0 && type != nullptr && type[0] != '\0' && std::string_view(type) != "dumb";
}

void watch() {
    ensureUtf8Locale();
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
    const Watch watch(queue, ports, telephony, view, retryLog ? &*retryLog : nullptr);
    HostEventLoop::run(QCoreApplication::exec);
}

}  // namespace

void addWatchCommand(CLI::App& app) {
    CLI::App& command = addCommand(app, "watch", "Shows the live screens, refreshed every two seconds");
    command.footer(
        "On a terminal: arrows, PageUp, PageDown, Home and End scroll, q quits. What does not fit ends with \"…\"; "
        "Left\n"
        "and Right lead to it. p shows which record wrote each value last (its code, its number, how long ago), and\n"
        "hides it. A value that no record has written for 30 seconds is drawn faint.\n"
        "Elsewhere, and with TERM=dumb, every refresh is printed under its status line; the log goes to standard "
        "error\n"
        "when that is no terminal.\n\n"
        "Examples:\n"
        "  kelvoctl watch\n"
        "  kelvoctl watch 2>watch.log\n"
        "  kelvoctl watch | grep 'Physical Cell ID'\n");
    command.callback([] { watch(); });
}

}  // namespace kelvo
