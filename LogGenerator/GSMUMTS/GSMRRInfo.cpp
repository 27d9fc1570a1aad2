#include "LogGenerator/GSMUMTS/GSMRRInfo.h"

#include "LogGenerator/GSMUMTS/GPRSCellOptionsRecord.h"
#include "LogGenerator/GSMUMTS/GSMReselectionRecord.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr ValueTable kStates({  // the blanks within 13, 19 and 21 are intended
    {  0, "RR_INACTIVE"                          },
    {  1, "RR_GOING_ACTIVE"                      },
    {  2, "RR_GOING_INACTIVE"                    },
    {  3, "RR_CELL_SELECTION"                    },
    {  4, "RR_PLMN_LIST_CONSTRUCTION"            },
    {  5, "RR_IDLE"                              },
    {  6, "RR_CELL_RESELECTION"                  },
    {  7, "RR_CONNECTION_PENDING"                },
    {  8, "RR_CHOOSE_CELL"                       },
    {  9, "RR_DATA_TRANSFER"                     },
    { 10, "RR_NO_CHANNELS"                       },
    { 11, "RR_CONNECTION_RELEASE"                },
    { 12, "RR_EARLY_CAMPED_WAIT_FOR_SI"          },
    { 13, "RR_W2G_INTERRAT_HANDOVER_ PROGRESS"   },
    { 14, "RR_W2G_INTERRAT_RESELECTION_PROGRESS" },
    { 15, "RR_WAIT_FOR_EARLY_PSCAN"              },
    { 16, "GRR51"                                },
    { 17, "GRR52"                                },
    { 18, "RR_G2W_INTERRAT_RESELECTION_PROGRESS" },
    { 19, "RR_G2W_INTERRAT_HANDOVER_ PROGRESS"   },
    { 20, "RR_CELL_REEST"                        },
    { 21, "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS"   },
}, "Unknown");

constexpr auto kState = record(code::kGSMRRState, 17, {
    { 13, u8,  "RR State",         label(kStates)        },
    { 14, u8,  "RR Sub State",     decimal               },
    { 15, u8,  "RR Status",        decimal               },
    { 16, u8,  "RR Mode",          flag("Data", "Voice") },
});

constexpr auto kDTX = record(code::kGSMDTX, 20, {
    { 19, u8,  "DTX Used",         flag("ON", "OFF") },
});
// clang-format on

}  // namespace

void GSMRRInfo::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "GSMRRInfo");
    showOneOf(data, logCode, kState, GSMReselectionRecord::kQuality, kDTX, GPRSCellOptionsRecord::kDRX);
}

}  // namespace kelvo
