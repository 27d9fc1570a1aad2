#pragma once

#include <functional>

#include "telephony/simulation/HeldFor.h"
#include "telephony/simulation/LTE/Air.h"
#include "telephony/simulation/LTE/Reports.h"
#include "telephony/simulation/PhoneUser.h"

namespace kelvo::simulation::lte {

/// The modem: camps, measures, reselects and hands over, registers, and is idle or connected by turns.
class Modem {
public:
    /// Both must outlive it.
    Modem(const Network& network, Air& air, Random random);

    /// Moves on to then, one step after the last time.
    void step(Time now, const PhoneUser& user);

    /// In the last step, and as the phone still is.
    bool hasMeasured() const { return _hasMeasured; }

    std::size_t servingIndex() const { return _serving; }
    const Cell& serving() const { return _cells[_serving]; }
    const Reading& reading() const { return _air.reading(_serving); }
    bool isConnected() const { return _isConnected; }
    /// The tracking area that the network believes the phone to be in.
    int registeredArea() const { return _registeredArea; }
    bool isOnCall() const { return _isOnCall; }
    /// The serving cell's subframe, counted over all its 1024 frames.
    int subframe() const;

    /// Measured on the carrier that was looked at last; of an idle phone each carrier in its turn.
    const std::vector<Neighbor>& neighbors() const { return _neighbors; }
    const Carrier& neighborsCarrier() const { return _neighborsCarrier; }
    int neighborsMinimumLevel() const { return _neighborsMinimumLevel; }
    /// Physical identities of those found on the serving carrier, and not measured yet.
    const std::vector<Pci>& detected() const { return _detected; }
    /// Of an idle phone.
    const IdleState& idle() const { return _idle; }
    /// The candidate for reselection that was weighed last, each in its turn.
    const std::optional<Candidate>& candidate() const { return _candidate; }

private:
    void followUser(const PhoneUser& user);
    void connect();
    void release();
    void registerInArea();
    void camp(std::size_t cell);
    void measureConnected();
    void measureInGaps();
    void handOver();
    void redirect();
    void measureIdle();
    void evaluateServing();
    void lookAround();
    void listNeighbors(const Carrier& carrier);
    Neighbor neighbor(std::size_t cell) const;
    void weighCandidates();
    void reselect();
    std::optional<std::size_t> bestMeasured(const std::function<bool(const Cell&)>& isWanted) const;
    bool isOnServingCarrier(const Carrier& carrier) const { return carrier.downlink == serving().carrier.downlink; }
    double meanLevel(std::size_t cell) const;
    bool isFit(std::size_t cell) const { return _air.reading(cell).filteredRsrp > _cells[cell].minimumLevel; }

    const std::vector<Cell>& _cells;
    Air& _air;
    Random _random;

    std::size_t _serving = 0;
    Time _camped{0};
    Time _now{0};
    HeldFor _better;     // a candidate for reselection or handover
    HeldFor _elsewhere;  // a much better cell on another carrier
    bool _isConnected = false;
    bool _isOnCall = false;
    Time _heldUntil;  // the connection, at the least
    Time _barredUntil{0};
    int _registeredArea = 0;
    std::optional<Time> _registersAt;
    std::size_t _cycle = 0;  // of the idle phone

    std::vector<Neighbor> _neighbors;
    Carrier _neighborsCarrier{};
    int _neighborsMinimumLevel = 0;
    std::vector<Pci> _detected;
    IdleState _idle;
    std::optional<Candidate> _candidate;
    bool _hasMeasured = false;
};

}  // namespace kelvo::simulation::lte
