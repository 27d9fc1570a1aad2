#pragma once

#include <array>
#include <optional>
#include <vector>

#include "telephony/wire/RecordConfiguration.h"

namespace kelvo::wire {

/// Which records a modem has been asked for, and which it is to be asked for: the codes that are wanted, as far as it
/// has them.
class MaskKeeper {
public:
    /// A modem of these ranges has been asked for nothing yet.
    void begin(const Ranges& ranges);
    const Ranges& ranges() const { return _ranges; }
    /// The codes that are wanted from now on.
    void want(const RecordCodes& codes) { _wanted = codes; }
    bool wants(LogCode code) const { return code < _wanted.size() && _wanted.test(code); }

    /// The codes that are wanted and that the modem has no place for, each only once after begin().
    std::vector<LogCode> takeUnknown();
    /// The next mask to ask for: none when the modem has been asked for everything. It counts as asked for.
    std::optional<LogMask> takeNext();
    /// The codes of the mask that was taken last and are not in force, each only once after begin(). `inForce` is none
    /// when the modem refused the whole mask.
    std::vector<LogCode> takeRefused(const std::optional<LogMask>& inForce);

private:
    bool has(LogCode code) const { return (code & 0xFFF) < _ranges[code >> 12]; }
    LogMask wantedOf(std::uint32_t equipment) const;
    void tellOnce(LogCode code, std::vector<LogCode>& codes);

    Ranges _ranges{};
    RecordCodes _wanted;
    RecordCodes _told;
    std::array<std::optional<LogMask>, kEquipmentIds> _asked;
    std::uint32_t _last = 0;  // the equipment of the mask that was taken last
};

}  // namespace kelvo::wire
