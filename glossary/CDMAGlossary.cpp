#include "glossary/Glossary.h"

namespace kelvo::glossary {

namespace {

// clang-format off
constexpr Meaning kMeanings[] = {
    // 1x
    { "1x", "State",
      "What the phone does in the 1x network: it looks for one, listens to paging, sleeps between pages, or is in a call.",
      "3GPP2 C.S0005" },
    { "1x", "Active Set",
      "The base stations whose signals the phone combines, each under its pilot's offset, with the pilot's energy over all that is received (Ec/Io).",
      "3GPP2 C.S0005" },
    { "1x", "Traffic FER",
      "Frame error rate of the traffic channel: the share of frames received with errors, smoothed over the last ones.",
      "3GPP2 C.S0002" },
    { "1x", "Tx AGC",
      "The power at which the phone transmits, as its gain control says; shown during a call.",
      "3GPP2 C.S0011" },
    { "1x", "Rx0 AGC",
      "The power that the first receive chain takes in over the whole carrier, as its gain control says.",
      "3GPP2 C.S0011" },
    { "1x", "Rx0 Channel",
      "The carrier frequency of the first receive chain as a channel number in its band class.",
      "3GPP2 C.S0057" },
    { "1x", "Rx0 Band Class",
      "The band class that the first receive chain is tuned to.",
      "3GPP2 C.S0057" },
    { "1x", "Rx1 AGC",
      "The power that the second receive chain takes in over the whole carrier; shown during a call.",
      "3GPP2 C.S0011" },
    { "1x", "Rx1 Channel",
      "The carrier frequency of the second receive chain as a channel number; shown during a call.",
      "3GPP2 C.S0057" },
    { "1x", "Rx1 Band Class",
      "The band class that the second receive chain is tuned to; shown during a call.",
      "3GPP2 C.S0057" },

    // EV-DO
    { "EV-DO", "Device State",
      "What the phone does in the EV-DO network: it acquires one, is idle, asks for access, or is connected.",
      "3GPP2 C.S0024" },
    { "EV-DO", "Session State",
      "How far phone and network have agreed on the protocols of their session.",
      "3GPP2 C.S0024" },
    { "EV-DO", "Active Set",
      "The sectors assigned to the phone, each under its pilot's offset, with the pilot's energy over all that is received (Ec/Io).",
      "3GPP2 C.S0024" },
    { "EV-DO", "Fingers",
      "The paths that the rake receiver follows, each under its pilot's offset, with the carrier-to-interference ratio of the path.",
      "3GPP2 C.S0024" },
    { "EV-DO", "Serving PN Offset",
      "The pilot offset of the sector that serves the phone, in steps of 64 chips.",
      "3GPP2 C.S0024" },
    { "EV-DO", "Tx AGC",
      "The power at which the phone transmits, as its gain control says; shown from Access on.",
      "3GPP2 C.S0033" },
    { "EV-DO", "Rx0 AGC",
      "The power that the first receive chain takes in over the whole carrier, as its gain control says.",
      "3GPP2 C.S0033" },
    { "EV-DO", "Rx1 AGC",
      "The power that the second receive chain takes in over the whole carrier; shown from Access on.",
      "3GPP2 C.S0033" },
    { "EV-DO", "Channel",
      "The carrier frequency as a channel number in its band class.",
      "3GPP2 C.S0057" },
    { "EV-DO", "Band Class",
      "The band class of the carrier.",
      "3GPP2 C.S0057" },
    { "EV-DO", "UATI24",
      "The lower 24 bits of the unicast access terminal identifier, the phone's address in its session.",
      "3GPP2 C.S0024" },
    { "EV-DO", "Color Code",
      "The number of the subnet that gave the phone its address: when it changes, the phone asks for a new one.",
      "3GPP2 C.S0024" },

    // Rates and Errors
    { "", "EV-DO Forward Rate",
      "The data rate from the network to the phone, from the growth of the modem's counters.",
      "3GPP2 C.S0024" },
    { "", "EV-DO Reverse Rate",
      "The data rate from the phone to the network, from the growth of the modem's counters.",
      "3GPP2 C.S0024" },
    { "", "1x Traffic FER",
      "Frame error rate of the 1x traffic channel: the share of frames received with errors, smoothed over the last ones.",
      "3GPP2 C.S0002" },

    // System
    { "", "Roaming Indicator",
      "How the phone is to show whether it roams: off, on, flashing, or one of the enhanced indications.",
      "3GPP2 C.R1001" },
    { "", "System ID",
      "SID: the number of the cellular system.",
      "3GPP2 C.S0005" },
    { "", "Network ID",
      "NID: the number of a network inside its system.",
      "3GPP2 C.S0005" },
    { "", "Base Station ID",
      "The number of the base station in its network.",
      "3GPP2 C.S0005" },
    { "", "Packet Zone ID",
      "The packet data zone of the base station: a phone that enters another may have to register its data session anew.",
      "3GPP2 C.S0005" },
    { "", "Protocol Revision",
      "The revision of the air interface that the base station supports, P_REV.",
      "3GPP2 C.S0005" },
};
// clang-format on

}  // namespace

const std::span<const Meaning> kCDMA = kMeanings;

}  // namespace kelvo::glossary
