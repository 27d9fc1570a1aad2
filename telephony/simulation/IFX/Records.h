#pragma once

#include "platform/values/Bytes.h"
#include "telephony/simulation/IFX/Reports.h"

/// The message of a modem with a cell monitor: no log record, and no time in it.
namespace kelvo::simulation::ifx {

/// The whole cell monitor as a property list: dictionaries, arrays that begin with a header, and texts. Readings are
/// rounded to whole dBm, Ec/N0 to half a dB, throughput to whole kbit/s, errors to 0.1 %.
Bytes cellMonitorRecord(const Status& status, const Network& network);

}  // namespace kelvo::simulation::ifx
