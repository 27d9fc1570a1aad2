#pragma once

#include "platform/values/Bytes.h"
#include "telephony/simulation/UTRAN/Modem.h"

/// The log records of a TD-SCDMA modem: one function a record, from what it reports to bytes. Levels and ratios travel
/// in the steps in which phones report them (3GPP TS 25.123, section 9.1).
namespace kelvo::simulation::utran {

/// 0xd0e0: the state of the connection.
Bytes rrcStateRecord(Time time, RrcState state);
/// 0xd0e2: the serving cell, and whether the phone may use it for all calls.
Bytes servingCellRecord(Time time, const Modem& modem);
/// 0xd00a: the serving cell and the others around it.
Bytes cellsRecord(Time time, const Modem& modem);
/// 0xd00e: the GSM cells around.
Bytes gsmCellsRecord(Time time, const Modem& modem);
/// 0xd00c: block errors of the transport channels, and interference on the physical channels that carry them.
Bytes channelsRecord(Time time, const Modem& modem);

/// Level of a P-CCPCH in steps of 1 dB: 0 below -115 dBm, 91 from -25 dBm.
int rscpLevel(double dBm);
/// Share of blocks in error in steps of 0.065 of its logarithm: 0 for none, 1 below -4.03, 63 the most.
int blerLevel(double share);
/// Signal-to-interference ratio in steps of 0.5 dB: 0 below -11 dB, 63 from 20 dB.
int sirLevel(double dB);

}  // namespace kelvo::simulation::utran
