#pragma once

#include <cstdint>
#include <string_view>

namespace kelvo {

/// The kind of a log record: the baseband's 16-bit code, or'ed with 0xff0000 for records of type 255.
using LogCode = std::uint32_t;

inline constexpr LogCode kExtendedLogCodes = 0xff0000;

/// A code with a name; it stands for its code wherever one is wanted. Each family has its own in `<family>/…Codes.h`,
/// in the namespace `code`.
struct KnownCode {
    LogCode code;
    std::string_view name;    ///< for people, the system first: "LTE serving cell, idle"
    std::string_view source;  ///< the standard whose quantities the record reports

    constexpr operator LogCode() const { return code; }
};

}  // namespace kelvo
