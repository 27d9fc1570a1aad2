#pragma once

#include <vector>

#include "telephony/simulation/CDMA/Air.h"
#include "telephony/simulation/CDMA/Network.h"
#include "telephony/simulation/CDMA/Reports.h"
#include "telephony/simulation/HeldFor.h"

namespace kelvo::simulation::cdma {

/// When a pilot joins and leaves the active set of a connected phone.
struct PilotRules {
    double add;      ///< Ec/Io in dB: T_ADD, PilotAdd
    double drop;     ///< Ec/Io in dB: T_DROP, PilotDrop
    Time dropTime;   ///< below `drop` for this long: T_TDROP, PilotDropTimer
    double compare;  ///< dB above the weakest of a full set: T_COMP, PilotCompare
};
inline constexpr PilotRules kOneXRules{-14, -16, std::chrono::seconds(4), 2.5};
inline constexpr PilotRules kEvdoRules{-7, -9, std::chrono::seconds(4), 2.5};

/// The active set of pilots, by the rules of 3GPP2 C.S0005 (2.6.6) for 1x, which those of the route update protocol of
/// C.S0024 resemble: idle, one pilot, left for one that is clearly stronger; connected, up to six, added and dropped
/// by their strength.
class PilotSet {
public:
    static constexpr std::size_t kMost = 6;
    static constexpr double kIdleMargin = 3;  ///< dB that the other must be stronger, for kIdleHold
    static constexpr Time kIdleHold = std::chrono::seconds(2);
    static constexpr double kReferenceMargin = 3;  ///< dB within the set

    explicit PilotSet(const PilotRules& rules) : _rules(rules) {}

    bool empty() const { return _members.empty(); }
    /// The sector that the phone follows: listens to when idle, takes its time from or is served by when connected.
    std::size_t reference() const { return _reference; }

    void clear() { _members.clear(); }
    /// Leaves all but this one.
    void follow(std::size_t sector);
    /// Idle: moves to another pilot when it should, at once when its own is too weak. True when it did.
    bool reselect(Time now, const Reception& air);
    /// Connected: drops, adds and replaces.
    void update(Time now, const Reception& air);

    /// The members as read last, in the order in which they joined.
    std::vector<PilotReading> readings(const Reception& air, const Network& network) const;
    std::vector<std::size_t> sectors() const;

private:
    struct Member {
        std::size_t sector;
        HeldFor weak;
    };
    Member member(std::size_t sector) const { return {sector, HeldFor(_rules.dropTime)}; }
    bool contains(std::size_t sector) const;
    void dropWeak(Time now, const Reception& air);
    void offer(std::size_t sector, const Reception& air);

    PilotRules _rules;
    std::vector<Member> _members;
    std::size_t _reference = 0;
    HeldFor _better{kIdleHold};
};

}  // namespace kelvo::simulation::cdma
