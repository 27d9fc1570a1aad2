#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>

namespace kelvo {

/// The two parts of an answer's error; both 0 when it succeeded.
struct PLError {
    long domain = 0;
    long error = 0;
};

/// What creating a log channel gave: the name of the service's own port, or the reason why there is none.
struct PLLogChannel {
    PLError error;
    std::string portName;  ///< empty when none came back
};

/// An open connection to the telephony service; destroying it closes it.
class PLServerConnection {
public:
    virtual ~PLServerConnection() = default;

    /// Asks the service's network monitor for a log channel that delivers to the local port `localPortName`.
    /// Blocks for at most two seconds; a service that does not answer is an error.
    virtual PLLogChannel networkMonitorCreateLogChannel(std::string_view localPortName) = 0;
};

/// The way to the telephony service.
class TelephonyClient {
public:
    /// Told what the service announces on a connection; `notification` is the announcement's name.
    using NotificationCallback = std::function<void(std::string_view notification)>;

    virtual ~TelephonyClient() = default;

    /// Opens a connection; none when no service is there.
    virtual std::unique_ptr<PLServerConnection> createServerConnection(NotificationCallback callback) = 0;
};

/// The request by the name under which the platform knows it.
inline PLLogChannel PLServerConnectionNetworkMonitorCreateLogChannel(PLServerConnection& connection,
                                                                     std::string_view localPortName) {
    return connection.networkMonitorCreateLogChannel(localPortName);
}

}  // namespace kelvo
