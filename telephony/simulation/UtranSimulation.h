#pragma once

#include <cstdint>
#include <vector>

#include "telephony/simulation/ExtendedRecords.h"
#include "telephony/simulation/Simulation.h"
#include "telephony/simulation/UTRAN/UtranModem.h"

namespace kelvo::simulation {

/// A TD-SCDMA modem on its drive. Its world is modem(), read between two calls of next().
class UtranSimulation final : public Simulation {
public:
    explicit UtranSimulation(std::uint64_t seed) : _modem(seed) {}

    Technology technology() const override { return Technology::UTRAN; }
    const UtranModem& modem() const { return _modem; }

private:
    void step() override;
    void reportServingCell();
    void reportMeasurements();
    void reportExtended();
    std::vector<MonitoredCell> monitoredCells() const;
    std::vector<PdpContext> contexts() const;

    UtranModem _modem;
    bool _hasShownChannels = false;
};

}  // namespace kelvo::simulation
