#pragma once

#include <optional>

#include "telephony/simulation/GSMUMTS/Network.h"
#include "telephony/simulation/PhoneUser.h"
#include "telephony/simulation/Time.h"

namespace kelvo::simulation::gsm {

using Activity = PhoneUser::Activity;

// The states of mobility management (3GPP TS 24.008, section 4), numbered as the modem numbers them.
enum class MmState {
    Null = 0,
    LocationUpdateInitiated = 3,
    ConnectionActive = 6,
    WaitForRrConnectionLu = 13,
    WaitForRrConnectionMm = 14,
    Idle = 19,
};
enum class MmSubState { Null = 0, PlmnSearch = 2, LocationUpdateNeeded = 5, NormalService = 8 };
enum class GmmState {
    Deregistered = 1,
    RegisteredInitiated = 2,
    Registered = 3,
    RoutingAreaUpdateInitiated = 5,
    ServiceRequestInitiated = 6,
};
enum class GmmSubState { NormalService = 0, AttachNeeded = 2, PlmnSearch = 6, Suspended = 7, UpdateNeeded = 8 };
enum class RegistrationState { Idle = 1, Registering = 2, AutomaticSearch = 5 };
enum class ServiceType { None = 0, CsOnly = 1, CsAndPs = 3, Limited = 4 };

/// What the phone tells of its registration.
struct Mobility {
    MmState mm = MmState::Null;
    MmSubState mmSub = MmSubState::PlmnSearch;
    bool isLocationUpdated = false;
    GmmState gmm = GmmState::Deregistered;
    GmmSubState gmmSub = GmmSubState::PlmnSearch;
    bool isRoutingUpdated = false;
    RegistrationState registration = RegistrationState::AutomaticSearch;
    ServiceType service = ServiceType::None;
    bool operator==(const Mobility&) const = default;
};

/// Keeps the phone registered where it is: both domains in one procedure whenever the area that the serving cell
/// broadcasts is another than the registered one, a call's end awaited.
class Registration {
public:
    struct Surroundings {
        std::optional<Area> area = {};  ///< broadcast by the serving cell; none before the first
        Rat rat = Rat::GSM;
        bool isLinkOpen = false;
        Activity activity = Activity::Resting;
    };

    void step(Time now, const Surroundings& here);

    /// The procedure needs a connection, or is using it.
    bool wantsLink() const { return _phase != Phase::Settled; }
    const std::optional<Area>& registered() const { return _registered; }
    const Mobility& mobility() const { return _mobility; }

private:
    enum class Phase { Settled, Requested, Updating };
    void advance(Time now, const Surroundings& here);
    void describeCircuits(const Surroundings& here);
    void describePackets(const Surroundings& here);
    ServiceType service(const Surroundings& here) const;

    Phase _phase = Phase::Settled;
    Time _done{0};
    std::optional<Area> _registered;
    Mobility _mobility;
};

}  // namespace kelvo::simulation::gsm
