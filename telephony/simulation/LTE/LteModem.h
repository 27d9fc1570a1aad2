#pragma once

#include <functional>

#include "telephony/simulation/HeldFor.h"
#include "telephony/simulation/LTE/LteReceiver.h"

namespace kelvo::simulation {

/// A cell beside the serving one, as it was last measured.
struct LteNeighbor {
    int physicalId = 0;
    LteReading reading;
    double srxlev = 0;       ///< dB: its level above what it asks for
    int frequencyError = 0;  ///< Hz
    int frames = 0;          ///< its frame count is ahead by so many
    int samples = 0;         ///< its frames arrive so many samples (1/30.72 us) later
};

/// What an idle phone makes of its serving cell (3GPP TS 36.304, section 5.2).
struct LteIdleState {
    enum Rule { SearchIntra = 1, SearchInter = 2, SearchOther = 4 };
    double srxlev = 0;     ///< dB
    int failedCycles = 0;  ///< DRX cycles in a row with a srxlev of 0 or less
    int rules = 0;         ///< what the phone looks for: Rule bits
    bool rulesChanged = false;
};

/// The modem: camps, measures, reselects and hands over, registers, and is idle or connected by turns.
class LteModem {
public:
    explicit LteModem(std::uint64_t seed);
    LteModem(const LteModem&) = delete;
    LteModem& operator=(const LteModem&) = delete;

    /// Moves on to then, one step after the last time.
    void moveTo(Time now);

    // What the last step has brought.
    bool hasMeasured() const { return _hasMeasured; }
    bool hasChangedCell() const { return _hasChangedCell; }
    bool hasRegistered() const { return _hasRegistered; }
    bool hasChangedContexts() const { return _hasChangedContexts; }

    const Drive& drive() const { return _drive; }
    const std::vector<LteCell>& cells() const { return _cells; }
    std::size_t servingIndex() const { return _serving; }
    const LteCell& serving() const { return _cells[_serving]; }
    const LteReading& reading() const { return _receiver.reading(_serving); }
    bool isConnected() const { return _isConnected; }
    /// The tracking area that the network believes the phone to be in.
    int registeredArea() const { return _registeredArea; }
    bool isOnCall() const { return _isOnCall; }
    /// The serving cell's subframe, counted over all its 1024 frames.
    int subframe() const;

    /// Measured on the carrier that was looked at last; of an idle phone each carrier in its turn.
    const std::vector<LteNeighbor>& neighbors() const { return _neighbors; }
    const LteCarrier& neighborsCarrier() const { return _neighborsCarrier; }
    int neighborsMinimumLevel() const { return _neighborsMinimumLevel; }
    /// Physical identities of those found on the serving carrier, and not measured yet.
    const std::vector<int>& detected() const { return _detected; }
    /// Of an idle phone.
    const LteIdleState& idle() const { return _idle; }
    /// The candidate for reselection that was weighed last, each in its turn.
    const std::optional<LteCandidate>& candidate() const { return _candidate; }

private:
    void followActivity();
    void connect(Time until);
    void release(Time next);
    void registerInArea();
    void camp(std::size_t cell);
    void measureConnected();
    void measureInGaps();
    void handOver();
    void redirect();
    void measureIdle();
    void evaluateServing();
    void lookAround();
    void listNeighbors(const LteCarrier& carrier);
    LteNeighbor neighbor(std::size_t cell) const;
    void weighCandidates();
    void reselect();
    std::optional<std::size_t> bestMeasured(const std::function<bool(const LteCell&)>& isWanted) const;
    bool isOnServingCarrier(const LteCarrier& carrier) const { return carrier.downlink == serving().carrier.downlink; }
    double meanLevel(std::size_t cell) const;
    bool isFit(std::size_t cell) const { return _receiver.reading(cell).averageRsrp > _cells[cell].minimumLevel; }

    Random _random;
    std::vector<Sector> _sectors;
    std::vector<LteCell> _cells;
    Drive _drive;
    LteReceiver _receiver;

    std::size_t _serving = 0;
    Time _camped{0};
    Time _now{0};
    HeldFor _better;     // a candidate for reselection or handover
    HeldFor _elsewhere;  // a much better cell on another carrier
    bool _isConnected = false;
    bool _isOnCall = false;
    Time _connectedUntil{0};
    Time _nextSession{0};
    int _registeredArea = 0;
    std::optional<Time> _registersAt;
    std::size_t _cycle = 0;  // of the idle phone

    std::vector<LteNeighbor> _neighbors;
    LteCarrier _neighborsCarrier{};
    int _neighborsMinimumLevel = 0;
    std::vector<int> _detected;
    LteIdleState _idle;
    std::optional<LteCandidate> _candidate;
    bool _hasMeasured = false;
    bool _hasChangedCell = false;
    bool _hasRegistered = false;
    bool _hasChangedContexts = false;
};

}  // namespace kelvo::simulation
