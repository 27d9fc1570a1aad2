#include "platform/encodings/WholeNumber.h"

#include <fmt/format.h>

#include <charconv>
#include <limits>
#include <system_error>

namespace kelvo {

Result<std::uint64_t> wholeNumber(std::string_view text, std::uint64_t least) {
    std::uint64_t number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    const bool isNumber = end == text.data() + text.size() && error != std::errc::invalid_argument;
    if (isNumber && error == std::errc::result_out_of_range) {
        return Failure{
            fmt::format("{} is too large; the largest number is {}", text, std::numeric_limits<std::uint64_t>::max())};
    }
    if (!isNumber || number < least) return Failure{fmt::format("{} is not a whole number from {}", text, least)};
    return number;
}

}  // namespace kelvo
