#pragma once

#include <optional>
#include <vector>

#include "telephony/simulation/GSMUMTS/ActiveSet.h"
#include "telephony/simulation/GSMUMTS/Registration.h"

namespace kelvo::simulation::gsm {

/// The connection to the network: RR in GSM, RRC in UMTS.
enum class Link { None, Opening, Open, Closing, Fach, UraPch };

/// States of the modem's GSM radio resource layer, numbered as it numbers them.
enum class RrState {
    Inactive = 0,
    CellSelection = 3,
    Idle = 5,
    CellReselection = 6,
    ConnectionPending = 7,
    DataTransfer = 9,
    ConnectionRelease = 11,
    W2gHandover = 13,
    W2gReselection = 14,
    G2wReselection = 18,
    G2wHandover = 19,
    W2gCellChangeOrder = 21,
};
/// States of its UMTS layer, numbered likewise; CELL_PCH, which is 4, is never entered.
enum class RrcState { Disconnected = 0, Connecting = 1, CellFach = 2, CellDch = 3, UraPch = 5 };

/// A cell as it stands in the ranking for reselection (3GPP TS 25.304, section 5.2.6.1.4), by RSCP or RXLEV.
struct Ranked {
    std::size_t sector = 0;
    double rank = 0;  ///< dB
};

/// The modem: which cell it is on, what it does there, and when it moves to another.
class Modem {
public:
    /// Both must outlive it.
    Modem(const Network& network, const Air& air, Random random)
        : _network(network), _air(air), _random(std::move(random)) {}

    /// Moves on to then; `hasMeasured` tells that the air has new readings.
    void step(Time now, const PhoneUser& user, bool hasMeasured);

    bool isCamped() const { return _isCamped; }
    Rat rat() const { return _rat; }
    /// The serving cell's index in the layer of rat(); in soft handover that of a member.
    std::size_t serving() const { return _serving; }
    const Area& area() const;  ///< broadcast by the serving cell
    Activity activity() const { return _activity; }
    Link link() const { return _link; }
    bool isOn(Rat rat) const { return _isCamped && _rat == rat; }
    bool isDedicated(Rat rat) const { return isOn(rat) && _link == Link::Open; }
    /// On its way to another cell, which is the best neighbor of its system.
    bool isMoving() const { return _change.has_value(); }
    RrState rrState() const;
    RrcState rrcState() const;

    const ActiveSet& activeSet() const { return _activeSet; }
    const Registration& registration() const { return _registration; }
    /// The GSM neighbor of the highest C2 lies in another location area or a packet transfer runs, so that reselection
    /// to it wants a hysteresis (3GPP TS 45.008, section 6.6.2).
    bool isHysteresisApplied() const;
    bool isMeasuringGsm() const { return isOn(Rat::GSM) || _isMeasuringGsm; }
    /// The GSM neighbors measured, the strongest first, at most six; none when GSM is not measured.
    std::vector<std::size_t> gsmNeighbors() const;
    /// The UMTS cells found beside those of the active set, the best first, at most `count`.
    std::vector<std::size_t> umtsNeighbors(std::size_t count) const;
    /// The highest first, the serving cell among them.
    const std::vector<Ranked>& rankedGsm() const { return _rankedGsm; }
    const std::vector<Ranked>& rankedUmts() const { return _rankedUmts; }

    double c1(std::size_t gsmSector) const;  ///< dB
    double c2(std::size_t gsmSector) const;  ///< dB

private:
    struct Change {
        Rat rat;
        std::size_t sector;
        RrState state;
        Time until;
    };
    void follow(Activity activity);
    void followLink(Time now);
    void setLink(Time now, Link link);
    void restartTriggers();
    void complete(Time now, const Change& change);
    std::size_t gsmByC2() const;  ///< the neighbor of the highest C2; on GSM only
    double umtsQuality() const;   ///< Ec/No of the best cell in use, dB
    void rank();
    void leaveGsm(Time now);
    void moveWithinGsm(Time now);
    void leaveUmts(Time now);
    void moveWithinUmts(Time now);

    const Network& _network;
    const Air& _air;
    Random _random;

    bool _isCamped = false;
    Rat _rat = Rat::GSM;
    std::size_t _serving = 0;
    std::optional<Change> _change;
    Activity _activity = Activity::Resting;
    Activity _lastActivity = Activity::Talking;
    Link _link = Link::None;
    Time _linkSince{0};
    ActiveSet _activeSet;
    Registration _registration;
    bool _hasSearchedUmts = false;
    bool _isMeasuringGsm = false;
    std::vector<Ranked> _rankedGsm;
    std::vector<Ranked> _rankedUmts;

    HeldFor _gsmReselection{std::chrono::seconds(5)};  // TS 45.008, 6.6.2
    HeldFor _gsmHandover{std::chrono::milliseconds(1500)};
    HeldFor _umtsReselection{std::chrono::seconds(1)};  // Treselection
    HeldFor _bestChange{std::chrono::milliseconds(640)};
    HeldFor _toUmts{std::chrono::seconds(3)};
    HeldFor _toGsm{std::chrono::seconds(2)};
    HeldFor _toGsmHandover{std::chrono::milliseconds(640)};
};

}  // namespace kelvo::simulation::gsm
