#pragma once

#include <optional>

#include "telephony/simulation/FamilySimulation.h"
#include "telephony/simulation/GSMUMTS/NewerRecords.h"

namespace kelvo::simulation::gsm {

/// A GSM and UMTS modem on its drive. It is switched on in the centre of the town, registers through GSM, finds UMTS
/// within two seconds and drives on, in the centre mostly in UMTS, outside in GSM. It is of the generation that the
/// screens read, or of a newer one.
class Simulation final : public FamilySimulation<Network, Air, Modem> {
public:
    explicit Simulation(std::uint64_t seed, Generation generation = Generation::Of2010);

    Technology technology() const override { return Technology::GSM; }

    /// What the last record of its kind told.
    struct LastReports {
        Arfcn dedicatedArfcn;
        bool isDtxUsed = false;
        std::vector<std::optional<double>> transmitPower = {};  ///< dBm of each slot
        BlockErrors blockErrors = {};
        HsdpaReport hsdpa = {};
    };
    const LastReports& lastReports() const { return _lastReports; }

private:
    struct Window {
        Time begin;
        Time end;
    };
    using Cell = std::pair<Rat, std::size_t>;

    void step() override;
    void reportSim();
    void reportCells();
    void reportMobility();
    void reportRanking();
    void reportGsm();
    void reportGprs(const GprsOptions& options);
    void reportGsmChannel(const GsmCell& cell);
    void reportUmts();
    void reportUmtsChannel();
    void reportBlocks(Time window);

    void emit(Bytes message) {
        FamilySimulation::emit(_wording.hasTwoSims ? ofFirstSim(std::move(message)) : std::move(message));
    }
    World world() const { return {_network, _air, _modem}; }
    Cell cell() const { return {_modem.rat(), _modem.serving()}; }

    const Wording& _wording;
    LastReports _lastReports;
    std::optional<Window> _blocks;  // those not yet reported

    Reported<std::optional<Area>> _sim;
    Reported<std::pair<Activity, bool>> _contexts;
    Reported<std::pair<Cell, bool>> _cells;
    Reported<Mobility> _mobility;
    Reported<ServingNetwork> _servingNetwork;
    Reported<std::vector<Plmn>> _equivalents;
    Reported<RrStatus> _rrStatus;
    Reported<Cell> _servingGsm;
    Reported<Cell> _gprs;
    Reported<Cell> _decoded;
    Reported<std::pair<Cell, bool>> _allocation;
    Reported<Cell> _servingUmts;
    Reported<std::vector<std::size_t>> _activeCells;
    Reported<RrcState> _rrcState;
    Reported<bool> _ciphering;
    int _rankings = 0;
};

}  // namespace kelvo::simulation::gsm
