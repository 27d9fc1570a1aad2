#pragma once

#include "platform/values/Key.h"

namespace kelvo {

/// An elementary file of the SIM (3GPP TS 51.011, TS 31.102).
struct SimFile {
    Key key;    ///< the telephony service's name for it
    Key label;  ///< the screens'
};

// clang-format off
inline constexpr SimFile kElementaryFiles[] = {
    { "kSimFile_ICCID",    "EF-ICCID"                        },
    { "kSimFile_MSISDN",   "EF-MSISDN"                       },
    { "kSimFile_MBDN",     "EF-3GPP MAIL BOX DIALING NUMBER" },
    { "kSimFile_HPPLMN",   "EF-HPPLMN SEARCH PERIOD"         },
    { "kSimFile_LOCI",     "EF-LOCI"                         },
    { "kSimFile_PSLOCI",   "EF-GPRS/PS-LOCI"                 },
    { "kSimFile_ACC",      "EF-ACCESS CONTROL CLASS"         },
    { "kSimFile_AD",       "EF-ADMINISTRATIVE DATA"          },
    { "kSimFile_FPLMN",    "EF-FPLMN"                        },
    { "kSimFile_AHPLMN",   "EF-ACTING HPLMN"                 },
    { "kSimFile_RATMODE",  "EF-RAT MODE"                     },
    { "kSimFile_PNN",      "EF-PLMN NETWORK NAME"            },
    { "kSimFile_OPL",      "EF-OPERATOR PLMN LIST"           },
    { "kSimFile_OPLMNAcT", "EF-OPLMNAcT"                     },
};
// clang-format on

}  // namespace kelvo
