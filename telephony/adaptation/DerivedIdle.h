#pragma once

#include <cstdint>

#include "telephony/adaptation/IdleCells.h"

/// A 0xB17F record of what tells less than it: a 0xB193, or the phone's own services.
namespace kelvo::adaptation {

/// The serving cell of an LTE phone and its levels.
struct ServingLevels {
    std::uint32_t earfcn = 0;
    std::uint16_t pci = 0;
    double rsrp = 0;  ///< dBm
    double rsrq = 0;  ///< dB
    double rssi = 0;  ///< dBm

    bool operator==(const ServingLevels&) const = default;
};

/// The payload of a fixed 0xB17F. Levels take the nearest step, ties up, and saturate; an EARFCN above 65,535 becomes
/// 65535. `last` is the cell's last real 0xB17F; none: what the levels do not say has the standard's neutral values (no
/// demand on the level, no limits, power class 3).
IdleCells::Payload derivedIdle(const ServingLevels& levels, const IdleCells::Payload* last);

/// Completes a derived payload (`made`, 20 bytes) by the cell's last real 0xB17F: what that said beside the levels, and
/// its Srxlev, moved as far as measured RSRP has moved since.
void completeIdle(std::uint8_t* made, const IdleCells::Payload& last);

}  // namespace kelvo::adaptation
