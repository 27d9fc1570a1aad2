#pragma once

#include <vector>

#include "telephony/wire/RecordConfiguration.h"

namespace kelvo::modem {

/// Which records a modem has, and which of them it is to send: a mask for each equipment.
class RecordMasks {
public:
    explicit RecordMasks(const wire::Ranges& ranges) : _ranges(ranges) { clear(); }

    const wire::Ranges& ranges() const { return _ranges; }
    /// Puts a mask in force, cut to what the modem has. Its equipment is below 16.
    void set(const wire::LogMask& mask);
    const wire::LogMask& get(std::uint32_t equipment) const { return _masks[equipment]; }
    void clear();
    void setAll();

    bool wants(std::uint16_t code) const { return _masks[code >> 12].test(code); }
    /// Whether any record at all is asked for.
    bool wantAny() const;

private:
    wire::Ranges _ranges;
    std::vector<wire::LogMask> _masks;
};

}  // namespace kelvo::modem
