#include "model/Connection.h"

#include <fmt/format.h>

namespace kelvo {

using namespace std::chrono_literals;

namespace {

constexpr const char* kWaiting = "Waiting for the modem";

std::string silenceText(std::chrono::nanoseconds silence) {
    const auto seconds = std::chrono::floor<std::chrono::seconds>(silence);
    if (seconds < 2min) return fmt::format("No records for {} s", seconds.count());
    return fmt::format("No records for {} min", std::chrono::floor<std::chrono::minutes>(silence).count());
}

}  // namespace

std::string connectionText(const Connection& connection) {
    if (connection.isSilent()) return silenceText(connection.silence);
    switch (connection.state) {
        case Connection::State::NoPort: return "Kelvo cannot open its port";
        case Connection::State::PortTaken: return "Kelvo is already open";
        case Connection::State::NoService: return "No telephony service is running";
        case Connection::State::Refused: return "The telephony service refuses the connection";
        case Connection::State::NoAnswer: return "The telephony service does not answer";
        case Connection::State::UnknownTechnology: return "The modem's technology is unknown";
        case Connection::State::NotStarted:
        case Connection::State::NoRecordYet: return kWaiting;
        case Connection::State::Receiving: return "";
    }
    return "";
}

std::string waitingText(const Connection& connection) {
    if (!connection.isConnected()) return connectionText(connection);
    return connection.isSilent() && connection.state == Connection::State::NoRecordYet ? "The modem sends nothing"
                                                                                       : kWaiting;
}

std::string statusText(bool isConnected, std::string_view updateMessage) {
    return isConnected ? std::string(updateMessage) : "Connecting...";
}

}  // namespace kelvo
