#include "telephony/simulation/GsmSimulation.h"

namespace kelvo::simulation {

using namespace gsm;
using namespace std::chrono_literals;

namespace {

constexpr Time kMeasurement = 160ms;
constexpr Time kSlowMeasurement = 960ms;  // 480 ms in a connection, as a SACCH multiframe lasts
constexpr Time kFirstBlocks = 300ms;      // counted before they are first reported
constexpr Time kBlocks = 2s;

}  // namespace

GsmSimulation::GsmSimulation(std::uint64_t seed)
    : _random(seed),
      _network(_random),
      _air{_network, drawJourney(_random), _random.split()},  // braces: the draws have an order
      _phone(_network, _air, _random.split()) {}

/// One that begins where UMTS is.
Journey GsmSimulation::drawJourney(Random& random) {
    for (;;) {
        Journey journey = Journey::through(kTownRadius, random);
        if (distance({}, journey.at(Time(0))) < kCentreRadius) return journey;
    }
}

void GsmSimulation::step() {
    const bool isMeasurement = now() % kMeasurement == Time(0);
    if (isMeasurement) _air.measure(now());
    _phone.step(now(), isMeasurement);
    countSessions();
    reportSim();
    reportMobility();
    if (!_phone.isDedicated(Rat::UMTS)) _blocks.reset();
    if (!_phone.isCamped()) return;
    reportCells();
    reportRanking();
    if (_phone.rat() == Rat::GSM) {
        reportGsm();
    } else {
        reportUmts();
    }
}

void GsmSimulation::countSessions() {
    const bool isData = _phone.use() == Use::Data;
    if (isData && !_wasData) ++_dataSessions;
    _wasData = isData;
}

void GsmSimulation::reportSim() {
    const auto& registered = _phone.registration().registered();
    if (_sim.isDue(registered, now(), 60s)) {
        const SimFiles files = registered ? testNetworkSim(registered->lac, registered->rac) : testNetworkSim();
        emit(simFilesRecord(files, now()));
    }
    if (_contexts.isDue({_phone.use(), registered.has_value()}, now(), 60s)) {
        emit(pdpContextsRecord(pdpContexts(world(), _dataSessions), now()));
    }
}

/// When a move begins, too, so that where it goes has been told.
void GsmSimulation::reportCells() {
    if (_cells.isDue({cell(), _phone.isMoving()}, now(), 15s))
        emit(cellInformationRecord(monitoredCells(world()), now()));
}

void GsmSimulation::reportMobility() {
    if (_rrStatus.isDue(rrStatus(world()), now(), 480ms)) emit(rrStatusRecord(rrStatus(world()), now()));
    const Mobility& mobility = _phone.registration().mobility();
    if (_mobility.isDue(mobility, now(), 1s)) {
        emit(circuitStateRecord(mobility, now()));
        emit(packetStateRecord(mobility, now()));
        emit(registrationRecord(mobility, now()));
    }
    if (!_phone.isCamped()) return;
    const ServingNetwork network = servingNetwork(world());
    if (_servingNetwork.isDue(network, now(), 4s)) emit(servingNetworkRecord(network, now()));
    const auto plmns = equivalentPlmns(world());
    if (_equivalents.isDue(plmns, now(), 20s)) emit(equivalentPlmnsRecord(plmns, now()));
}

/// Out of a connection, in turns of three: what is ranked of GSM, what of UMTS.
void GsmSimulation::reportRanking() {
    if (_phone.link() == Link::Open || !isDue(960ms, 240ms)) return;
    const auto umts = rankedUmtsCells(world());
    const auto gsm = rankedGsmCells(world());
    const bool isGsmsTurn = umts.empty() || (!gsm.empty() && _rankings / 3 % 2 == 0);
    ++_rankings;
    emit(isGsmsTurn ? gsmRankingRecord(gsm, now()) : umtsRankingRecord(umts, now()));
}

void GsmSimulation::reportGsm() {
    const GsmCell& serving = _network.gsm[_phone.serving()];
    if (_servingGsm.isDue(cell(), now(), 4s)) emit(servingCellRecord(serving, now()));
    if (_gprs.isDue(cell(), now(), 20s)) reportGprs(serving.gprs);
    const bool isDedicated = _phone.isDedicated(Rat::GSM);
    if (isDue(isDedicated ? kSlowMeasurement / 2 : kSlowMeasurement, 320ms)) {
        const GsmMeasurement measurement = gsmMeasurement(world());
        if (_decoded.isDue(cell(), now(), 4s)) emit(decodedCellsRecord(measurement.neighbors, now()));
        emit(measurementRecord(measurement, now()));
    }
    if (_allocation.isDue({cell(), isDedicated}, now(), 20s) && isDedicated)
        emit(mobileAllocationRecord(serving, now()));
    if (isDedicated && isDue(960ms, 480ms)) reportGsmChannel(serving);
}

void GsmSimulation::reportGprs(const GprsOptions& options) {
    emit(si13PositionRecord(options, now()));
    emit(si13Record(options, now()));
    emit(cellOptionsRecord(options, now()));
    emit(pbcchRecord(options, now()));
    emit(packetStatusRecord(options, now()));
}

void GsmSimulation::reportGsmChannel(const GsmCell& cell) {
    const int hop = _random.between(0, static_cast<int>(cell.mobileAllocation.size()) - 1);
    _drawn.dedicatedArfcn = cell.mobileAllocation[static_cast<std::size_t>(hop)];
    _drawn.isDtxUsed = _phone.isSilent();
    emit(dedicatedCarrierRecord(_drawn.dedicatedArfcn, now()));
    emit(channelModeRecord(_drawn.isDtxUsed, now()));
}

void GsmSimulation::reportUmts() {
    if (_servingUmts.isDue(cell(), now(), 8s)) emit(rrcCellRecord(_network.umts[_phone.serving()], now()));
    if (_rrcState.isDue(_phone.rrcState(), now(), 480ms)) emit(rrcStateRecord(_phone.rrcState(), now()));
    const bool isCiphered = _phone.link() != Link::None && _phone.link() != Link::Opening;
    if (_ciphering.isDue(isCiphered, now(), 8s)) emit(cipheringRecord(isCiphered, now()));
    const bool isOpen = _phone.link() == Link::Open;
    const auto active = isOpen ? _phone.activeSet().members() : std::vector{_phone.serving()};
    if (_activeCells.isDue(active, now(), isOpen ? 960ms : 1920ms)) {
        emit(searcherRecord(_air.umtsRssi(), searchedCells(world()), now()));
    }
    reportUmtsChannel();
}

void GsmSimulation::reportUmtsChannel() {
    if (!_phone.isDedicated(Rat::UMTS)) return;
    if (isDue(480ms, 160ms)) {
        _drawn.transmitPower = drawTransmitPower(world(), _random);
        emit(transmitPowerRecord(_drawn.transmitPower, now()));
    }
    if (!_blocks) _blocks = Window{now(), now() + kFirstBlocks};
    if (now() >= _blocks->end) reportBlocks(now() - _blocks->begin);
}

void GsmSimulation::reportBlocks(Time window) {
    _blocks = Window{now(), now() + kBlocks};
    _drawn.blockErrors = drawBlockErrors(world(), window, _random);
    emit(blockErrorsRecord(_drawn.blockErrors, now()));
    if (_phone.use() != Use::Data) return;
    _drawn.hsdpa = drawHsdpaReport(world(), window, _random);
    emit(hsdpaRecord(_drawn.hsdpa, now()));
}

}  // namespace kelvo::simulation
