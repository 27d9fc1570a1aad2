#pragma once

#include <map>
#include <vector>

#include "telephony/simulation/HeldFor.h"
#include "telephony/simulation/IFX/Air.h"
#include "telephony/simulation/PhoneUser.h"

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
    std::size_t serving = 0;         ///< meant where `access` is not None, as are the readings
    double rssi = 0;                 ///< dBm, on GSM
    double gsmToRest = 0;            ///< dB above others on its carrier and noise, on GSM
    double rscp = 0;                 ///< dBm, on UMTS
    double ecN0 = 0;                 ///< dB, on UMTS
    std::vector<GsmNeighbor> gsm;    ///< the strongest first
    std::vector<UmtsNeighbor> umts;  ///< the strongest first

    Registration registration = Registration::Searching;
    LocationArea registered;  ///< the area registered in last

    Connection connection = Connection::Idle;
    double tx = 0;          ///< dBm; this and what follows when connected
    double errors = 0;      ///< part of the blocks, of speech or data, that are lost
    int codingScheme = 0;   ///< of EGPRS, 1 to 9; in packet transfer on GSM
    double throughput = 0;  ///< kbit/s, in packet transfer
};

/// A GSM and UMTS modem.
class Modem {
public:
    Modem(const Network& network, Random random) : _network(network), _random(std::move(random)) {}

    /// Reads the air and acts on it.
    void measure(const Drive& drive, Time now, PhoneUser::Activity activity, double demand);

    const Status& status() const { return _status; }
    /// Of the serving cell.
    LocationArea area() const;

private:
    // The most that are listed, without the serving one.
    std::vector<std::size_t> gsmByStrength() const;
    std::vector<std::size_t> umtsByStrength() const;
    void choose(Time now);
    void chooseFromGsm(Time now);
    void chooseFromUmts(Time now);
    double gsmMargin(std::size_t candidate, Time now) const;
    void move(RadioAccess access, std::size_t sector, Time now);
    void registerInArea(Time now);
    void readServing();
    void readGsmNeighbors(Time now);
    void readUmtsNeighbors();
    void connect(PhoneUser::Activity activity, double demand);
    void connectOnGsm(double demand);
    void connectOnUmts(double demand);

    const Network& _network;
    Random _random;
    Air _air;
    Status _status;
    EachHeldFor _gsmReselection{std::chrono::seconds(5)};
    EachHeldFor _gsmHandover{std::chrono::seconds(1)};
    EachHeldFor _umtsChange{std::chrono::seconds(1)};
    HeldFor _toGsm{std::chrono::seconds(2)};
    EachHeldFor _toUmts{std::chrono::seconds(5)};
    Time _movedAt{0};
    Time _updatedAt{0};
    std::map<std::size_t, Time> _listed;  // since when a GSM cell is in the neighbor list
};

}  // namespace kelvo::simulation::ifx
