#pragma once

#include "telephony/simulation/LTE/Modem.h"
#include "tests/telephony/simulation/Played.h"

namespace kelvo::test {

/// Holds what the screens show after an LTE record against the world that the modem plays; differences are test
/// failures. Knows the records that change the screens, by their log codes.
class LteShown {
public:
    LteShown(Played& played, const simulation::lte::Modem& modem) : _played(played), _modem(modem) {}

    void compare(std::uint32_t code);

private:
    void servingCell();
    void connectedMeasurement();
    void servingMeasurement();
    void neighborMeasurement();
    void candidates();
    void candidate(const simulation::lte::Candidate& candidate);
    void monitoredCell();
    void contexts();

    /// The text shown under `key` of the section last opened.
    std::string at(const std::string& key) { return _played.text(_section + "/" + key); }
    void equals(const std::string& key, const std::string& text);
    void equals(const std::string& key, std::int64_t number) { equals(key, std::to_string(number)); }
    /// A reading shown in steps of `step`, with its unit.
    void reads(const std::string& key, double truth, double step, const std::string& unit);

    Played& _played;
    const simulation::lte::Modem& _modem;
    std::string _section;
};

}  // namespace kelvo::test
