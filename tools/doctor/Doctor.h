#pragma once

#include <functional>
#include <optional>
#include <string>

#include "tools/doctor/Findings.h"

namespace kelvo {

/// Where the doctor looks: the system's, or a test's. Everything only reads, but for the probe, which asks the modem.
struct DoctorInputs {
    std::function<std::vector<wire::CandidateNode>()> candidates;
    std::function<PortAccess(const std::string& path)> access;
    std::function<PortHolders(const std::string& path)> holders;
    std::function<bool()> modemManagerRuns;
    std::function<PhoneFindings()> phone;  ///< asked only when ModemManager runs
    std::function<ModemProbe(const std::string& place)> probe;
    std::string user;
};

/// Looks at the port at `place` (a path, "tcp:HOST:PORT" or "unix:PATH"), or at every candidate where none is named or
/// it is "auto". With `probe` the ports that may be opened and that nobody has open are asked as well; where none is
/// named, only those that may be diagnostic ones.
Findings examine(const DoctorInputs& inputs, const std::optional<std::string>& place, bool probe);

}  // namespace kelvo
