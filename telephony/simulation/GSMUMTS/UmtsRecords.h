#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "platform/values/Bytes.h"
#include "telephony/simulation/GSMUMTS/Phone.h"

namespace kelvo::simulation::gsm {

/// How the searcher knows a cell: used, told of by the network, found on its own, or best of the other carrier.
enum class CellSet { Active, Monitored, Detected, VirtualActive };

struct SearchedCell {
    std::size_t sector = 0;
    int scramblingCode = 0;
    CellSet set = CellSet::Active;
    double ecNo = 0;  ///< dB, Air::kEcNoFloor to 0
};

struct RankedUmtsCell {
    int scramblingCode = 0;
    double rscp = 0;  ///< dBm
    double ecNo = 0;  ///< dB
    double rank = 0;  ///< dB
};
struct RankedGsmCell {
    int arfcn = 0;
    int bsic = 0;
    double level = 0;  ///< dBm
    double rank = 0;   ///< dB
};

/// Checksums of a transport channel's blocks in one window.
struct TransportChannel {
    int id = 0;
    int received = 0;
    int inError = 0;
};
struct BlockErrors {
    int windowSize = 0;  ///< radio frames of 10 ms
    std::vector<TransportChannel> channels = {};
};

struct HarqProcess {
    int id = 0;
    std::uint32_t bits = 0;
    int newTransmissions = 0;
    int blockErrors = 0;
};
struct HsdpaReport {
    int subFrames = 0;  ///< of 2 ms, at most 1023
    bool hasTwoCarriers = false;
    std::vector<HarqProcess> primary = {};
    std::vector<HarqProcess> secondary = {};
};

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
