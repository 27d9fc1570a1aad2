#pragma once

#include "tools/share/Replacer.h"

namespace kelvo {

/// What screens showed, with pseudonyms. What no screen has is removed and counted.
Value sharedDisplay(Replacer& replacer, const Value& display);

}  // namespace kelvo
