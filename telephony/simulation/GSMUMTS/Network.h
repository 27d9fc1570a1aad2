#pragma once

#include <cstddef>
#include <vector>

#include "telephony/simulation/Town.h"

namespace kelvo::simulation::gsm {

enum class Rat { GSM, UMTS };

inline constexpr int kMcc = 1;  // the test network of ITU-T E.212: MCC 001, MNC 01
inline constexpr int kMnc = 1;

/// A location area and the routing area within it.
struct Area {
    int lac = 0;
    int rac = 0;
    bool operator==(const Area&) const = default;
};

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
    int arfcn = 0;  ///< of the BCCH; primary GSM 900 band
    int bsic = 0;
    Area area = {};
    double reselectOffset = 0;  ///< CELL_RESELECT_OFFSET, dB
    int hoppingSequence = 0;
    std::vector<int> mobileAllocation = {};  ///< ARFCNs of the traffic channels
    GprsOptions gprs = {};
};

struct UmtsCell {
    int cellId = 0;  ///< 28 bits: RNC and cell
    int scramblingCode = 0;
    Area area = {};
    int uraId = 0;
    bool hasTwoCarriers = false;
};

inline constexpr int kDownlinkUarfcn = 10562;  // 2112.4 MHz, band I
inline constexpr int kUplinkUarfcn = 9612;

/// Two layers of one operator: GSM over the whole town, UMTS from small cells in its centre. Cells have the indices of
/// their layer's sectors. All of one district are in one location area, a GSM and a UMTS one.
struct Network {
    explicit Network(Random& random);

    std::vector<Sector> gsmSectors;
    std::vector<Sector> umtsSectors;
    std::vector<GsmCell> gsm;
    std::vector<UmtsCell> umts;
};

inline constexpr double kTownRadius = 2500;    // metres
inline constexpr double kCentreRadius = 1000;  // metres: UMTS sites up to here

}  // namespace kelvo::simulation::gsm
