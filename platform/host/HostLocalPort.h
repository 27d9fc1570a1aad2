#pragma once

#include "platform/host/PortServer.h"
#include "platform/system/MessagePorts.h"

namespace kelvo {

/// A local port on a Unix-domain socket.
class HostLocalPort final : public LocalPort {
public:
    explicit HostLocalPort(std::shared_ptr<PortServer> server) : _server(std::move(server)) {}
    ~HostLocalPort() override { _server->close(); }

    void setInvalidationCallback(std::function<void(LocalPort&)> callback) override;
    void schedule() override { _server->start(); }
    void invalidate() override;
    bool isValid() const override { return _server->isOpen(); }
    const std::string& name() const override { return _server->name(); }

private:
    const std::shared_ptr<PortServer> _server;
    std::function<void(LocalPort&)> _invalidationCallback;
};

}  // namespace kelvo
