#pragma once

#include "tools/doctor/PhoneFindings.h"

namespace kelvo {

/// Asks ModemManager on the system bus what it knows, for a few seconds at most, and changes nothing. Needs a
/// QCoreApplication.
PhoneFindings askPhone();

}  // namespace kelvo
