#include "telephony/wire/modem/PseudoTerminal.h"

#include <fcntl.h>
#include <fmt/format.h>
#include <poll.h>
#include <stdlib.h>
#include <termios.h>
#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <system_error>

#include "platform/system/Environment.h"

namespace kelvo::modem {
namespace {

using namespace std::chrono_literals;

constexpr auto kLook = 20ms;  // for a reader: a terminal does not tell when it is opened
constexpr std::string_view kTerminals = "/dev/pts/";

std::string lastError() { return std::generic_category().message(errno); }

// As a modem's port is: no line editing, and above all no echo, or the modem would hear itself.
bool makeRaw(int master) {
    termios settings{};
    if (::tcgetattr(master, &settings) != 0) return false;
    ::cfmakeraw(&settings);
    return ::tcsetattr(master, TCSANOW, &settings) == 0;
}

UniqueFd openTerminal(std::string& path) {
    UniqueFd master(::posix_openpt(O_RDWR | O_NOCTTY | O_CLOEXEC | O_NONBLOCK));
    char name[64];
    if (!master || ::grantpt(master.get()) != 0 || ::unlockpt(master.get()) != 0 || !makeRaw(master.get()) ||
        ::ptsname_r(master.get(), name, sizeof name) != 0)
        return {};
    path = name;
    // Opened and let go at once: the line is hung up from the beginning, as it is again whenever its reader goes.
    const UniqueFd once(::open(name, O_RDWR | O_NOCTTY | O_CLOEXEC));
    return master;
}

// A reader that was killed leaves its claim to have the terminal for itself alone; nobody but root can open it then.
bool isStillClaimed(const std::string& path) {
    const UniqueFd slave(::open(path.c_str(), O_RDWR | O_NOCTTY | O_CLOEXEC | O_NONBLOCK));
    return !slave && errno == EBUSY;
}

}  // namespace

Result<void> PseudoTerminal::plugIn() {
    _master = openTerminal(_path);
    if (!_master) return Failure{"a pseudo-terminal cannot be made: " + lastError()};
    if (const auto linked = makeLink(); !linked) {
        _master.reset();
        return linked;
    }
    _incoming = std::make_unique<FdWatcher>(_master.get(), FdWatcher::For::Reading, [this] { read(); });
    _room = std::make_unique<FdWatcher>(_master.get(), FdWatcher::For::Writing, [this] {
        _room->setEnabled(false);
        if (onRoom) onRoom();
    });
    waitForReader();
    return {};
}

void PseudoTerminal::unplug() {
    if (!_master) return;
    _absent.reset();
    _incoming.reset();
    _room.reset();
    std::error_code ignored;
    if (!_link.empty() && std::filesystem::read_symlink(_link, ignored) == _path)
        std::filesystem::remove(_link, ignored);
    _master.reset();
}

Result<void> PseudoTerminal::makeLink() {
    if (_link.empty()) return {};
    std::error_code error;
    const auto target = std::filesystem::read_symlink(_link, error);
    if (!error && target.string().starts_with(kTerminals)) std::filesystem::remove(_link, error);
    std::filesystem::create_symlink(_path, _link, error);
    if (!error) return {};
    return Failure{error == std::errc::file_exists
                       ? fmt::format("{} is there and no link to a modem that is played", _link.string())
                       : fmt::format("the link {} cannot be made: {}", _link.string(), error.message())};
}

std::size_t PseudoTerminal::send(ByteView bytes) {
    if (!_master || _absent) return 0;
    if (isHungUp()) {
        waitForReader();
        return 0;
    }
    const ssize_t sent = ::write(_master.get(), bytes.data(), bytes.size());
    const auto taken = sent > 0 ? static_cast<std::size_t>(sent) : 0;
    if (taken < bytes.size()) _room->setEnabled(true);
    return taken;
}

bool PseudoTerminal::isHungUp() const {
    pollfd state{_master.get(), POLLIN, 0};
    return ::poll(&state, 1, 0) > 0 && (state.revents & POLLHUP) != 0;
}

void PseudoTerminal::read() {
    std::uint8_t bytes[4096];
    const ssize_t count = ::read(_master.get(), bytes, sizeof bytes);
    if (count > 0) {
        if (onReceived) onReceived(ByteView(bytes, static_cast<std::size_t>(count)));
    } else if (isHungUp()) {
        waitForReader();
    }
}

// The watchers would find a hung-up terminal ready without end.
void PseudoTerminal::waitForReader() {
    _incoming->setEnabled(false);
    _room->setEnabled(false);
    _absent = _queue.repeat(kLook, [this] { lookForReader(); });
}

void PseudoTerminal::lookForReader() {
    if (isHungUp()) {
        if (!isStillClaimed(_path)) return;
        unplug();
        if (const auto made = plugIn(); !made) return logLine(Level::Error, made.error().reason);
        return logLine(Level::Notice, "The reader was killed and left its claim: the modem is at %s now", _path);
    }
    _absent.reset();
    _incoming->setEnabled(true);
    if (onRoom) onRoom();
}

}  // namespace kelvo::modem
