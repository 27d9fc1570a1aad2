#pragma once

#include <array>

#include "LogGenerator/LogCode.h"

/// What GSM/UMTS modems report. Phones with two SIMs send the GSM codes plus kDualSimOffset as well, the records with
/// the number of the SIM (u8) in front of their payload.
namespace kelvo::code {

inline constexpr LogCode kDualSimOffset = 0xA00;

// clang-format off
inline constexpr KnownCode kNeighborRanking       {0x4005, "UMTS and GSM neighbor cells, ranked", "3GPP TS 25.304, 5.2.6"};
inline constexpr KnownCode kUMTSTransmitPower     {0x4031, "UMTS transmit power",                 "3GPP TS 25.101, 6.2"};
inline constexpr KnownCode kUMTSTransportErrors   {0x4116, "UMTS transport channel block errors", "3GPP TS 25.215, 5.1"};
inline constexpr KnownCode kUMTSRRCState          {0x4125, "UMTS RRC state",                      "3GPP TS 25.331, 7.1"};
inline constexpr KnownCode kUMTSServingCell       {0x4127, "UMTS serving cell",                   "3GPP TS 25.331, 10.3.2"};
inline constexpr KnownCode kUMTSCiphering         {0x4157, "UMTS ciphering",                      "3GPP TS 33.102, 6.6"};
inline constexpr KnownCode kUMTSCellSets          {0x417A, "UMTS searcher, cell sets",            "3GPP TS 25.215, 5.1"};
inline constexpr KnownCode kHSDPA                 {0x4221, "HSDPA HARQ processes",                "3GPP TS 25.321, 11.6.2"};
inline constexpr KnownCode kGSMDTX                {0x5072, "GSM discontinuous transmission",      "3GPP TS 45.008, 8.3"};
inline constexpr KnownCode kGSMDedicatedChannel   {0x5076, "GSM dedicated channel",               "3GPP TS 44.018, 3.4"};
inline constexpr KnownCode kGSMRRState            {0x512C, "GSM radio resource state",            "3GPP TS 44.018, 3.1"};
inline constexpr KnownCode kGSMServingCell        {0x5134, "GSM serving cell",                    "3GPP TS 44.018, 10.5.2"};
inline constexpr KnownCode kGSMReselection        {0x5137, "GSM cell reselection",                "3GPP TS 45.008, 6.4"};
inline constexpr KnownCode kGPRSSI13Position      {0x51F4, "GPRS system information 13, where",   "3GPP TS 44.018, 10.5.2.34"};
inline constexpr KnownCode kGPRSNetworkControl    {0x51F5, "GPRS network control and access",     "3GPP TS 44.060, 11.2"};
inline constexpr KnownCode kGPRSCellOptions       {0x51F6, "GPRS cell options",                   "3GPP TS 44.060, 12.24"};
inline constexpr KnownCode kMobileAllocation      {0x51F8, "GSM mobile allocation",               "3GPP TS 44.018, 10.5.2.21"};
inline constexpr KnownCode kGPRSBroadcastChannel  {0x51FB, "GPRS packet broadcast channel",       "3GPP TS 45.002, 3.3"};
/// Newer modems send it in place of kGSMReselection; no section shows it.
inline constexpr KnownCode kGPRSReselection       {0x51FC, "GPRS cell reselection",               "3GPP TS 45.008, 10.1"};
inline constexpr KnownCode kGPRSSystemInformation {0x51FD, "GPRS packet system information",      "3GPP TS 44.060, 11.2"};
inline constexpr KnownCode kGSMNeighborIdentities {0x51FF, "GSM neighbor cells, BSIC",            "3GPP TS 45.008, 7.2"};
inline constexpr KnownCode kGMMState              {0x7130, "GMM state, packet-switched",          "3GPP TS 24.008, 4.1.3"};
inline constexpr KnownCode kMMState               {0x7131, "MM state, circuit-switched",          "3GPP TS 24.008, 4.1.2"};
inline constexpr KnownCode kRegistration          {0x7132, "Registration, PLMN selection",        "3GPP TS 23.122, 4.3"};
inline constexpr KnownCode kServingPLMN           {0x7135, "Serving PLMN",                        "3GPP TS 24.008, 10.5.1.3"};
inline constexpr KnownCode kEquivalentPLMNs       {0x7150, "Equivalent PLMNs",                    "3GPP TS 24.008, 10.5.1.13"};

inline constexpr std::array kGSMUMTS = {
    kNeighborRanking,       kUMTSTransmitPower,     kUMTSTransportErrors,   kUMTSRRCState,
    kUMTSServingCell,       kUMTSCiphering,         kUMTSCellSets,          kHSDPA,
    kGSMDTX,                kGSMDedicatedChannel,   kGSMRRState,            kGSMServingCell,
    kGSMReselection,        kGPRSSI13Position,      kGPRSNetworkControl,    kGPRSCellOptions,
    kMobileAllocation,      kGPRSBroadcastChannel,  kGPRSReselection,       kGPRSSystemInformation,
    kGSMNeighborIdentities, kGMMState,              kMMState,               kRegistration,
    kServingPLMN,           kEquivalentPLMNs,
};
// clang-format on

}  // namespace kelvo::code
