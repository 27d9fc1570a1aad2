#pragma once

#include <vector>

#include "telephony/simulation/IFX/Network.h"

/// What a modem with a cell monitor reports, in physical units: its message is made of it.
namespace kelvo::simulation::ifx {

enum class RadioAccess { None, Gsm, Umts };
enum class Registration { Searching, Updating, Registered };
enum class Connection { Idle, Call, Packet };

/// A GSM cell of the neighbor list. Its level is known half a second after it has come into the list, its identity
/// code, which must be decoded, a second later.
struct GsmNeighbor {
    std::size_t sector;
    double rssi;  ///< dBm
    bool measured;
    bool identified;
};

struct UmtsNeighbor {
    std::size_t sector;
    double rscp;  ///< dBm
    double ecN0;  ///< dB
};

/// What the modem knows at one moment.
struct Status {
    RadioAccess access = RadioAccess::None;
    std::size_t serving = 0;           ///< meant where `access` is not None, as are the readings
    double rssi = 0;                   ///< dBm, on GSM
    double carrierToInterference = 0;  ///< dB above others on its carrier and noise, on GSM
    double rscp = 0;                   ///< dBm, on UMTS
    double ecN0 = 0;                   ///< dB, on UMTS
    std::vector<GsmNeighbor> gsm;      ///< the strongest first
    std::vector<UmtsNeighbor> umts;    ///< the strongest first

    Registration registration = Registration::Searching;
    Area registered;  ///< the area registered in last

    Connection connection = Connection::Idle;
    double tx = 0;          ///< dBm; this and what follows when connected
    double errors = 0;      ///< part of the blocks, of speech or data, that are lost
    int codingScheme = 0;   ///< of EGPRS, 1 to 9; in packet transfer on GSM
    double throughput = 0;  ///< kbit/s, in packet transfer
};

}  // namespace kelvo::simulation::ifx
