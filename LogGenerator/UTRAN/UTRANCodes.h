#pragma once

#include <array>

#include "LogGenerator/LogCode.h"

/// What UTRAN modems (TD-SCDMA) report.
namespace kelvo::code {

// clang-format off
inline constexpr KnownCode kUTRANNeighborCells    {0xD00A, "UTRAN neighbor cells",                  "3GPP TS 25.225, 5.1"};
inline constexpr KnownCode kUTRANTransportChannels{0xD00C, "UTRAN transport channels, BLER and SIR", "3GPP TS 25.225, 5.1"};
inline constexpr KnownCode kUTRANGSMNeighborCells {0xD00E, "UTRAN neighbor cells, GSM",              "3GPP TS 25.225, 5.1"};
inline constexpr KnownCode kUTRANRRCState         {0xD0E0, "UTRAN RRC state",                       "3GPP TS 25.331, 7.1"};
inline constexpr KnownCode kUTRANServingCell      {0xD0E2, "UTRAN serving cell",                    "3GPP TS 25.331, 10.3.2"};

inline constexpr std::array kUTRAN = {
    kUTRANNeighborCells,     kUTRANTransportChannels, kUTRANGSMNeighborCells,  kUTRANRRCState,
    kUTRANServingCell,
};
// clang-format on

}  // namespace kelvo::code
