#pragma once

#include <string_view>

/// How a client asks the telephony service for a log channel: one message of id 0 to the control port, answered at
/// once. Both are XML property lists:
///     request  { "CreateLogChannel": <name of the client's local port> }
///     answer   { "Error": n, "ErrorDomain": n, "PortName": <name of the service's port> }
/// Error and ErrorDomain are 0, and PortName is there, when the channel exists; LogChannelProtocol.h goes on from
/// there.
///
/// And how anybody asks what it does:
///     request  { "GetStatus": "GetStatus" }
///     answer   { "Source": text, "Technology": its name, "Records": number of all so far,
///                "Codes": [ { "Code": log code (none: without one), "Records": n, "PerSecond": real }, … ],
///                "Clients": [ { "Name": of the local port, "Streaming": boolean, "Delivered": n, "Waiting": n,
///                               "Dropped": n }, … ],
///                "State": text (only while there is something to say),
///                "Port": what a modem's port has said and counted, by name (only for a modem at a port) }
namespace kelvo {

inline constexpr std::string_view kPLTelephonyServicePort = "com.zorvik.TelephonyService";
inline constexpr std::string_view kPLCreateLogChannel = "CreateLogChannel";
inline constexpr std::string_view kPLGetStatus = "GetStatus";
inline constexpr std::string_view kPLError = "Error";
inline constexpr std::string_view kPLErrorDomain = "ErrorDomain";
inline constexpr std::string_view kPLPortName = "PortName";

/// Error domains: who says so.
inline constexpr long kPLErrorDomainService = 1;
inline constexpr long kPLErrorDomainClient = 2;

/// Errors of the service's domain.
inline constexpr long kPLErrorBadRequest = 1;         ///< not understood
inline constexpr long kPLErrorTooManyChannels = 2;    ///< the service serves no more clients
inline constexpr long kPLErrorPortUnreachable = 3;    ///< the client's local port cannot be opened
inline constexpr long kPLErrorNoPort = 4;             ///< the service could not make a port of its own
inline constexpr long kPLErrorTechnologyUnknown = 5;  ///< the modem is still being listened to: ask again
/// Errors of the client's domain.
inline constexpr long kPLErrorServiceGone = 1;  ///< it ended before it answered
inline constexpr long kPLErrorNoAnswer = 2;     ///< none came in time
inline constexpr long kPLErrorBadAnswer = 3;    ///< one came that is no answer

/// Announced on an open connection when the service ends.
inline constexpr std::string_view kPLNotificationServiceGone = "kPLNotificationServiceGone";

}  // namespace kelvo
