#pragma once

#include "telephony/simulation/Generation.h"
#include "telephony/simulation/LTE/Records.h"

namespace kelvo::simulation::lte {

/// How a modem of one year words its records.
struct Wording {
    Bytes (*antennas)(Time, const Cell&);
    Bytes (*servingCell)(Time, const Cell&);
    Bytes (*connectedMeasurement)(Time, const Modem&);
    Bytes (*servingMeasurement)(Time, const Cell&, const Reading&, const IdleState&);
    Bytes (*neighborMeasurement)(Time, const Modem&);
    /// 0xb193: the serving cell, idle or connected, and three neighbors on its carrier; none: it has no such record.
    Bytes (*everyModeMeasurement)(Time, const Modem&);
};

/// 2010: the layouts of Records.h.
/// 2014: 0xb0c1 version 2, 0xb0c2 version 3, 0xb179 version 3, 0xb17f and 0xb180 version 4, 0xb193 part 25 version 19.
/// 2018: 0xb0c1 and 0xb0c2 version 3, 0xb179 version 4, 0xb17f and 0xb180 version 5, 0xb193 part 25 version 36.
const Wording& wordingOf(Generation generation);

}  // namespace kelvo::simulation::lte
