#pragma once

#include <span>

#include "platform/values/Bytes.h"
#include "telephony/simulation/GSMUMTS/Phone.h"

namespace kelvo::simulation::gsm {

/// A GSM cell beside the serving one.
struct GsmNeighbor {
    int arfcn = 0;
    int bsic = 0;
    double level = 0;  ///< dBm
    double c1 = 0;     ///< dB
};

/// What the GSM layer measures at one moment.
struct GsmMeasurement {
    double level = 0;  ///< dBm, of the serving cell
    double c1 = 0;     ///< dB
    double c2 = 0;     ///< dB
    bool isHysteresisApplied = false;
    std::vector<GsmNeighbor> neighbors = {};
};

struct RrStatus {
    RrState state = RrState::Inactive;
    int subState = 0;  ///< the connection's
    int status = 0;    ///< 1 while there is service
    bool isData = false;
    bool operator==(const RrStatus&) const = default;
};

Bytes servingCellRecord(Time time, const GsmCell& cell);                      // 0x5134
Bytes measurementRecord(Time time, const GsmMeasurement& measurement);        // 0x5137
Bytes decodedCellsRecord(Time time, std::span<const GsmNeighbor> neighbors);  // 0x51ff
Bytes rrStatusRecord(Time time, const RrStatus& status);                      // 0x512c
Bytes dedicatedCarrierRecord(Time time, int arfcn);                           // 0x5076
Bytes channelModeRecord(Time time, bool isDtxUsed);                           // 0x5072
Bytes mobileAllocationRecord(Time time, const GsmCell& cell);                 // 0x51f8

Bytes si13PositionRecord(Time time, const GprsOptions& options);  // 0x51f4
Bytes si13Record(Time time, const GprsOptions& options);          // 0x51f5
Bytes cellOptionsRecord(Time time, const GprsOptions& options);   // 0x51f6
Bytes pbcchRecord(Time time, const GprsOptions& options);         // 0x51fb
Bytes packetStatusRecord(Time time, const GprsOptions& options);  // 0x51fd

}  // namespace kelvo::simulation::gsm
