#pragma once

#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"
#include "LogGenerator/GSMUMTS/RegistrationRecord.h"
#include "LogGenerator/LayoutSection.h"

namespace kelvo {

/// 0x7130: packet-switched mobility management, as the modem numbers its states.
struct GMMStateRecord {
    // clang-format off
    static constexpr auto kStates = ValueTable({
        { 0, "GMM_NULL"                          },
        { 1, "GMM_DEREGISTERED"                  },
        { 2, "GMM_REGISTERED_INITIATED"          },
        { 3, "GMM_REGISTERED"                    },
        { 4, "GMM_DEREGISTERED_INITIATED"        },
        { 5, "GMM_ROUTING_AREA_UPDATE_INITIATED" },
        { 6, "GMM_SERVICE_REQUEST_INITIATED"     },
    }, "Unknown");

    static constexpr auto kSubStates = ValueTable({
        {  0, "GMM_NORMAL_SERVICE"          },
        {  1, "GMM_LIMITED_SERVICE"         },
        {  2, "GMM_ATTACH_NEEDED"           },
        {  3, "GMM_ATTEMPTING_TO_ATTACH"    },
        {  4, "GMM_NO_IMSI"                 },
        {  5, "GMM_NO_CELL_AVAILABLE"       },
        {  6, "GMM_PLMN_SEARCH"             },
        {  7, "GMM_SUSPENDED"               },
        {  8, "GMM_UPDATE_NEEDED"           },
        {  9, "GMM_ATTEMPING_TO_UPDATE"     },  // spelled so
        { 10, "GMM_ATTEMPTING_TO_UPDATE_MM" },
        { 11, "GMM_IMSI_DETACH_INITIATED"   },
        { 12, "GMM_NULL_SUBSTATE"           },
    }, "Unknown");

    static constexpr auto kUpdateStatus = ValueTable({
        { 0, "GMM_GU1_UPDATED"                  },
        { 1, "GMM_GU2_NOT_UPDATED"              },
        { 2, "GMM_GU3_PLMN_NOT_ALLOWED"         },
        { 3, "GMM_GU3_ROUTING_AREA_NOT_ALLOWED" },
    }, "Unknown");

    static constexpr auto kWhole = record(code::kGMMState, 16, {
        { 13, u8, "MM State",            label(kStates)       },
        { 14, u8, "MM Sub State",        label(kSubStates)    },
        { 15, u8, "Attach Reject Cause", label(kUpdateStatus) },
    });
    // clang-format on
};

/// Packet-switched mobility management, GMM (3GPP TS 24.008). Its states stand under the circuit-switched keys.
class ProcessPS final : public LayoutSection<ProcessPS, GMMStateRecord::kWhole, RegistrationRecord::kState> {
public:
    static constexpr std::string_view kSectionName = "Process PS";
    static constexpr std::string_view kTraceWord = "ProcessPS";

    using LayoutSection::LayoutSection;
};

}  // namespace kelvo
