#pragma once

#include <functional>
#include <initializer_list>
#include <memory>
#include <vector>

#include "platform/host/FdWatcher.h"
#include "platform/host/UniqueFd.h"

namespace kelvo {

/// Calls a function on the main queue when the process receives one of the given signals, for as long as it lives;
/// afterwards the signals do what they did before. One object at a time. Signals that come faster than the queue runs
/// are told once.
class UnixSignals {
public:
    UnixSignals(std::initializer_list<int> watched, std::function<void(int signal)> callback);
    ~UnixSignals();
    UnixSignals(const UnixSignals&) = delete;
    UnixSignals& operator=(const UnixSignals&) = delete;

private:
    struct Before;

    UniqueFd _readEnd;
    UniqueFd _writeEnd;
    std::unique_ptr<FdWatcher> _watcher;
    std::vector<Before> _before;
};

}  // namespace kelvo
