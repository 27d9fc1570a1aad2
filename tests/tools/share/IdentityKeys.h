#pragma once

#include <set>
#include <string>

namespace kelvo::test {

/// Whether the screens' key names somebody, or where somebody is; everything else is a level, a state, a count, a
/// channel.
inline bool namesSomebody(const std::string& key) {
    static const std::set<std::string> keys = {
        "Physical Cell ID",
        "Serving Physical Cell ID",
        "Serving Cell ID",
        "Cell ID",
        "Cell Identity",
        "Tracking Area Code",
        "PSC",
        "BSIC ID",
        "Pilot",
        "Mobile Country Code",
        "Mobile Network Code",
        "Location Area Code",
        "Routing Area Code",
        "URA ID",
        "Scrambling Code",
        "BSIC",
        "Local Area Code",
        "Cell Scrambling Code",
        "Serving PN Offset",
        "UATI24",
        "Color Code",
        "System ID",
        "Network ID",
        "Base Station ID",
        "Packet Zone ID",
        "PDP Address",
        "MCC",
        "MNC",
        "LAC",
        "CellId",
        "SCN",
        "RAC",
        "EF-ICCID",
        "EF-MSISDN",
        "EF-LOCI",
        "EF-3GPP MAIL BOX DIALING NUMBER",
        "EF-GPRS/PS-LOCI",
        "EF-ACCESS CONTROL CLASS",
        "EF-FPLMN",
        "EF-ACTING HPLMN",
        "EF-PLMN NETWORK NAME",
        "EF-OPERATOR PLMN LIST",
        "EF-OPLMNAcT",
    };
    return keys.contains(key);
}

}  // namespace kelvo::test
