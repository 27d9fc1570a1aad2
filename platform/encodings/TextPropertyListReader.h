#pragma once

#include <string_view>

#include "platform/values/Result.h"
#include "platform/values/Value.h"

namespace kelvo {

/// Reads the old text form, in UTF-8 without byte-order mark or NUL:
///
///     { key = value; }    ( a, b )    "quoted\n\U0041"    word    <0fbd77 1c>    // comment    /* comment */
///
/// A word is made of letters, digits and _ $ / : . - alone. The entries of a dictionary may also stand at the top level
/// without braces. Nothing but space and comments may follow the value.
Result<Value> readTextPropertyList(std::string_view text);

}  // namespace kelvo
