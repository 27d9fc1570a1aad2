#include "glossary/Glossary.h"

namespace kelvo::glossary {

namespace {

// clang-format off
constexpr Meaning kMeanings[] = {
    // Serving
    { "Serving", "Technology",
      "The radio technology of the serving cell.",
      "3GPP TS 23.122" },
    { "", "MCC",
      "Mobile country code: the country of the network.",
      "3GPP TS 23.003, 2.2" },
    { "", "MNC",
      "Mobile network code: the network in its country.",
      "3GPP TS 23.003, 2.2" },
    { "", "LAC",
      "The location area: when the phone enters another it tells the network.",
      "3GPP TS 23.003, 4.1" },
    { "", "CellId",
      "The cell's identity: in GSM 16 bits, unique in its location area; in UMTS 28 bits, unique in its network.",
      "3GPP TS 23.003, 4.3.1; TS 25.331" },
    { "", "BandInfo",
      "The frequency band of the cell.",
      "3GPP TS 45.005, 2; TS 25.101, 5.2" },
    { "", "UARFCN",
      "The downlink carrier frequency of a UMTS cell as a channel number.",
      "3GPP TS 25.101, 5.4" },
    { "", "SCN",
      "The primary scrambling code, 0 to 511, that tells a UMTS cell from its neighbors on the same frequency.",
      "3GPP TS 25.213, 5.2" },
    { "", "RSCP",
      "Received signal code power: the level of a UMTS cell's pilot.",
      "3GPP TS 25.215, 5.1.1" },
    { "", "ECN0",
      "The energy of a UMTS cell's pilot over all that is received in the band, Ec/N0.",
      "3GPP TS 25.215, 5.1.5" },
    { "", "ARFCN",
      "The carrier frequency of a GSM cell as a channel number.",
      "3GPP TS 45.005, 2" },
    { "", "BSIC",
      "Base station identity code: network and base station colour, which tell GSM cells of one frequency apart.",
      "3GPP TS 23.003, 4.3.2" },
    { "", "RSSI",
      "The level of a GSM cell's carrier.",
      "3GPP TS 45.008, 8.1" },
    { "", "C1",
      "Path loss criterion of a GSM cell: the phone may camp on it only above 0.",
      "3GPP TS 45.008, 6.4" },

    // Neighbours
    { "Neighbours", "GSM",
      "The GSM neighbors; one that is known by its carrier frequency alone shows it in place of a screen.",
      "3GPP TS 45.005, 2" },

    // Registration
    { "", "Registration",
      "Whether the network knows where the phone is; alone when no more is known of it.",
      "3GPP TS 24.008" },
    { "Registration", "State",
      "Whether the network knows where the phone is.",
      "3GPP TS 24.008" },
    { "", "RAC",
      "The routing area: the part of the location area that packet data is registered in.",
      "3GPP TS 23.003, 4.2" },

    // Connection
    { "", "Connection",
      "What the phone does with the network; alone while it does nothing.",
      "3GPP TS 24.008" },
    { "Connection", "State",
      "What the phone does with the network: a call, or the transfer of packets.",
      "3GPP TS 24.008" },
    { "", "Channel",
      "The kind of channel that carries the call or the packets.",
      "3GPP TS 45.002; TS 25.211" },
    { "", "Throughput",
      "The rate at which packets arrive.",
      "" },
    { "", "Errors",
      "The share of blocks or frames received with errors.",
      "3GPP TS 45.008, 8.2; TS 25.215, 5.1.6" },
    { "", "TxPower",
      "The power at which the phone transmits.",
      "3GPP TS 45.005, 4.1; TS 25.101, 6.2" },
};
// clang-format on

}  // namespace

const std::span<const Meaning> kIFX = kMeanings;

}  // namespace kelvo::glossary
