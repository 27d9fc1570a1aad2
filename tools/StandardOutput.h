#pragma once

#include <string_view>

namespace kelvo {

/// Writes `text` to standard output and hands it on at once. Throws CommandFailure when it could not be written.
void writeToStandardOutput(std::string_view text);

}  // namespace kelvo
