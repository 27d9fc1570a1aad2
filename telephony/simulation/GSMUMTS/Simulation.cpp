#include "telephony/simulation/GSMUMTS/Simulation.h"

#include "telephony/simulation/GSMUMTS/Records.h"

namespace kelvo::simulation::gsm {
namespace {

using namespace std::chrono_literals;

constexpr Time kMeasurement = 160ms;
constexpr Time kSlowMeasurement = 960ms;  // 480 ms in a connection, as a SACCH multiframe lasts
constexpr Time kFirstBlocks = 300ms;      // counted before they are first reported
constexpr Time kBlocks = 2s;

/// One that begins where UMTS is.
Journey journeyFromCentre(Random& random) {
    for (;;) {
        Journey journey = Journey::through(kTownRadius, random);
        if (distance({}, journey.at(Time(0))) < kCentreRadius) return journey;
    }
}

}  // namespace

Simulation::Simulation(std::uint64_t seed, Generation generation)
    : FamilySimulation(seed, 1400ms, journeyFromCentre), _wording(wordingOf(generation)) {}

void Simulation::step() {
    const bool isMeasurement = every(kMeasurement);
    _user.moveTo(now());
    if (isMeasurement) _air.measure(now());
    _modem.step(now(), _user, isMeasurement);
    reportSim();
    reportMobility();
    if (!_modem.isDedicated(Rat::UMTS)) _blocks.reset();
    if (!_modem.isCamped()) return;
    reportCells();
    reportRanking();
    if (_modem.rat() == Rat::GSM) {
        reportGsm();
    } else {
        reportUmts();
    }
}

void Simulation::reportSim() {
    const auto& registered = _modem.registration().registered();
    if (_sim.isDue(now(), registered, 60s)) {
        const SimFiles files = registered ? testNetworkSim(registered->lac, registered->rac) : testNetworkSim();
        emit(simFilesRecord(now(), files));
    }
    if (_contexts.isDue(now(), {_modem.activity(), registered.has_value()}, 60s)) {
        emit(pdpContextsRecord(now(), pdpContexts(world(), _user.sessions())));
    }
}

/// When a move begins, too, so that where it goes has been told.
void Simulation::reportCells() {
    if (_cells.isDue(now(), {cell(), _modem.isMoving()}, 15s))
        emit(cellInformationRecord(now(), monitoredCells(world())));
}

void Simulation::reportMobility() {
    if (_rrStatus.isDue(now(), rrStatus(world()), 480ms)) emit(rrStatusRecord(now(), rrStatus(world())));
    const Mobility& mobility = _modem.registration().mobility();
    if (_mobility.isDue(now(), mobility, 1s)) {
        emit(circuitStateRecord(now(), mobility));
        emit(packetStateRecord(now(), mobility));
        emit(registrationRecord(now(), mobility));
    }
    if (!_modem.isCamped()) return;
    const ServingNetwork network = servingNetwork(world());
    if (_servingNetwork.isDue(now(), network, 4s)) emit(servingNetworkRecord(now(), network));
    const auto plmns = equivalentPlmns(world());
    if (_equivalents.isDue(now(), plmns, 20s)) emit(_wording.equivalentPlmns(now(), plmns));
}

/// Out of a connection, in turns of three: what is ranked of GSM, what of UMTS.
void Simulation::reportRanking() {
    if (_modem.link() == Link::Open || !every(960ms, 240ms)) return;
    const auto umts = rankedUmtsCells(world());
    const auto gsm = rankedGsmCells(world());
    const bool isGsmsTurn = umts.empty() || (!gsm.empty() && _rankings / 3 % 2 == 0);
    ++_rankings;
    emit(isGsmsTurn ? _wording.gsmRanking(now(), gsm) : _wording.umtsRanking(now(), umts));
}

void Simulation::reportGsm() {
    const GsmCell& serving = _network.gsmCells[_modem.serving()];
    if (_servingGsm.isDue(now(), cell(), 4s)) emit(servingCellRecord(now(), serving));
    if (_gprs.isDue(now(), cell(), 20s)) reportGprs(serving.gprs);
    const bool isDedicated = _modem.isDedicated(Rat::GSM);
    if (every(isDedicated ? kSlowMeasurement / 2 : kSlowMeasurement, 320ms)) {
        const GsmMeasurement measurement = gsmMeasurement(world());
        if (_decoded.isDue(now(), cell(), 4s)) emit(decodedCellsRecord(now(), measurement.neighbors));
        emit(_wording.gsmMeasurement(now(), measurement));
    }
    if (_allocation.isDue(now(), {cell(), isDedicated}, 20s) && isDedicated)
        emit(mobileAllocationRecord(now(), serving));
    if (isDedicated && every(960ms, 480ms)) reportGsmChannel(serving);
}

void Simulation::reportGprs(const GprsOptions& options) {
    emit(si13PositionRecord(now(), options));
    emit(si13Record(now(), options));
    emit(cellOptionsRecord(now(), options));
    emit(pbcchRecord(now(), options));
    emit(packetStatusRecord(now(), options));
}

void Simulation::reportGsmChannel(const GsmCell& cell) {
    const int hop = _random.between(0, static_cast<int>(cell.mobileAllocation.size()) - 1);
    _lastReports.dedicatedArfcn = cell.mobileAllocation[static_cast<std::size_t>(hop)];
    _lastReports.isDtxUsed = _user.isListening();
    emit(dedicatedCarrierRecord(now(), _lastReports.dedicatedArfcn));
    emit(channelModeRecord(now(), _lastReports.isDtxUsed));
}

void Simulation::reportUmts() {
    if (_servingUmts.isDue(now(), cell(), 8s)) emit(_wording.rrcCell(now(), _network.umtsCells[_modem.serving()]));
    if (_rrcState.isDue(now(), _modem.rrcState(), 480ms)) emit(rrcStateRecord(now(), _modem.rrcState()));
    const bool isCiphered = _modem.link() != Link::None && _modem.link() != Link::Opening;
    if (_ciphering.isDue(now(), isCiphered, 8s)) emit(cipheringRecord(now(), isCiphered));
    const bool isOpen = _modem.link() == Link::Open;
    const auto active = isOpen ? _modem.activeSet().members() : std::vector{_modem.serving()};
    if (_activeCells.isDue(now(), active, isOpen ? 960ms : 1920ms)) {
        emit(searcherRecord(now(), _air.umtsRssi(), searchedCells(world())));
    }
    reportUmtsChannel();
}

void Simulation::reportUmtsChannel() {
    if (!_modem.isDedicated(Rat::UMTS)) return;
    if (every(480ms, 160ms)) {
        _lastReports.transmitPower = transmitPower(world(), _random);
        emit(transmitPowerRecord(now(), _lastReports.transmitPower));
    }
    if (!_blocks) _blocks = Window{now(), now() + kFirstBlocks};
    if (now() >= _blocks->end) reportBlocks(now() - _blocks->begin);
}

void Simulation::reportBlocks(Time window) {
    _blocks = Window{now(), now() + kBlocks};
    _lastReports.blockErrors = blockErrors(world(), window, _random);
    emit(blockErrorsRecord(now(), _lastReports.blockErrors));
    if (_modem.activity() != Activity::Browsing) return;
    _lastReports.hsdpa = hsdpaReport(world(), window, _random);
    emit(hsdpaRecord(now(), _lastReports.hsdpa));
}

}  // namespace kelvo::simulation::gsm
