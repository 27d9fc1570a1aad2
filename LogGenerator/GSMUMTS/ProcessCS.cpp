#include "LogGenerator/GSMUMTS/ProcessCS.h"

#include "LogGenerator/GSMUMTS/MMStates.h"

namespace kelvo {

namespace {

// clang-format off
constexpr ValueTable kSubStates({
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

constexpr ValueTable kUpdateStatus({
    { 0, "UPDATED"                   },
    { 1, "NOT_UPDATED"               },
    { 2, "ROAMING_NOT_ALLOWED"       },
    { 3, "LOCATION_AREA_NOT_ALLOWED" },
}, "Unknown");

constexpr auto kState = record(16, {  // 0x7131
    { 13, u8, "MM State",        label(kMMStates)     },
    { 14, u8, "MM Sub State",    label(kSubStates)    },
    { 15, u8, "LU Reject Cause", label(kUpdateStatus) },
});
// clang-format on

}  // namespace

void ProcessCS::showState(ByteView data) const { show(data, kState); }

}  // namespace kelvo
