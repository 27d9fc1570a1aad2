#pragma once

#include "tools/inputs/Input.h"
#include "tools/report/Drive.h"

namespace kelvo::report {

/// Follows a recording from its beginning to its end, or to where it can be read no further, and keeps what a report
/// tells of it. Throws CommandFailure for a record that ends the program elsewhere.
Drive followDrive(Input& input);

}  // namespace kelvo::report
