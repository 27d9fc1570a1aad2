#pragma once

#include "LogGenerator/FieldTable.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// 0x7131: circuit-switched mobility management, as the modem numbers its states. Two sections show it.
struct MMStateRecord {
    static constexpr std::size_t kMinimum = 16;

    // clang-format off
    /// 1, 2, 4, 11, 12, 16 and 24 have no name; the blanks within 20 and 21 are intended.
    static constexpr auto kStates = ValueTable({
        {  0, "MM_NULL"                                        },
        {  3, "MM_LOCATION_UPDATE_INITIATED"                   },
        {  5, "MM_WAIT_FOR_OUTGOING_MM_CONNECTION"             },
        {  6, "MM_CONNECTION_ACTIVE"                           },
        {  7, "MM_IMSI_DETACH_INITIATED"                       },
        {  8, "MM_PROCESS_CM_SERVICE_PROMPT"                   },
        {  9, "MM_WAIT_FOR_NETWORK_COMMAND"                    },
        { 10, "MM_LOCATION_UPDATE_REJECTED"                    },
        { 13, "MM_WAIT_FOR_RR_CONNECTION_LU"                   },
        { 14, "MM_WAIT_FOR_RR_CONNECTION_MM"                   },
        { 15, "MM_WAIT_FOR_RR_CONNECTION_IMSI_DETACH"          },
        { 17, "MM_REESTABLISHMENT_INITIATED"                   },
        { 18, "MM_WAIT_FOR_RR_ACTIVE"                          },
        { 19, "MM_IDLE"                                        },
        { 20, "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION" },
        { 21, "MM_WAIT_FOR_RR_CONNECTION_ REESTABLISHMENT"     },
        { 22, "MM_WAIT_FOR_REESTABLISH_DECISION"               },
        { 23, "MM_LOCATION_UPDATING_PENDING"                   },
        { 25, "MM_RR_CONNECTION_RELEASE_NOT_ALLOWED"           },
    }, "Unknown");
    static constexpr auto kSubStates = ValueTable({
        { 0, "MM_NULL_SUBSTATE"              },
        { 1, "MM_NO_IMSI"                    },
        { 2, "MM_PLMN_SEARCH"                },
        { 3, "MM_LIMITED_SERVICE"            },
        { 4, "MM_ATTEMPTING_TO_UPDATE"       },
        { 5, "MM_LOCATION_UPDATE_NEEDED"     },
        { 6, "MM_NO_CELL_AVAILABLE"          },
        { 7, "MM_PLMN_SEARCH_NORMAL_SERVICE" },
        { 8, "MM_NORMAL_SERVICE"             },
    }, "Unknown");
    static constexpr auto kUpdateStatus = ValueTable({
        { 0, "UPDATED"                   },
        { 1, "NOT_UPDATED"               },
        { 2, "ROAMING_NOT_ALLOWED"       },
        { 3, "LOCATION_AREA_NOT_ALLOWED" },
    }, "Unknown");

    static constexpr auto kWhole = record(code::kMMState, kMinimum, {  // Process CS
        { 13, u8, "MM State",        label(kStates)       },
        { 14, u8, "MM Sub State",    label(kSubStates)    },
        { 15, u8, "LU Reject Cause", label(kUpdateStatus) },
    });
    static constexpr auto kState = record(code::kMMState, kMinimum, {  // Process CO
        { 13, u8, "MM State",        label(kStates)       },
    });
    // clang-format on
};

}  // namespace kelvo
