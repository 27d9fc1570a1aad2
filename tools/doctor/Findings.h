#pragma once

#include <nlohmann/json.hpp>
#include <optional>
#include <string>
#include <vector>

#include "telephony/wire/CandidateNode.h"
#include "tools/doctor/ModemProbe.h"
#include "tools/doctor/PhoneFindings.h"
#include "tools/doctor/PortAccess.h"
#include "tools/doctor/PortHolders.h"

namespace kelvo {

/// What there is to say of one port.
struct PortFindings {
    wire::CandidateNode node;  ///< of a network port its path is "tcp:…" or "unix:…", and nothing else is known
    bool isNetwork = false;
    PortAccess access;
    PortHolders holders;
    std::optional<ModemProbe> probe;  ///< none: it has not been asked
};

/// What the doctor has found.
struct Findings {
    std::vector<PortFindings> ports;  ///< the likeliest first
    bool modemManagerRuns = false;
    std::optional<PhoneFindings> phone;  ///< none: ModemManager does not run
    std::string user;
};

/// The findings for people, with the one next step at their end.
std::string findingsText(const Findings& findings);
/// The same for programs.
nlohmann::ordered_json findingsJson(const Findings& findings);

/// The one thing to do next.
std::string nextStep(const Findings& findings);

/// A udev rule that gives the port to the group dialout and tells the modem manager to leave it alone. The node is on
/// USB.
std::string udevRule(const wire::CandidateNode& node);

}  // namespace kelvo
