#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

#include "tools/share/ShareChoices.h"

namespace kelvo {

/// Whom or what a value names, and so how it is replaced.
enum class Identity : std::uint8_t {
    None,  ///< nobody: a level, a state, a count, a channel

    // Always replaced.
    SimNumber,    ///< ICCID
    Phone,        ///< a telephone number
    Subscriber,   ///< IMSI
    Equipment,    ///< IMEI, MEID, ESN
    Temporary,    ///< TMSI, P-TMSI, GUTI, UATI
    AccessClass,  ///< EF-ACC: its class is the last digit of the IMSI
    Address,      ///< IP
    Location,     ///< EF-LOCI: a TMSI and an area
    PsLocation,   ///< EF-PSLOCI: a P-TMSI and an area

    // On request.
    Apn,

    // With cells. Those up to LastNumber are numbers; their order is that of kBounds.
    Country,     ///< MCC
    Network,     ///< MNC
    Area,        ///< LAC, TAC
    SubArea,     ///< routing area, URA
    Cell,        ///< of a network
    EutranCell,  ///< the same of LTE, 28 bits: an eNB of 20 and a sector of 8 (3GPP TS 36.413, 9.2.1.38)
    UtranCell,   ///< of UMTS, likewise: an RNC of 12 and a cell of 16 (3GPP TS 25.331, 10.3.2.2); of fewer bits: GSM's
    PhysicalCell,  ///< of LTE
    ScramblingCode,
    Bsic,
    Colour,         ///< network or base station colour code, three bits
    Pilot,          ///< PN offset
    CellParameter,  ///< of TD-SCDMA
    System,         ///< SID, NID, packet zone, colour code of CDMA
    LastNumber = System,
    Plmn,        ///< one network or several, packed as in 3GPP TS 24.008, 10.5.1.3
    PlmnAccess,  ///< EF-OPLMNAcT: networks, each with two bytes
    PlmnAreas,   ///< EF-OPL: networks, each with two areas and a number
    NetworkName,
};

/// Whether values of this kind are replaced.
bool isHidden(Identity identity, const ShareChoices& choices);

/// Whether it is a plain number that `Pseudonyms::number` replaces.
constexpr bool isNumber(Identity identity) { return identity >= Identity::Country && identity <= Identity::LastNumber; }

/// Where ranges of such a number end: pseudonyms stay within theirs.
std::span<const std::uint64_t> boundsOf(Identity identity);

/// A number of 28 bits in two parts: the lower one says which part of the site that the upper one names.
struct Sited {
    std::string_view site;
    std::string_view part;
    int partBits;
    std::span<const std::uint64_t> bounds;  ///< of sites, all of them
};
/// None when the identity has no such parts.
std::optional<Sited> sitedOf(Identity identity);

/// "telephone number".
std::string_view nameOf(Identity identity);

}  // namespace kelvo
