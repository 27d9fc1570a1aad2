#include "glossary/Glossary.h"

namespace kelvo::glossary {

namespace {

// clang-format off
constexpr Meaning kFiles[] = {
    { "", "EF-ICCID",
      "The serial number of the card itself.",
      "ETSI TS 102 221, 13.2" },
    { "", "EF-MSISDN",
      "The subscriber's own telephone number, as it was written to the card.",
      "3GPP TS 31.102, 4.2.26" },
    { "", "EF-3GPP MAIL BOX DIALING NUMBER",
      "The number of the voice mailbox.",
      "3GPP TS 31.102, 4.2.60" },
    { "", "EF-HPPLMN SEARCH PERIOD",
      "How often a phone in a visited network looks for a better one, in steps of six minutes.",
      "3GPP TS 31.102, 4.2.6" },
    { "", "EF-LOCI",
      "Where the phone was registered last for calls: temporary identity, location area and update status.",
      "3GPP TS 31.102, 4.2.17" },
    { "", "EF-GPRS/PS-LOCI",
      "Where the phone was registered last for packet data: temporary identity, routing area and update status.",
      "3GPP TS 31.102, 4.2.23" },
    { "", "EF-ACCESS CONTROL CLASS",
      "The access classes of the subscriber, which a crowded cell may bar.",
      "3GPP TS 31.102, 4.2.15" },
    { "", "EF-ADMINISTRATIVE DATA",
      "How the card wants the phone to operate, and how long the network code in the subscriber's identity is.",
      "3GPP TS 31.102, 4.2.18" },
    { "", "EF-FPLMN",
      "The networks that have refused the subscriber and are not tried again by themselves.",
      "3GPP TS 31.102, 4.2.16" },
    { "", "EF-ACTING HPLMN",
      "The network that the card at present calls its home network.",
      "" },
    { "", "EF-RAT MODE",
      "The radio technologies that the card wants to be used.",
      "" },
    { "", "EF-PLMN NETWORK NAME",
      "The names of networks, as the card wants them shown.",
      "3GPP TS 31.102, 4.2.58" },
    { "", "EF-OPERATOR PLMN LIST",
      "Which of the network names is shown in which network and area.",
      "3GPP TS 31.102, 4.2.59" },
    { "", "EF-OPLMNAcT",
      "The networks that the operator prefers, with their radio technologies, most preferred first.",
      "3GPP TS 31.102, 4.2.53" },
};

constexpr Meaning kContexts[] = {
    { "PDP Context Info", "Context ID",
      "The number by which the phone and the network call the data context, NSAPI or bearer identity.",
      "3GPP TS 24.008, 10.5.6.2" },
    { "PDP Context Info", "APN",
      "The access point name: the network that the data context leads to.",
      "3GPP TS 23.003, 9.1" },
    { "PDP Context Info", "PDP Type",
      "Whether the data context carries IPv4, IPv6 or both.",
      "3GPP TS 24.008, 10.5.6.4" },
    { "PDP Context Info", "State",
      "Whether the data context is active.",
      "3GPP TS 24.008, 6.1.3" },
    { "PDP Context Info", "PDP Address",
      "The address that the network has given the phone in the data context.",
      "3GPP TS 24.008, 10.5.6.4" },
    { "PDP Context Info", "Quality of Service",
      "How the network treats the data context: its traffic class, or its QCI in LTE.",
      "3GPP TS 23.107; TS 23.203" },
};
// clang-format on

}  // namespace

const std::span<const Meaning> kSim = kFiles;
const std::span<const Meaning> kDataContexts = kContexts;

}  // namespace kelvo::glossary
