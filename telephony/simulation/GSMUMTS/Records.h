#pragma once

#include "platform/values/Bytes.h"
#include "telephony/simulation/GSMUMTS/Reports.h"

/// The log records of a GSM and UMTS modem: one function a record, from what it reports to bytes.
namespace kelvo::simulation::gsm {

Bytes packetStateRecord(Time time, const Mobility& mobility);          // 0x7130
Bytes circuitStateRecord(Time time, const Mobility& mobility);         // 0x7131
Bytes registrationRecord(Time time, const Mobility& mobility);         // 0x7132
Bytes servingNetworkRecord(Time time, const ServingNetwork& network);  // 0x7135
/// At most one: the entries of more would lie over one another. 0x7150
Bytes equivalentPlmnsRecord(Time time, std::span<const Plmn> plmns);

Bytes servingCellRecord(Time time, const GsmCell& cell);                      // 0x5134
Bytes measurementRecord(Time time, const GsmMeasurement& measurement);        // 0x5137
Bytes decodedCellsRecord(Time time, std::span<const GsmNeighbor> neighbors);  // 0x51ff
Bytes rrStatusRecord(Time time, const RrStatus& status);                      // 0x512c
Bytes dedicatedCarrierRecord(Time time, Arfcn arfcn);                         // 0x5076
Bytes channelModeRecord(Time time, bool isDtxUsed);                           // 0x5072
Bytes mobileAllocationRecord(Time time, const GsmCell& cell);                 // 0x51f8

Bytes si13PositionRecord(Time time, const GprsOptions& options);  // 0x51f4
Bytes si13Record(Time time, const GprsOptions& options);          // 0x51f5
Bytes cellOptionsRecord(Time time, const GprsOptions& options);   // 0x51f6
Bytes pbcchRecord(Time time, const GprsOptions& options);         // 0x51fb
Bytes packetStatusRecord(Time time, const GprsOptions& options);  // 0x51fd

Bytes searcherRecord(Time time, double rssi, std::span<const SearchedCell> cells);  // 0x417a; dBm
Bytes umtsRankingRecord(Time time, std::span<const RankedUmtsCell> cells);          // 0x4005
Bytes gsmRankingRecord(Time time, std::span<const RankedGsmCell> cells);            // 0x4005
Bytes rrcStateRecord(Time time, RrcState state);                                    // 0x4125
Bytes rrcCellRecord(Time time, const UmtsCell& cell);                               // 0x4127
Bytes cipheringRecord(Time time, bool isCiphered);                                  // 0x4157
/// dBm in each slot; none where nothing is sent. 0x4031
Bytes transmitPowerRecord(Time time, std::span<const std::optional<double>> slots);
Bytes blockErrorsRecord(Time time, const BlockErrors& errors);  // 0x4116
Bytes hsdpaRecord(Time time, const HsdpaReport& report);        // 0x4221

}  // namespace kelvo::simulation::gsm
