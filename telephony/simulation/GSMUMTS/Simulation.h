#pragma once

#include <optional>

#include "telephony/simulation/GSMUMTS/Reports.h"
#include "telephony/simulation/Reported.h"
#include "telephony/simulation/Simulation.h"

namespace kelvo::simulation::gsm {

/// A phone for GSM and UMTS. It is switched on in the centre of a town, registers through GSM, finds UMTS within two
/// seconds and drives on: in the centre mostly in UMTS, outside in GSM, calling and loading on the way.
class Simulation final : public simulation::Simulation {
public:
    explicit Simulation(std::uint64_t seed);

    Technology technology() const override { return Technology::GSM; }

    // The world that is played.
    const Network& network() const { return _network; }
    const Air& air() const { return _air; }
    const Modem& modem() const { return _modem; }

    /// What the last record of its kind told.
    struct LastReports {
        Arfcn dedicatedArfcn;
        bool isDtxUsed = false;
        std::vector<std::optional<double>> transmitPower = {};  ///< dBm of each slot
        BlockErrors blockErrors = {};
        HsdpaReport hsdpa = {};
    };
    const LastReports& lastReports() const { return _lastReports; }
    int dataSessions() const { return _dataSessions; }

private:
    struct Window {
        Time begin;
        Time end;
    };
    using Cell = std::pair<Rat, std::size_t>;

    void step() override;
    void countSessions();
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

    World world() const { return {_network, _air, _modem}; }
    Cell cell() const { return {_modem.rat(), _modem.serving()}; }

    Random _random;
    Network _network;
    Air _air;
    Modem _modem;
    LastReports _lastReports;
    int _dataSessions = 0;
    bool _wasData = false;
    std::optional<Window> _blocks;  // those not yet reported

    Reported<std::optional<Area>> _sim;
    Reported<std::pair<Use, bool>> _contexts;
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
