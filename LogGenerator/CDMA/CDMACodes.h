#pragma once

#include <array>

#include "LogGenerator/LogCode.h"

/// What CDMA2000 modems report.
namespace kelvo::code {

// clang-format off
inline constexpr KnownCode kEVDOFingers          {0x108A, "EV-DO fingers, C/I",             "3GPP2 C.S0024"};
inline constexpr KnownCode kEVDOStatus           {0x1183, "EV-DO status",                   "3GPP2 C.S0024"};
inline constexpr KnownCode kEVDOForwardLink      {0x1192, "EV-DO forward link, counters",   "3GPP2 C.S0024"};
inline constexpr KnownCode k1xStatus             {0x119C, "1x status",                      "3GPP2 C.S0005"};
inline constexpr KnownCode k1xTrafficFrames      {0x119D, "1x traffic frames",              "3GPP2 C.S0002"};
inline constexpr KnownCode kEVDOReverseLink      {0x127E, "EV-DO reverse link, counters",   "3GPP2 C.S0024"};
inline constexpr KnownCode kEVDOActiveSet        {0x12B6, "EV-DO active set, pilots",       "3GPP2 C.S0024"};
inline constexpr KnownCode kCDMASystem           {0x134F, "CDMA system identification",     "3GPP2 C.S0005, C.R1001"};

inline constexpr std::array kCDMA = {
    kEVDOFingers,     kEVDOStatus,      kEVDOForwardLink, k1xStatus,        k1xTrafficFrames, kEVDOReverseLink,
    kEVDOActiveSet,   kCDMASystem,
};
// clang-format on

}  // namespace kelvo::code
