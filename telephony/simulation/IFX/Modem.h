#pragma once

#include <map>
#include <vector>

#include "telephony/simulation/HeldFor.h"
#include "telephony/simulation/IFX/Air.h"
#include "telephony/simulation/IFX/Reports.h"
#include "telephony/simulation/PhoneUser.h"

namespace kelvo::simulation::ifx {

/// A GSM and UMTS modem.
class Modem {
public:
    Modem(const Network& network, Random random) : _network(network), _random(std::move(random)) {}

    /// Reads the air and acts on it.
    void measure(Time now, const Drive& drive, PhoneUser::Activity activity, double demand);

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
