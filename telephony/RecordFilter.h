#pragma once

#include <bitset>
#include <cstdint>
#include <memory>
#include <optional>

#include "LogGenerator/LogCode.h"
#include "platform/values/Bytes.h"

namespace kelvo {

/// The log code of a record as the service delivers it; none when it is too short to hold one.
std::optional<LogCode> codeOf(ByteView record);

/// Which records a client asked for. Nothing passes until it asked.
class RecordFilter {
public:
    /// The 16-bit codes of one code space: 8 KiB.
    using Codes = std::bitset<65536>;

    /// Lets everything through: for a technology whose records have no codes.
    void passEverything() { _everything = true; }
    void setOrdinaryCodes(std::shared_ptr<const Codes> codes) { _ordinary = std::move(codes); }
    void setExtendedCodes(std::shared_ptr<const Codes> codes) { _extended = std::move(codes); }

    /// None: no code.
    const std::shared_ptr<const Codes>& ordinaryCodes() const { return _ordinary; }

    /// A record too short to hold a code has none, and nobody can have asked for it.
    bool passes(ByteView record) const;

private:
    bool _everything = false;
    std::shared_ptr<const Codes> _ordinary;  // none: no code
    std::shared_ptr<const Codes> _extended;
};

}  // namespace kelvo
