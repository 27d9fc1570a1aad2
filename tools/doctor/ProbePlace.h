#pragma once

#include <string>

#include "tools/doctor/ModemProbe.h"

namespace kelvo {

/// Opens the port at `place` (a path, "tcp:HOST:PORT" or "unix:PATH"), asks the modem behind it and closes the port,
/// with a serial line's settings as they were.
ModemProbe probePlace(const std::string& place);

}  // namespace kelvo
