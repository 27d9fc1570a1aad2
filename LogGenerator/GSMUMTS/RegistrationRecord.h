#pragma once

#include "LogGenerator/FieldTable.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// 0x7132: registration and network selection. Four sections show it.
struct RegistrationRecord {
    static constexpr std::size_t kMinimum = 16;

    // clang-format off
    static constexpr auto kStates = ValueTable({
        { 0, "REG_STATE_INACTIVE"         },
        { 1, "REG_STATE_IDLE"             },
        { 2, "REG_STATE_REGISTERING"      },
        { 3, "REG_STATE_DEREGISTERING"    },
        { 4, "REG_STATE_MANUAL_SEARCH"    },
        { 5, "REG_STATE_AUTOMATIC_SEARCH" },
        { 6, "REG_STATE_OFFLINE"          },
    }, "Unknown");
    static constexpr auto kSelectionModes = ValueTable({
        { 0, "Automatic"           },
        { 1, "Manual"              },
        { 2, "Limited"             },
        { 3, "LIMITED_ROUTINE_ACQ" },
        { 4, "LIMITED_MANUAL_ACQ"  },
    }, "Unknown");

    static constexpr auto kState = record(code::kRegistration, kMinimum, {  // Process CO, CS and PS
        { 13, u8, "MM Service State", label(kStates)         },
    });
    static constexpr auto kSelection = record(code::kRegistration, kMinimum, {  // Serving PLMN
        { 14, u8, "PLMN Sel Mod",     label(kSelectionModes) },
    });
    // clang-format on
};

}  // namespace kelvo
