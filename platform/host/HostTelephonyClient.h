#pragma once

#include "platform/system/MessagePorts.h"
#include "platform/telephony/Telephony.h"

namespace kelvo {

/// The telephony service by its control port. Main queue only; `ports` outlives it and its connections.
class HostTelephonyClient final : public TelephonyClient {
public:
    explicit HostTelephonyClient(MessagePorts& ports) : _ports(ports) {}

    std::unique_ptr<PLServerConnection> createServerConnection(NotificationCallback callback) override;

private:
    MessagePorts& _ports;
};

}  // namespace kelvo
