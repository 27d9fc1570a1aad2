#pragma once

#include "platform/values/Bytes.h"
#include "telephony/simulation/LTE/Modem.h"

/// The log records of an LTE modem: one function a record, from what it reports to bytes.
namespace kelvo::simulation::lte {

/// 0xb0c2: the serving cell's identity, carrier and area.
Bytes servingCellRecord(Time time, const Cell& cell);
/// 0xb0c1: its antennas, as its master information block tells.
Bytes antennasRecord(Time time, const Cell& cell);
/// 0xb179: a connected phone's measurement of its carrier.
Bytes connectedMeasurementRecord(Time time, const Modem& modem);
/// 0xb17f: an idle phone's measurement of its serving cell.
Bytes servingMeasurementRecord(Time time, const Cell& cell, const Reading& reading, const IdleState& idle);
/// 0xb180: an idle phone's measurement of the other cells of a carrier, of which there is at least one.
Bytes neighborMeasurementRecord(Time time, const Modem& modem);
/// 0xb186: the candidate for reselection, if there is one. The layout lays candidates closer to one another than a
/// candidate is long, so that a record has room for one only.
Bytes candidatesRecord(Time time, const Modem& modem);

}  // namespace kelvo::simulation::lte
