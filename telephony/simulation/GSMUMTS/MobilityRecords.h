#pragma once

#include <span>

#include "platform/values/Bytes.h"
#include "telephony/simulation/GSMUMTS/Registration.h"

namespace kelvo::simulation::gsm {

/// The network as its serving cell broadcasts it, and what the phone has of it.
struct ServingNetwork {
    Area area = {};
    ServiceType service = ServiceType::None;
    int operationMode = 0;  ///< 0 is mode I
    bool operator==(const ServingNetwork&) const = default;
};

struct Plmn {
    int mcc = 0;
    int mnc = 0;
    bool operator==(const Plmn&) const = default;
};

Bytes packetStateRecord(Time time, const Mobility& mobility);          // 0x7130
Bytes circuitStateRecord(Time time, const Mobility& mobility);         // 0x7131
Bytes registrationRecord(Time time, const Mobility& mobility);         // 0x7132
Bytes servingNetworkRecord(Time time, const ServingNetwork& network);  // 0x7135
/// At most one: the entries of more would lie over one another. 0x7150
Bytes equivalentPlmnsRecord(Time time, std::span<const Plmn> plmns);

}  // namespace kelvo::simulation::gsm
