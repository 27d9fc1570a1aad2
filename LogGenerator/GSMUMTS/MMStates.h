#pragma once

#include "LogGenerator/FieldTable.h"

namespace kelvo {

// clang-format off
/// The states of circuit-switched mobility management (3GPP TS 24.008, 4.1.2.1), as the modem numbers them. 1, 2, 4,
/// 11, 12, 16 and 24 have no name; the blanks within 20 and 21 are meant to be there.
inline constexpr ValueTable kMMStates({
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
// clang-format on

}  // namespace kelvo
