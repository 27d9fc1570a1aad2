#pragma once

#include "platform/values/Bytes.h"
#include "telephony/simulation/LTE/LteModem.h"

namespace kelvo::simulation {

// The log records of an LTE modem, as its log service words them.

/// 0xb0c2: the serving cell's identity, carrier and area.
Bytes lteServingCellRecord(Time time, const LteCell& cell);
/// 0xb0c1: its antennas, as its master information block tells.
Bytes lteAntennasRecord(Time time, const LteCell& cell);
/// 0xb179: a connected phone's measurement of its carrier.
Bytes lteConnectedMeasurementRecord(Time time, const LteModem& modem);
/// 0xb17f: an idle phone's measurement of its serving cell.
Bytes lteServingMeasurementRecord(Time time, const LteCell& cell, const LteReading& reading, const LteIdleState& idle);
/// 0xb180: an idle phone's measurement of the other cells of a carrier, of which there is at least one.
Bytes lteNeighborMeasurementRecord(Time time, const LteModem& modem);
/// 0xb186: the candidate for reselection, if there is one. The layout lays candidates closer to one another than a
/// candidate is long, so that a record has room for one only.
Bytes lteCandidatesRecord(Time time, const LteModem& modem);

}  // namespace kelvo::simulation
