#pragma once

#include <optional>

#include "telephony/line/ModemLines.h"
#include "telephony/line/PathWatch.h"
#include "telephony/line/PortAddress.h"
#include "telephony/line/SerialLine.h"

namespace kelvo {

/// The lines of this system to one address. "auto" tries the nodes that may be a diagnostic port one after the other,
/// the likeliest first.
class HostModemLines final : public ModemLines {
public:
    HostModemLines(PortAddress address, SerialLine::Options options)
        : _address(std::move(address)), _options(options) {}

    std::string description() const override { return _address.description(); }
    Result<std::unique_ptr<ModemLine>> next(ModemLine::Listener& listener, bool again) override;
    void watch(std::function<void()> changed) override;

private:
    Result<std::unique_ptr<ModemLine>> nextCandidate(ModemLine::Listener& listener, bool again);
    Result<std::unique_ptr<ModemLine>> toNode(const std::string& path, ModemLine::Listener& listener) const;

    const PortAddress _address;
    const SerialLine::Options _options;
    std::string _tried;  // the candidate that was tried last
    std::optional<PathWatch> _watch;
};

}  // namespace kelvo
