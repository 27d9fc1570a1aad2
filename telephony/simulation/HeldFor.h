#pragma once

#include <cstddef>
#include <map>
#include <optional>
#include <vector>

#include "telephony/simulation/Time.h"

namespace kelvo::simulation {

/// Lets a condition through only when it has held for a while (the "time to trigger" of 3GPP TS 36.331, Treselection
/// of TS 36.304 and their like).
class HeldFor {
public:
    explicit HeldFor(Time hold) : _hold(hold) {}

    /// True when `condition`, which is about `subject`, has held for the time without a break or a change of subject.
    bool operator()(bool condition, std::size_t subject, Time now);
    void restart() { _running = false; }

private:
    Time _hold;
    Time _since{0};
    std::size_t _subject = 0;
    bool _running = false;
};

/// HeldFor for many subjects at a time, such as all cells that are better than the serving one: two that are better by
/// turns do not hold each other up.
class EachHeldFor {
public:
    explicit EachHeldFor(Time hold) : _hold(hold) {}

    /// `subjects` are those that the condition holds for now. The first of them for which it has held for the time
    /// without a break.
    std::optional<std::size_t> operator()(const std::vector<std::size_t>& subjects, Time now);
    void restart() { _since.clear(); }

private:
    Time _hold;
    std::map<std::size_t, Time> _since;
};

}  // namespace kelvo::simulation
