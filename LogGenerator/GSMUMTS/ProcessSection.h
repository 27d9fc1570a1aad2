#pragma once

#include "LogGenerator/Base.h"
#include "platform/system/Environment.h"

namespace kelvo {

// clang-format off
inline constexpr ValueTable kRegistrationStates({
    { 0, "REG_STATE_INACTIVE"         },
    { 1, "REG_STATE_IDLE"             },
    { 2, "REG_STATE_REGISTERING"      },
    { 3, "REG_STATE_DEREGISTERING"    },
    { 4, "REG_STATE_MANUAL_SEARCH"    },
    { 5, "REG_STATE_AUTOMATIC_SEARCH" },
    { 6, "REG_STATE_OFFLINE"          },
}, "Unknown");

inline constexpr auto kRegistrationState = record(16, {  // 0x7132
    { 13, u8, "MM Service State", label(kRegistrationStates) },
});
// clang-format on

/// What the registration processes share: their own state under the first of their codes, and the registration state
/// (0x7132) that all of them show. `Derived` says with `kTraceWord` what each record writes to the log.
template <class Derived>
class ProcessSection : public Section<Derived> {
public:
    using Section<Derived>::Section;

    void updateWithData(ByteView data, LogCode logCode) final {
        logLine(Level::Warning, Derived::kTraceWord);
        if (logCode == Derived::kLogCodes.front()) {
            showState(data);
        } else if (logCode == 0x7132) {
            this->show(data, kRegistrationState);
        } else {
            this->reportUnknown(logCode);
        }
    }

private:
    virtual void showState(ByteView data) const = 0;
};

}  // namespace kelvo
