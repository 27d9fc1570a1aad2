#pragma once

#include <cstdint>
#include <string_view>

/// What travels on a log channel, once it exists (TelephonyProtocol.h says how it comes to be). Every message, in
/// either direction, has id 0. The client's are XML property lists, sent to the service's port:
///     query    { "GetTechnology": "GetTechnology" }, answered by
///              { "GetTechnology": one of the kPLLogChannelTechnology_ identifiers }
///     start    { "SetState": "Streaming", "SetOskraLogCodes": [ n, … ], "SetPlExtraCodes": [ n, … ] }, not answered
/// The codes are those of the records that the client wants: ordinary ones, and extended ones less 0xff0000. A family
/// whose records carry no codes is asked for without either list, CDMA without the second.
/// The service's messages are the records, as they are, to the client's local port.
namespace kelvo {

inline constexpr std::int32_t kPLLogChannelMessageId = 0;

inline constexpr std::string_view kPLGetTechnology = "GetTechnology";  ///< key of query and answer, value of the query
inline constexpr std::string_view kPLSetState = "SetState";
inline constexpr std::string_view kPLStateStreaming = "Streaming";
inline constexpr std::string_view kPLSetOskraLogCodes = "SetOskraLogCodes";
inline constexpr std::string_view kPLSetPlExtraCodes = "SetPlExtraCodes";

}  // namespace kelvo
