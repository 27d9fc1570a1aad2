#pragma once

#include "telephony/simulation/GSMUMTS/Records.h"
#include "telephony/simulation/Generation.h"

namespace kelvo::simulation::gsm {

/// How a modem of one year words its records.
struct Wording {
    Bytes (*umtsRanking)(Time, std::span<const RankedUmtsCell>);
    Bytes (*gsmRanking)(Time, std::span<const RankedGsmCell>);
    Bytes (*rrcCell)(Time, const UmtsCell&);
    Bytes (*gsmMeasurement)(Time, const GsmMeasurement&);
    Bytes (*equivalentPlmns)(Time, std::span<const Plmn>);
    bool hasTwoSims;  ///< its GSM records say of which SIM they are
};

/// 2010: the layouts of Records.h.
/// 2014: 0x4005 version 1, the long 0x4127, 0x51fc in place of 0x5137, and 0x7150 as the network sends its list.
/// 2018: likewise with 0x4005 version 2, and of the first of two SIMs: 0x5b34 in place of 0x5134, 0x5bfc of 0x51fc, and
/// so on for every GSM code.
const Wording& wordingOf(Generation generation);

/// A record of a modem with two SIMs, made of one of a modem with one; records that are not GSM's stay as they are.
Bytes ofFirstSim(Bytes message);

}  // namespace kelvo::simulation::gsm
