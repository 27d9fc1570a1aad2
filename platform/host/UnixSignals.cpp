#include "platform/host/UnixSignals.h"

#include <fcntl.h>
#include <signal.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>

namespace kelvo {
namespace {

std::atomic<int> writeEnd = -1;  // all that a signal handler can reach

extern "C" void passSignalOn(int signal) {
    const int error = errno;
    const auto number = static_cast<unsigned char>(signal);
    if (::write(writeEnd, &number, 1) < 0) {
        // The pipe is full of signals that nobody has read yet: they stand for this one.
    }
    errno = error;
}

}  // namespace

struct UnixSignals::Before {
    int signal;
    struct sigaction action;
};

UnixSignals::UnixSignals(std::initializer_list<int> watched, std::function<void(int)> callback) {
    int ends[2] = {-1, -1};
    if (::pipe2(ends, O_CLOEXEC | O_NONBLOCK) != 0) return;  // the signals keep what they do
    _readEnd = UniqueFd(ends[0]);
    _writeEnd = UniqueFd(ends[1]);
    writeEnd = ends[1];
    _watcher =
        std::make_unique<FdWatcher>(ends[0], FdWatcher::For::Reading, [from = ends[0], call = std::move(callback)] {
            unsigned char signal = 0;
            if (::read(from, &signal, 1) == 1) call(signal);
        });
    for (const int signal : watched) {
        struct sigaction action {};
        action.sa_handler = passSignalOn;
        action.sa_flags = SA_RESTART;
        _before.push_back({signal, {}});
        ::sigaction(signal, &action, &_before.back().action);
    }
}

UnixSignals::~UnixSignals() {
    for (const Before& before : _before) ::sigaction(before.signal, &before.action, nullptr);
    writeEnd = -1;
}

}  // namespace kelvo
