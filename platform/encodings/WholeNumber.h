#pragma once

#include <cstdint>
#include <string_view>

#include "platform/values/Result.h"

namespace kelvo {

/// The number that a user wrote in decimal digits, and nothing else, `least` or more. The reason of a failure names the
/// text: "-1 is not a whole number from 1".
Result<std::uint64_t> wholeNumber(std::string_view text, std::uint64_t least = 0);

}  // namespace kelvo
