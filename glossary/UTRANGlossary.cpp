#include "glossary/Glossary.h"

namespace kelvo::glossary {

namespace {

// clang-format off
constexpr Meaning kMeanings[] = {
    // RRC Info
    { "RRC Info", "State",
      "How the phone is connected to the radio network: with a channel of its own, shared channels, paging alone, or not at all.",
      "3GPP TS 25.331, 7" },

    // Serving Cell Info
    { "Serving Cell Info", "Cell ID",
      "The cell's identity in its network, 28 bits: the upper 12 name the radio network controller, the lower 16 its cell.",
      "3GPP TS 25.331" },
    { "", "Local Area Code",
      "The location area of the cell: when the phone enters another it tells the network.",
      "3GPP TS 23.003, 4.1" },
    { "", "URA ID",
      "The registration area of the radio network in which a connected phone is paged.",
      "3GPP TS 25.331" },
    { "", "Cell Scrambling Code",
      "The number of the code that tells the cell from its neighbors on the same frequency, its cell parameter.",
      "3GPP TS 25.223" },
    { "", "Downlink UARFCN",
      "The carrier frequency on which the cell transmits, as a channel number.",
      "3GPP TS 25.102, 5.4" },
    { "", "Uplink UARFCN",
      "The carrier frequency on which the cell receives, as a channel number; both directions share one.",
      "3GPP TS 25.102, 5.4" },
    { "", "Freq Band Indicator",
      "The frequency band in which the cell transmits, as the phone's services number it.",
      "3GPP TS 25.102, 5.2" },
    { "", "Allowed Access",
      "Whether the cell takes every call or emergency calls alone.",
      "3GPP TS 25.304, 5.3" },
    { "", "Cell Access Restrictions",
      "What the cell broadcasts about who may use it, as the modem packs it.",
      "3GPP TS 25.331" },

    // Neighbor Cell List
    { "", "UARFCN",
      "The carrier frequency of the neighbor as a channel number.",
      "3GPP TS 25.102, 5.4" },
    { "Neighbor Cell List", "Cell ID",
      "The neighbor's cell parameter, 0 to 127, which tells it from others on the same frequency.",
      "3GPP TS 25.223" },
    { "", "Filter RSCP",
      "Received signal code power of the neighbor after the modem's filter, as a fraction in steps of 1/256 and not in dBm.",
      "3GPP TS 25.225, 5.1" },
    { "", "Status",
      "The set of cells that the neighbor belongs to: active, monitored or detected.",
      "3GPP TS 25.331" },
    { "", "inJDCS",
      "Whether the receiver takes the neighbor into account when it detects all cells jointly.",
      "" },

    // TRCH BLER
    { "", "TRCH ID",
      "The number of a transport channel.",
      "3GPP TS 25.331" },
    { "", "TRCH BLER Measurement",
      "How many of the transport channel's blocks were received with errors, as the modem scales it.",
      "3GPP TS 25.225, 5.1" },

    // CCTRCH SIR
    { "", "CCTRCH ID",
      "The number of a coded composite transport channel: transport channels that share the physical ones.",
      "3GPP TS 25.222" },
    { "", "TSNUM",
      "How many timeslots the coded composite transport channel is received in, as the record holds it.",
      "3GPP TS 25.221" },
    { "", "SIR",
      "The signal-to-interference ratio of the coded composite transport channel, a figure for each of six timeslots, as the modem scales it.",
      "3GPP TS 25.225, 5.1" },
};
// clang-format on

}  // namespace

const std::span<const Meaning> kUTRAN = kMeanings;

}  // namespace kelvo::glossary
