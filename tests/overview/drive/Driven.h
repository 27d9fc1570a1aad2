#pragma once

#include <gtest/gtest.h>

#include <cmath>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "LogGenerator/Factory.h"
#include "LogGenerator/RecordLedger.h"
#include "overview/Tracker.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "telephony/simulation/Simulation.h"

namespace kelvo::overview::test {

using Kind = Event::Kind;

/// The drive's time as the events have it.
inline Time timeOf(simulation::Time time) { return Time(std::chrono::duration_cast<Time::duration>(time)); }

/// A simulated modem's log, followed record by record as a capture is.
class Driven {
public:
    explicit Driven(simulation::Simulation& modem)
        : _modem(modem), _generator(generatorFromTechnology(namesOf(modem.technology()).identifier)) {}

    /// Takes the next message up. Its log code, 0xff0000 and more for an extended record, 0 for a tree.
    std::uint32_t next();
    simulation::Time time() const { return _time; }
    const Tracker& tracker() const { return _tracker; }
    const Observation& seen() const { return _tracker.latest(); }
    /// The cell of that name around the serving one; null when it is not there.
    const TrackedCell* around(std::string_view identity) const;
    /// The cell heard now that is on this channel, whatever its code; null when there is none.
    const TrackedCell* onChannel(const std::string& channel) const;
    /// Each row is a cell that exists, none is there twice, and none is the serving cell.
    void expectDistinct(const std::set<std::string>& existing) const;
    /// The text of a fact; "(absent)" without.
    static std::string fact(const std::vector<Fact>& facts, std::string_view name);

private:
    DirectoryResources _resources{KELVO_RESOURCE_DIR};
    Environment::Scope _environment{{.resources = &_resources}};
    simulation::Simulation& _modem;
    std::unique_ptr<LogGenerator> _generator;
    Dictionary _state;
    RecordLedger _records;
    Tracker _tracker{{.events = 100'000, .span = std::chrono::hours(1000)}};
    simulation::Time _time{0};
};

/// What happened in the simulated world, as its rooms told between two messages, to be found among the events.
class Happened {
public:
    /// Another than before is something that happened; a first one is not.
    void change(Kind kind, simulation::Time time, const std::string& before, const std::string& now) {
        if (before != now && !before.empty() && !now.empty()) add(kind, time, before, now);
    }
    void add(Kind kind, simulation::Time time, std::string from, std::string to) {
        _all.push_back({time, kind, std::move(from), std::move(to)});
    }
    /// Each is among the events once, at its time; and no other event is there.
    void expectIn(const Tracker& tracker) const;
    int count(Kind kind) const;

private:
    struct One {
        simulation::Time time;
        Kind kind;
        std::string from;
        std::string to;
    };
    std::vector<One> _all;
};

/// The level or quality that is shown is the one that was sent, to the record's step.
void expectFigure(const std::optional<Measure>& shown, const char* name, double truth, double step);

}  // namespace kelvo::overview::test
