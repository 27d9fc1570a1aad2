#pragma once

#include <string>

#include "packaging/manual/Description.h"

namespace kelvo::manual {

/// "kelvoctl-decode" of "kelvoctl decode".
std::string pageName(const Description& description);

/// The manual page, in section 1, of a program or a command of one. `more` holds sections written by hand, in roff;
/// they stand in front of the examples.
std::string manPage(const Description& description, const std::string& more);

}  // namespace kelvo::manual
