#pragma once

#include <array>

#include "LogGenerator/LogCode.h"

/// What the phone's own services tell, whatever modem it has: property lists in records of type 255.
namespace kelvo::code {

// clang-format off
inline constexpr KnownCode kSimFiles    {0xFF0000, "SIM files",            "3GPP TS 51.011, TS 31.102"};
inline constexpr KnownCode kCellArray   {0xFF0001, "Cell information",     "the phone's cell monitor"};
inline constexpr KnownCode kPDPContexts {0xFF0002, "Packet data contexts", "3GPP TS 24.008, 6.1.3"};

inline constexpr std::array kPhoneServices = {kSimFiles, kCellArray, kPDPContexts};
// clang-format on

}  // namespace kelvo::code
