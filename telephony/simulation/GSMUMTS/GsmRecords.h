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

Bytes servingCellRecord(const GsmCell& cell, Time time);                      // 0x5134
Bytes measurementRecord(const GsmMeasurement& measurement, Time time);        // 0x5137
Bytes decodedCellsRecord(std::span<const GsmNeighbor> neighbors, Time time);  // 0x51ff
Bytes rrStatusRecord(const RrStatus& status, Time time);                      // 0x512c
Bytes dedicatedCarrierRecord(int arfcn, Time time);                           // 0x5076
Bytes channelModeRecord(bool isDtxUsed, Time time);                           // 0x5072
Bytes mobileAllocationRecord(const GsmCell& cell, Time time);                 // 0x51f8

Bytes si13PositionRecord(const GprsOptions& options, Time time);  // 0x51f4
Bytes si13Record(const GprsOptions& options, Time time);          // 0x51f5
Bytes cellOptionsRecord(const GprsOptions& options, Time time);   // 0x51f6
Bytes pbcchRecord(const GprsOptions& options, Time time);         // 0x51fb
Bytes packetStatusRecord(const GprsOptions& options, Time time);  // 0x51fd

}  // namespace kelvo::simulation::gsm
