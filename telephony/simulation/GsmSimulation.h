#pragma once

#include <optional>

#include "telephony/simulation/GSMUMTS/Reports.h"
#include "telephony/simulation/Reported.h"
#include "telephony/simulation/Simulation.h"

namespace kelvo::simulation {

/// A phone for GSM and UMTS. It is switched on in the centre of a town, registers through GSM, finds UMTS within two
/// seconds and drives on: in the centre mostly in UMTS, outside in GSM, calling and loading on the way.
class GsmSimulation final : public Simulation {
public:
    explicit GsmSimulation(std::uint64_t seed);

    Technology technology() const override { return Technology::GSM; }

    // The world that is played.
    const gsm::Network& network() const { return _network; }
    const gsm::Air& air() const { return _air; }
    const gsm::Phone& phone() const { return _phone; }

    /// What was drawn for the last record of its kind.
    struct Drawn {
        int dedicatedArfcn = 0;
        bool isDtxUsed = false;
        std::vector<std::optional<double>> transmitPower = {};  ///< dBm of each slot
        gsm::BlockErrors blockErrors = {};
        gsm::HsdpaReport hsdpa = {};
    };
    const Drawn& drawn() const { return _drawn; }
    int dataSessions() const { return _dataSessions; }

private:
    static Journey drawJourney(Random& random);

    struct Window {
        Time begin;
        Time end;
    };
    using Cell = std::pair<gsm::Rat, std::size_t>;

    void step() override;
    void countSessions();
    void reportSim();
    void reportCells();
    void reportMobility();
    void reportRanking();
    void reportGsm();
    void reportGprs(const gsm::GprsOptions& options);
    void reportGsmChannel(const gsm::GsmCell& cell);
    void reportUmts();
    void reportUmtsChannel();
    void reportBlocks(Time window);

    gsm::World world() const { return {_network, _air, _phone}; }
    Cell cell() const { return {_phone.rat(), _phone.serving()}; }

    Random _random;
    gsm::Network _network;
    gsm::Air _air;
    gsm::Phone _phone;
    Drawn _drawn;
    int _dataSessions = 0;
    bool _wasData = false;
    std::optional<Window> _blocks;  // those not yet reported

    Reported<std::optional<gsm::Area>> _sim;
    Reported<std::pair<gsm::Use, bool>> _contexts;
    Reported<std::pair<Cell, bool>> _cells;
    Reported<gsm::Mobility> _mobility;
    Reported<gsm::ServingNetwork> _servingNetwork;
    Reported<std::vector<gsm::Plmn>> _equivalents;
    Reported<gsm::RrStatus> _rrStatus;
    Reported<Cell> _servingGsm;
    Reported<Cell> _gprs;
    Reported<Cell> _decoded;
    Reported<std::pair<Cell, bool>> _allocation;
    Reported<Cell> _servingUmts;
    Reported<std::vector<std::size_t>> _activeCells;
    Reported<gsm::RrcState> _rrcState;
    Reported<bool> _ciphering;
    int _rankings = 0;
};

}  // namespace kelvo::simulation
