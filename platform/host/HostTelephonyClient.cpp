#include "platform/host/HostTelephonyClient.h"

#include <chrono>
#include <utility>

#include "platform/encodings/PropertyList.h"
#include "platform/telephony/TelephonyProtocol.h"

namespace kelvo {
namespace {

constexpr std::chrono::seconds kSendLimit{1};
constexpr std::chrono::seconds kReplyLimit{1};

PLLogChannel failure(long error) { return {{kPLErrorDomainClient, error}, {}}; }

PLLogChannel parseAnswer(ByteView answer) {
    const auto read = readPropertyList(answer);
    if (!read || !read->dictionary()) return failure(kPLErrorBadAnswer);
    const Dictionary& entries = *read->dictionary();
    const Number* error = entries[kPLError].number();
    const Number* domain = entries[kPLErrorDomain].number();
    const std::string* name = entries[kPLPortName].string();
    if (error == nullptr || domain == nullptr) return failure(kPLErrorBadAnswer);
    return {{domain->integer(), error->integer()}, name != nullptr ? *name : std::string()};
}

class HostServerConnection final : public PLServerConnection {
public:
    HostServerConnection(std::unique_ptr<RemotePort> port, TelephonyClient::NotificationCallback callback)
        : _port(std::move(port)) {
        if (!callback) return;
        _port->setInvalidationCallback([tell = std::move(callback)](RemotePort&) { tell(kPLNotificationServiceGone); });
    }

    PLLogChannel networkMonitorCreateLogChannel(std::string_view localPortName) override {
        const auto request = writeXmlPropertyList(Dictionary::make({{kPLCreateLogChannel, localPortName}}));
        const auto answer = _port->request(0, *request, kSendLimit, kReplyLimit);
        if (answer) return parseAnswer(*answer);
        return failure(answer.error() == RemotePort::Error::Invalid ? kPLErrorServiceGone : kPLErrorNoAnswer);
    }

private:
    const std::unique_ptr<RemotePort> _port;
};

}  // namespace

std::unique_ptr<PLServerConnection> HostTelephonyClient::createServerConnection(NotificationCallback callback) {
    auto port = _ports.openRemote(kPLTelephonyServicePort);
    if (!port) return nullptr;
    return std::make_unique<HostServerConnection>(std::move(port), std::move(callback));
}

}  // namespace kelvo
