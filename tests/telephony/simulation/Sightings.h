#pragma once

#include <gtest/gtest.h>

#include <map>
#include <vector>

#include "telephony/simulation/Time.h"

namespace kelvo::test {

/// What the screens have listed of the cells around since the phone came to its serving cell.
class Sightings {
public:
    /// `cell` was listed, `above` dB above the serving cell.
    void see(int cell, simulation::Time time, double above) { _sightings[cell].push_back({time, above}); }

    /// The phone has gone to `cell`, which must have been listed within the last second, clearly above the cell before:
    /// by the hysteresis less what the last reading took.
    void goTo(int cell, simulation::Time time) {
        const auto& history = _sightings[cell];
        ASSERT_FALSE(history.empty()) << cell;
        EXPECT_LE(time - history.back().time, std::chrono::seconds(1));
        EXPECT_GT(history.back().above, 1);
        _risen += history.back().above > history.front().above ? 1 : 0;
        ++_changes;
        _sightings.clear();
    }

    int changes() const { return _changes; }
    /// Of these, to a cell that had risen against the serving one since it was first listed.
    int risen() const { return _risen; }

private:
    struct Sighting {
        simulation::Time time;
        double above;
    };
    std::map<int, std::vector<Sighting>> _sightings;
    int _changes = 0;
    int _risen = 0;
};

}  // namespace kelvo::test
