#include "platform/host/HostLocalPort.h"

#include <utility>

namespace kelvo {

void HostLocalPort::setInvalidationCallback(std::function<void(LocalPort&)> callback) {
    _invalidationCallback = std::move(callback);
}

void HostLocalPort::invalidate() {
    if (!isValid()) return;
    _server->close();
    const auto callback = std::exchange(_invalidationCallback, nullptr);
    if (callback) callback(*this);  // last of all: it may destroy the port
}

}  // namespace kelvo
