#pragma once

#include "platform/values/Bytes.h"
#include "telephony/simulation/CDMA/Reports.h"
#include "telephony/simulation/Time.h"

/// The log records of a CDMA2000 modem: one function a record, from what it reports to bytes. Values are rounded
/// to the record's resolution and cut to its range.
namespace kelvo::simulation::cdma {

Bytes oneXStatusRecord(Time time, const OneXStatus& status);                 // 0x119c
Bytes trafficFrameRecord(Time time, bool erased);                            // 0x119d
Bytes systemRecord(Time time, const System& system);                         // 0x134f
Bytes evdoStatusRecord(Time time, const EvdoStatus& status);                 // 0x1183
Bytes evdoPilotsRecord(Time time, const std::vector<PilotReading>& active);  // 0x12b6
Bytes fingersRecord(Time time, const std::vector<Finger>& fingers);          // 0x108a
Bytes forwardPacketsRecord(Time time, const PacketCounters& counters);       // 0x1192
Bytes reversePacketsRecord(Time time, const PacketCounters& counters);       // 0x127e

}  // namespace kelvo::simulation::cdma
