#pragma once

#include <map>
#include <set>
#include <vector>

#include "telephony/simulation/HeldFor.h"
#include "telephony/simulation/IFX/Air.h"
#include "telephony/simulation/IFX/Reports.h"
#include "telephony/simulation/PhoneUser.h"

namespace kelvo::simulation::ifx {

/// The modem: chooses its network and cell, registers, and connects as its user wants.
class Modem {
public:
    /// Both must outlive it.
    Modem(const Network& network, const Air& air, Random random)
        : _network(network), _air(air), _random(std::move(random)) {}

    /// Acts on what was measured then.
    void step(Time now, const PhoneUser& user);

    const Status& status() const { return _status; }
    /// The status has been sent: the network may move the phone to the UMTS neighbors in it.
    void markReported();
    /// Of the serving cell.
    Area area() const;

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
    void connect(const PhoneUser& user);
    void connectOnGsm(double demand);
    void connectOnUmts(double demand);

    const Network& _network;
    const Air& _air;
    Random _random;
    Status _status;
    EachHeldFor _gsmReselection{std::chrono::seconds(5)};
    EachHeldFor _gsmHandover{std::chrono::seconds(1)};
    EachHeldFor _umtsChange{std::chrono::seconds(1)};
    std::set<std::size_t> _reported;  // UMTS neighbors in the last message
    HeldFor _toGsm{std::chrono::seconds(2)};
    EachHeldFor _toUmts{std::chrono::seconds(5)};
    Time _movedAt{0};
    Time _updatedAt{0};
    std::map<std::size_t, Time> _listed;  // since when a GSM cell is in the neighbor list
};

}  // namespace kelvo::simulation::ifx
