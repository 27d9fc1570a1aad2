#pragma once

#include <optional>
#include <string_view>

#include "platform/values/Reading.h"

namespace kelvo {

/// The number that a modem's ready-made text is, with a unit behind it or none: "-71 dBm", "-10.5 dB", "12". The
/// reading prints the very same text. None for every other text, also for one that a number would be written otherwise
/// for ("01", "-0", ".5"), and for a unit that is not among those that radio screens have.
std::optional<Reading> numberInText(std::string_view text);

}  // namespace kelvo
