#pragma once

#include "tools/inputs/Input.h"
#include "tools/report/Drive.h"
#include "tools/share/RecordSharer.h"

namespace kelvo::report {

/// Follows a recording from its beginning to its end, or to where it can be read no further, and keeps what a report
/// tells of it. Every record goes through `sharer` first, when there is one; then nothing else tells of the file, its
/// name neither. Throws CommandFailure for a record that ends the program elsewhere.
Drive followDrive(Input& input, RecordSharer* sharer = nullptr);

}  // namespace kelvo::report
