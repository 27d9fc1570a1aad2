#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "telephony/simulation/ExtendedRecords.h"
#include "telephony/simulation/GSMUMTS/Modem.h"

/// What a GSM and UMTS modem reports, in physical units: the records are made of it.
namespace kelvo::simulation::gsm {

/// A GSM cell beside the serving one.
struct GsmNeighbor {
    Arfcn arfcn;
    Bsic bsic;
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

/// The network as its serving cell broadcasts it, and what the phone has of it.
struct ServingNetwork {
    Area area = {};
    ServiceType service = ServiceType::None;
    int operationMode = 0;  ///< 0 is mode I
    bool operator==(const ServingNetwork&) const = default;
};

struct Plmn {
    int mcc = 0;
    int mnc = 0;
    bool operator==(const Plmn&) const = default;
};

/// How the searcher knows a cell: used, told of by the network, found on its own, or best of the other carrier.
enum class CellSet { Active, Monitored, Detected, VirtualActive };

struct SearchedCell {
    std::size_t sector = 0;
    Psc scramblingCode;
    CellSet set = CellSet::Active;
    double ecNo = 0;  ///< dB, Air::kEcNoFloor to 0
};

struct RankedUmtsCell {
    Psc scramblingCode;
    double rscp = 0;  ///< dBm
    double ecNo = 0;  ///< dB
    double rank = 0;  ///< dB
};
struct RankedGsmCell {
    Arfcn arfcn;
    Bsic bsic;
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

/// The phone where it is.
struct World {
    const Network& network;
    const Air& air;
    const Modem& modem;
};

// What the modem has to report of the world. Those that take a random source draw anew each time, so the caller keeps
// what it gets.
GsmMeasurement gsmMeasurement(const World& world);
RrStatus rrStatus(const World& world);
ServingNetwork servingNetwork(const World& world);
std::vector<Plmn> equivalentPlmns(const World& world);
std::vector<SearchedCell> searchedCells(const World& world);
std::vector<RankedUmtsCell> rankedUmtsCells(const World& world);
std::vector<RankedGsmCell> rankedGsmCells(const World& world);
std::vector<MonitoredCell> monitoredCells(const World& world);
/// `sessions`: data sessions begun so far.
std::vector<PdpContext> pdpContexts(const World& world, int sessions);

/// Open-loop power for the path to the serving cell, and the inner loop's answer to the fading in each slot. At most
/// one slot has none.
std::vector<std::optional<double>> transmitPower(const World& world, Random& random);
BlockErrors blockErrors(const World& world, Time window, Random& random);
HsdpaReport hsdpaReport(const World& world, Time window, Random& random);

/// Part of the blocks that cannot be read at this Ec/No: half of them at -16 dB, one in a hundred at -10.5 dB.
double blockErrorRate(double ecNo);
/// bit/s through the shared channel of one carrier: Shannon's bound with the attenuation of 3GPP TR 36.942, annex A.1.
double dataRate(double sinr);

}  // namespace kelvo::simulation::gsm
