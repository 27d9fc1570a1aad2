#pragma once

#include <array>

#include "telephony/simulation/ExtendedRecords.h"
#include "telephony/simulation/UTRAN/Air.h"

/// What a TD-SCDMA modem reports, in physical units: the records are made of it.
namespace kelvo::simulation::utran {

/// The states of the radio resource control (3GPP TS 25.331, section 7.1).
enum class RrcState { Disconnected, Connecting, CellFach, CellDch, CellPch, UraPch };

/// A cell as the phone knows it: the serving one or another.
struct Measurement {
    enum class Set { Active, Monitored, Detected };  ///< TS 25.331, section 8.4.0: serving, listed, found unlisted
    std::size_t cell = 0;
    double rscp = 0;  ///< dBm, of the P-CCPCH, filtered as in TS 25.331, section 8.6.7.2
    Set set = Set::Detected;
    bool isJointlyDetected = false;  ///< its codes are cancelled together with the serving cell's
};

struct GsmMeasurement {
    std::size_t cell = 0;  ///< whose mast carries the GSM cell
    int rssi = 0;          ///< dBm
    bool isIdentified = false;
};

/// A transport channel of a dedicated connection.
struct TransportChannel {
    int id = 0;
    double blockErrors = 0;  ///< share of its blocks
};

/// The physical channels that carry them: a coded composite transport channel.
struct CompositeChannel {
    int id = 0;
    int timeslots = 0;                              ///< in use
    std::array<std::optional<double>, 6> sir = {};  ///< dB, in the traffic timeslots 1 to 6; none where not in use
};

class Modem;

/// The serving cell and the two strongest of those listed.
std::vector<MonitoredCell> monitoredCells(const Modem& modem);
std::vector<PdpContext> pdpContexts(const Modem& modem);

}  // namespace kelvo::simulation::utran
