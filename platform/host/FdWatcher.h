#pragma once

#include <functional>

class QSocketNotifier;

namespace kelvo {

/// Calls a function on the main queue each time a descriptor is found ready (or hung up), until it is destroyed, which
/// the function itself may do. The descriptor stays the caller's and must outlive the watcher.
class FdWatcher {
public:
    enum class For { Reading, Writing };

    FdWatcher(int fd, For purpose, std::function<void()> onReady);
    ~FdWatcher();
    FdWatcher(const FdWatcher&) = delete;
    FdWatcher& operator=(const FdWatcher&) = delete;

    void setEnabled(bool enabled);

private:
    QSocketNotifier* _notifier;  // outlives this object by the rest of its own event
};

}  // namespace kelvo
