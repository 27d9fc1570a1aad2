#pragma once

#include "telephony/simulation/ExtendedRecords.h"
#include "telephony/simulation/GSMUMTS/GsmRecords.h"
#include "telephony/simulation/GSMUMTS/MobilityRecords.h"
#include "telephony/simulation/GSMUMTS/UmtsRecords.h"

namespace kelvo::simulation::gsm {

/// The phone where it is.
struct World {
    const Network& network;
    const Air& air;
    const Phone& phone;
};

// What the modem has to report of the world, in physical units. Those that draw do so anew each time: they are kept by
// who asks.
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
std::vector<std::optional<double>> drawTransmitPower(const World& world, Random& random);
BlockErrors drawBlockErrors(const World& world, Time window, Random& random);
HsdpaReport drawHsdpaReport(const World& world, Time window, Random& random);

/// Part of the blocks that cannot be read at this Ec/No: half of them at -16 dB, one in a hundred at -10.5 dB.
double blockErrorRate(double ecNo);
/// bit/s through the shared channel of one carrier: Shannon's bound with the attenuation of 3GPP TR 36.942, annex A.1.
double dataRate(double sinr);

}  // namespace kelvo::simulation::gsm
