#pragma once

#include <array>
#include <optional>
#include <string_view>

#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

/// The technology families a modem can speak.
enum class Technology { IFX, GSM, CDMA, LTE, UTRAN };

/// The names under which one family appears.
struct TechnologyNames {
    Technology technology;
    std::string_view word;        ///< on command lines: "lte"
    std::string_view name;        ///< for people and in machine-readable output: "LTE"
    std::string_view identifier;  ///< on the log channel: the answer to "GetTechnology"
    int linkType;                 ///< in captures: the pcap link type, one of LINKTYPE_USER0 to LINKTYPE_USER4
};

// clang-format off
inline constexpr std::array kTechnologies = {  // in the enumeration's order
    TechnologyNames{Technology::IFX,   "ifx",   "IFX",   kPLLogChannelTechnology_IFX,           147},
    TechnologyNames{Technology::GSM,   "gsm",   "GSM",   kPLLogChannelTechnology_Oskra_GSM,     148},
    TechnologyNames{Technology::CDMA,  "cdma",  "CDMA",  kPLLogChannelTechnology_Oskra_CDMA,    149},
    TechnologyNames{Technology::LTE,   "lte",   "LTE",   kPLLogChannelTechnology_Oskra_LTE,     150},
    TechnologyNames{Technology::UTRAN, "utran", "UTRAN", kPLLogChannelTechnology_Oskra_UTRAN2,  151},
};
// clang-format on

constexpr const TechnologyNames& namesOf(Technology technology) {
    return kTechnologies[static_cast<std::size_t>(technology)];
}

/// Whether the family's records carry log codes. Without, each is a tree, and nobody can ask for some of them alone.
constexpr bool hasCodes(Technology technology) { return technology != Technology::IFX; }

/// The family whose `field` is `wanted`, none when there is none: `technologyBy(&TechnologyNames::word, "lte")`.
template <class Field>
constexpr std::optional<Technology> technologyBy(Field TechnologyNames::*field, const Field& wanted) {
    for (const TechnologyNames& names : kTechnologies) {
        if (names.*field == wanted) return names.technology;
    }
    return std::nullopt;
}

}  // namespace kelvo
