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
    const bool isMeasurement = every(kMeasurement);
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
    if (_sim.isDue(now(), registered, 60s)) {
        const SimFiles files = registered ? testNetworkSim(registered->lac, registered->rac) : testNetworkSim();
        emit(simFilesRecord(now(), files));
    }
    if (_contexts.isDue(now(), {_phone.use(), registered.has_value()}, 60s)) {
        emit(pdpContextsRecord(now(), pdpContexts(world(), _dataSessions)));
    }
}

/// When a move begins, too, so that where it goes has been told.
void GsmSimulation::reportCells() {
    if (_cells.isDue(now(), {cell(), _phone.isMoving()}, 15s))
        emit(cellInformationRecord(now(), monitoredCells(world())));
}

void GsmSimulation::reportMobility() {
    if (_rrStatus.isDue(now(), rrStatus(world()), 480ms)) emit(rrStatusRecord(now(), rrStatus(world())));
    const Mobility& mobility = _phone.registration().mobility();
    if (_mobility.isDue(now(), mobility, 1s)) {
        emit(circuitStateRecord(now(), mobility));
        emit(packetStateRecord(now(), mobility));
        emit(registrationRecord(now(), mobility));
    }
    if (!_phone.isCamped()) return;
    const ServingNetwork network = servingNetwork(world());
    if (_servingNetwork.isDue(now(), network, 4s)) emit(servingNetworkRecord(now(), network));
    const auto plmns = equivalentPlmns(world());
    if (_equivalents.isDue(now(), plmns, 20s)) emit(equivalentPlmnsRecord(now(), plmns));
}

/// Out of a connection, in turns of three: what is ranked of GSM, what of UMTS.
void GsmSimulation::reportRanking() {
    if (_phone.link() == Link::Open || !every(960ms, 240ms)) return;
    const auto umts = rankedUmtsCells(world());
    const auto gsm = rankedGsmCells(world());
    const bool isGsmsTurn = umts.empty() || (!gsm.empty() && _rankings / 3 % 2 == 0);
    ++_rankings;
    emit(isGsmsTurn ? gsmRankingRecord(now(), gsm) : umtsRankingRecord(now(), umts));
}

void GsmSimulation::reportGsm() {
    const GsmCell& serving = _network.gsm[_phone.serving()];
    if (_servingGsm.isDue(now(), cell(), 4s)) emit(servingCellRecord(now(), serving));
    if (_gprs.isDue(now(), cell(), 20s)) reportGprs(serving.gprs);
    const bool isDedicated = _phone.isDedicated(Rat::GSM);
    if (every(isDedicated ? kSlowMeasurement / 2 : kSlowMeasurement, 320ms)) {
        const GsmMeasurement measurement = gsmMeasurement(world());
        if (_decoded.isDue(now(), cell(), 4s)) emit(decodedCellsRecord(now(), measurement.neighbors));
        emit(measurementRecord(now(), measurement));
    }
    if (_allocation.isDue(now(), {cell(), isDedicated}, 20s) && isDedicated)
        emit(mobileAllocationRecord(now(), serving));
    if (isDedicated && every(960ms, 480ms)) reportGsmChannel(serving);
}

void GsmSimulation::reportGprs(const GprsOptions& options) {
    emit(si13PositionRecord(now(), options));
    emit(si13Record(now(), options));
    emit(cellOptionsRecord(now(), options));
    emit(pbcchRecord(now(), options));
    emit(packetStatusRecord(now(), options));
}

void GsmSimulation::reportGsmChannel(const GsmCell& cell) {
    const int hop = _random.between(0, static_cast<int>(cell.mobileAllocation.size()) - 1);
    _drawn.dedicatedArfcn = cell.mobileAllocation[static_cast<std::size_t>(hop)];
    _drawn.isDtxUsed = _phone.isSilent();
    emit(dedicatedCarrierRecord(now(), _drawn.dedicatedArfcn));
    emit(channelModeRecord(now(), _drawn.isDtxUsed));
}

void GsmSimulation::reportUmts() {
    if (_servingUmts.isDue(now(), cell(), 8s)) emit(rrcCellRecord(now(), _network.umts[_phone.serving()]));
    if (_rrcState.isDue(now(), _phone.rrcState(), 480ms)) emit(rrcStateRecord(now(), _phone.rrcState()));
    const bool isCiphered = _phone.link() != Link::None && _phone.link() != Link::Opening;
    if (_ciphering.isDue(now(), isCiphered, 8s)) emit(cipheringRecord(now(), isCiphered));
    const bool isOpen = _phone.link() == Link::Open;
    const auto active = isOpen ? _phone.activeSet().members() : std::vector{_phone.serving()};
    if (_activeCells.isDue(now(), active, isOpen ? 960ms : 1920ms)) {
        emit(searcherRecord(now(), _air.umtsRssi(), searchedCells(world())));
    }
    reportUmtsChannel();
}

void GsmSimulation::reportUmtsChannel() {
    if (!_phone.isDedicated(Rat::UMTS)) return;
    if (every(480ms, 160ms)) {
        _drawn.transmitPower = drawTransmitPower(world(), _random);
        emit(transmitPowerRecord(now(), _drawn.transmitPower));
    }
    if (!_blocks) _blocks = Window{now(), now() + kFirstBlocks};
    if (now() >= _blocks->end) reportBlocks(now() - _blocks->begin);
}

void GsmSimulation::reportBlocks(Time window) {
    _blocks = Window{now(), now() + kBlocks};
    _drawn.blockErrors = drawBlockErrors(world(), window, _random);
    emit(blockErrorsRecord(now(), _drawn.blockErrors));
    if (_phone.use() != Use::Data) return;
    _drawn.hsdpa = drawHsdpaReport(world(), window, _random);
    emit(hsdpaRecord(now(), _drawn.hsdpa));
}

}  // namespace kelvo::simulation
