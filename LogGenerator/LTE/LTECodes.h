#pragma once

#include <array>

#include "LogGenerator/LogCode.h"

/// What LTE modems report.
namespace kelvo::code {

// clang-format off
inline constexpr KnownCode kLTEMasterInformationBlock{0xB0C1, "LTE master information block",       "3GPP TS 36.331, 6.2.2"};
inline constexpr KnownCode kLTEServingCell           {0xB0C2, "LTE serving cell, identity",         "3GPP TS 36.331, 6.2.2"};
inline constexpr KnownCode kLTEIntraFrequency        {0xB179, "LTE intra-frequency, connected",     "3GPP TS 36.331, 5.5.3"};
inline constexpr KnownCode kLTEServingCellIdle       {0xB17F, "LTE serving cell, idle",             "3GPP TS 36.304, 5.2.3"};
inline constexpr KnownCode kLTENeighborCellsIdle     {0xB180, "LTE neighbor cells, idle",           "3GPP TS 36.304, 5.2.4"};
inline constexpr KnownCode kLTEReselectionCandidates {0xB186, "LTE reselection candidates",         "3GPP TS 36.304, 5.2.4"};
/// Newer modems send it in place of kLTEServingCellIdle; no section shows it.
inline constexpr KnownCode kLTEServingCellEveryMode  {0xB193, "LTE serving cell, every mode",       "3GPP TS 36.214, 5.1"};

inline constexpr std::array kLTE = {
    kLTEMasterInformationBlock, kLTEServingCell,            kLTEIntraFrequency,         kLTEServingCellIdle,
    kLTENeighborCellsIdle,      kLTEReselectionCandidates,  kLTEServingCellEveryMode,
};
// clang-format on

}  // namespace kelvo::code
