#pragma once

#include <cstddef>
#include <vector>

#include "telephony/simulation/RadioNumbers.h"
#include "telephony/simulation/Town.h"

namespace kelvo::simulation::gsm {

enum class Rat { GSM, UMTS };

/// What a GSM cell's system information 13 says of packet data (3GPP TS 44.018, 10.5.2.37b). The numbers are the
/// codes on the air.
struct GprsOptions {
    int networkOperationMode = 0;  ///< 0 is mode I
    int networkControlOrder = 0;
    bool hasPacketFlowContexts = false;
    int priorityAccessThreshold = 6;
    int t3192 = 0;
    int drxTimerMax = 2;  ///< seconds
    bool longAccessBursts = false;
    bool hasPbcch = false;
    bool isSi13OnExtendedBcch = false;
    bool hasPacketSystemInformation = false;
    bool hasExtendedMeasurementOrder = false;
    int psiCountLow = 0;   ///< PSI messages repeated at the low rate
    int psiCountHigh = 0;  ///< and at the high rate
};

struct GsmCell {
    int cellId = 0;
    Arfcn arfcn;  ///< of the BCCH; primary GSM 900 band
    Bsic bsic;
    Area area = {};
    double reselectOffset = 0;  ///< CELL_RESELECT_OFFSET, dB
    int hoppingSequence = 0;
    std::vector<Arfcn> mobileAllocation = {};  ///< the carriers of the traffic channels
    GprsOptions gprs = {};
};

struct UmtsCell {
    int cellId = 0;  ///< 28 bits: RNC and cell
    Psc scramblingCode;
    Area area = {};
    int uraId = 0;
    bool hasTwoCarriers = false;
};

inline constexpr Uarfcn kDownlinkUarfcn{10562};  // 2112.4 MHz, band I
inline constexpr Uarfcn kUplinkUarfcn{9612};

/// The network of a GSM and UMTS operator: GSM over the whole town, UMTS from small cells in its centre. Cells have the
/// indices of their layer's sectors. All of one district are in one location area, a GSM and a UMTS one.
struct Network {
    explicit Network(Random& random);

    std::vector<Sector> gsmSectors;
    std::vector<Sector> umtsSectors;
    std::vector<GsmCell> gsmCells;
    std::vector<UmtsCell> umtsCells;
};

inline constexpr double kTownRadius = 2500;    // metres
inline constexpr double kCentreRadius = 1000;  // metres: UMTS sites up to here

}  // namespace kelvo::simulation::gsm
