#pragma once

#include <vector>

#include "telephony/simulation/GSMUMTS/Air.h"
#include "telephony/simulation/HeldFor.h"

namespace kelvo::simulation::gsm {

/// The UMTS cells that a connection runs through at once: soft handover by the events 1A (add), 1B (drop) and 1C
/// (replace) of 3GPP TS 25.331, section 14.1.2, on Ec/No, each with its time to trigger.
class ActiveSet {
public:
    static constexpr std::size_t kLargest = 3;
    static constexpr double kAddWindow = 4;   ///< dB below the best
    static constexpr double kDropWindow = 6;  ///< dB below the best
    static constexpr double kReplaceBy = 2;   ///< dB above the worst

    void start(std::size_t sector);
    void update(const Air& air, Time now);

    /// At least one once started; in the order in which they joined.
    const std::vector<std::size_t>& members() const { return _members; }
    bool contains(std::size_t sector) const;
    std::size_t best(const Air& air) const;

private:
    std::size_t worst(const Air& air) const;
    std::size_t bestOther(const Air& air) const;

    std::vector<std::size_t> _members{0};
    HeldFor _add{std::chrono::milliseconds(320)};
    HeldFor _drop{std::chrono::milliseconds(640)};
    HeldFor _replace{std::chrono::milliseconds(320)};
};

}  // namespace kelvo::simulation::gsm
