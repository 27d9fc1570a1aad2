#pragma once

#include "platform/values/Value.h"
#include "telephony/simulation/IFX/Modem.h"

namespace kelvo::simulation::ifx {

/// The modem's whole cell monitor as its service sends it: dictionaries, arrays that begin with a header, and texts.
/// Readings are rounded to whole dBm, Ec/N0 to half a dB, throughput to whole kbit/s, errors to 0.1 %.
Value monitorTree(const Status& status, const Network& network);

}  // namespace kelvo::simulation::ifx
