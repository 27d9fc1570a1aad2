#include "LogGenerator/PhoneServices/SimInfo.h"

#include "LogGenerator/PhoneServices/CellInfo.h"
#include "LogGenerator/UnknownDataException.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

struct SimFile {
    Key key;
    Key label;
};

// clang-format off
constexpr SimFile kFiles[] = {
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

}  // namespace

void SimInfo::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "SimInfo");
    if (logCode != code::kSimFiles) return;
    const Value files = payloadPropertyList(data);
    if (!files) {
        logLine(Level::Error, "SIM File dictionary data could not be constructed");
        throw LogCode_0xFF0000::UnknownDataException();
    }
    if (!files.dictionary() || !values()) return;
    for (const SimFile& file : kFiles) {
        if (const Value* value = files.dictionary()->find(file.key)) showDelivered(values()->slot(file.label), *value);
    }
}

}  // namespace kelvo
