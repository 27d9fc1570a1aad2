#pragma once

#include "telephony/simulation/ExtendedRecords.h"
#include "telephony/simulation/FamilySimulation.h"

namespace kelvo::simulation {

/// A family whose phone is registered from the start: its modem reports the radio in records of its own, and the
/// telephony service adds cells, contexts and SIM in the same way for every such family.
template <class Network, class Air, class Modem>
class RegisteredSimulation : public FamilySimulation<Network, Air, Modem> {
    using Family = FamilySimulation<Network, Air, Modem>;

protected:
    using Family::Family, Family::now, Family::emit, Family::_user, Family::_air, Family::_modem;

    virtual void reportServingCell() = 0;
    virtual void reportMeasurements() = 0;

private:
    static constexpr int kRoutingArea = 1;

    void step() final {
        _user.moveTo(now());
        _air.moveTo(now());
        _modem.step(now(), _user);
        reportServingCell();
        reportMeasurements();
        reportExtended();
    }

    void reportExtended() {
        using namespace std::chrono_literals;
        if (_cells.isDue(now(), _modem.servingIndex(), 20s)) emit(cellInformationRecord(now(), monitoredCells(_modem)));
        const auto contexts = pdpContexts(_modem);
        if (_contexts.isDue(now(), contexts, 30s)) emit(pdpContextsRecord(now(), contexts));
        const int area = _modem.registeredArea();
        if (_sim.isDue(now(), area, 60s)) emit(simFilesRecord(now(), testNetworkSim(area, kRoutingArea)));
    }

    Reported<std::size_t> _cells;
    Reported<std::vector<PdpContext>> _contexts;
    Reported<int> _sim;
};

}  // namespace kelvo::simulation
