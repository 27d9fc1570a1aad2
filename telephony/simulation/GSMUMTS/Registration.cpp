#include "telephony/simulation/GSMUMTS/Registration.h"

namespace kelvo::simulation::gsm {
namespace {

constexpr Time kProcedure = std::chrono::milliseconds(500);

}  // namespace

void Registration::step(Time now, const Surroundings& here) {
    if (!here.area) return;
    advance(now, here);
    describeCircuits(here);
    describePackets(here);
    _mobility.registration = _phase == Phase::Settled ? RegistrationState::Idle : RegistrationState::Registering;
    _mobility.service = service(here);
}

void Registration::advance(Time now, const Surroundings& here) {
    const bool isElsewhere = _registered != here.area;
    if (_phase == Phase::Settled && isElsewhere && here.activity != Activity::Talking) _phase = Phase::Requested;
    if (_phase == Phase::Requested && !isElsewhere) _phase = Phase::Settled;
    if (_phase == Phase::Requested && here.isLinkOpen) {
        _phase = Phase::Updating;
        _done = now + kProcedure;
    }
    if (_phase == Phase::Updating && now >= _done) {
        _registered = here.area;
        _phase = Phase::Settled;
    }
}

void Registration::describeCircuits(const Surroundings& here) {
    _mobility.isLocationUpdated = _registered && _registered->lac == here.area->lac;
    _mobility.mmSub = _mobility.isLocationUpdated ? MmSubState::NormalService : MmSubState::LocationUpdateNeeded;
    if (here.activity == Activity::Talking) {
        _mobility.mm = here.isLinkOpen ? MmState::ConnectionActive : MmState::WaitForRrConnectionMm;
    } else if (_mobility.isLocationUpdated || _phase == Phase::Settled) {
        _mobility.mm = MmState::Idle;
    } else {
        _mobility.mm = _phase == Phase::Updating ? MmState::LocationUpdateInitiated : MmState::WaitForRrConnectionLu;
    }
}

void Registration::describePackets(const Surroundings& here) {
    const bool isSuspended = here.activity == Activity::Talking && here.rat == Rat::GSM;  // a phone of class B
    _mobility.isRoutingUpdated = _registered == here.area;
    _mobility.gmm = GmmState::Registered;
    if (_phase != Phase::Settled) {
        _mobility.gmm = _registered ? GmmState::RoutingAreaUpdateInitiated : GmmState::RegisteredInitiated;
    } else if (here.activity == Activity::Browsing && !here.isLinkOpen && here.rat == Rat::UMTS) {
        _mobility.gmm = GmmState::ServiceRequestInitiated;
    }
    _mobility.gmmSub = isSuspended                  ? GmmSubState::Suspended
                       : _mobility.isRoutingUpdated ? GmmSubState::NormalService
                       : _registered                ? GmmSubState::UpdateNeeded
                                                    : GmmSubState::AttachNeeded;
}

ServiceType Registration::service(const Surroundings& here) const {
    if (!_registered) return ServiceType::Limited;
    return _mobility.gmmSub == GmmSubState::Suspended && here.isLinkOpen ? ServiceType::CsOnly : ServiceType::CsAndPs;
}

}  // namespace kelvo::simulation::gsm
