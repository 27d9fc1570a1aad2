#pragma once

#include <chrono>
#include <string>
#include <string_view>

namespace kelvo {

/// How far the monitor has come on its way to the modem's records, and why no further.
struct Connection {
    enum class State {
        NotStarted,         ///< nothing has been tried yet
        NoPort,             ///< the local port cannot be made
        PortTaken,          ///< another program holds the local port: the application is open already
        NoService,          ///< no telephony service is there
        Refused,            ///< the service gives no log channel
        NoAnswer,           ///< the service does not answer, or does not listen on the port it named
        UnknownTechnology,  ///< what the service answers names no technology that is known here
        NoRecordYet,        ///< connected; nothing has come since
        Receiving,          ///< connected; records have come since
    };

    State state = State::NotStarted;
    /// While connected: how long ago the last record came, or the connection while none has. 0 otherwise.
    std::chrono::nanoseconds silence{0};

    bool isConnected() const { return state == State::NoRecordYet || state == State::Receiving; }
    /// Connected, and nothing has come for so long that it must be told.
    bool isSilent() const { return isConnected() && silence >= std::chrono::seconds(10); }
};

/// What screens say about the connection, "No telephony service is running" or "No records for 24 s" (from 10 s on; in
/// minutes from two on): in place of rows while there are none, and beside the status else. Empty while records come.
std::string connectionText(const Connection& connection);

/// What a screen without any reading says in place of rows: the reason why there are none. As `connectionText`, except
/// for a modem that has been silent from the start, whose silence is told here without its length. Never empty.
std::string waitingText(const Connection& connection);

/// The status text of every screen: when its values are from, as `updateMessage` says, or that there is no connection.
std::string statusText(bool isConnected, std::string_view updateMessage);

}  // namespace kelvo
