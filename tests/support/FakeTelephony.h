#pragma once

#include <string>
#include <utility>
#include <vector>

#include "platform/telephony/Telephony.h"
#include "tests/support/FakePorts.h"

namespace kelvo::test {

/// A telephony service whose answers the test sets. Outlives the connections it opens.
class FakeTelephony final : public TelephonyClient {
public:
    bool reachable = true;
    PLLogChannel answer = {.error = {}, .portName = "service"};  ///< what asking for a log channel gives
    bool announces = false;  ///< calls the notification callback while it is being asked

    std::vector<std::string> askedFor;  ///< local port names of the log channels asked for, in order
    int openConnections = 0;
    NotificationCallback lastCallback;  ///< of the connection opened last; kept past its end

    std::unique_ptr<PLServerConnection> createServerConnection(NotificationCallback callback) override {
        if (!reachable) return nullptr;
        lastCallback = std::move(callback);
        return std::make_unique<Connection>(*this);
    }

private:
    class Connection final : public PLServerConnection {
    public:
        explicit Connection(FakeTelephony& service) : _service(service) { ++_service.openConnections; }
        ~Connection() override { --_service.openConnections; }
        PLLogChannel networkMonitorCreateLogChannel(std::string_view localPortName) override {
            _service.askedFor.emplace_back(localPortName);
            if (_service.announces) _service.lastCallback("announcement");
            return _service.answer;
        }

    private:
        FakeTelephony& _service;
    };
};

/// An answer to "GetTechnology" as a service writes it.
inline Bytes technologyAnswer(std::string_view technology) {
    const std::string text =
        "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<plist version=\"1.0\"><dict><key>GetTechnology</key><string>" +
        std::string(technology) + "</string></dict></plist>\n";
    const ByteView bytes = bytesOf(text);
    return {bytes.begin(), bytes.end()};
}

/// A service end that speaks `technology` and takes every start command.
inline auto speaking(std::string technology) {
    return [technology = std::move(technology)](const FakePorts::Sent& message) -> FakePorts::Answer {
        return message.replyLimit ? technologyAnswer(technology) : Bytes();
    };
}

}  // namespace kelvo::test
