#pragma once

#include <cstdint>
#include <vector>

#include "telephony/simulation/ExtendedRecords.h"
#include "telephony/simulation/LTE/LteModem.h"
#include "telephony/simulation/Simulation.h"

namespace kelvo::simulation {

/// An LTE modem on its drive. Its world is modem(), read between two calls of next().
class LteSimulation final : public Simulation {
public:
    explicit LteSimulation(std::uint64_t seed) : _modem(seed) {}

    Technology technology() const override { return Technology::LTE; }
    const LteModem& modem() const { return _modem; }

private:
    void step() override;
    void reportMeasurements();
    void reportServingCell();
    void reportExtended();
    std::vector<MonitoredCell> monitoredCells() const;
    std::vector<PdpContext> contexts() const;

    LteModem _modem;
};

}  // namespace kelvo::simulation
