#pragma once

#include <cstdint>

namespace kelvo {

/// The kind of a log record: the baseband's 16-bit code, or'ed with 0xff0000 for records of type 255.
using LogCode = std::uint32_t;

inline constexpr LogCode kExtendedLogCodes = 0xff0000;

}  // namespace kelvo
