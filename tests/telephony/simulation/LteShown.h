#pragma once

#include "telephony/simulation/LTE/Modem.h"
#include "tests/telephony/simulation/ShownSection.h"

namespace kelvo::test {

/// Holds what the screens show after an LTE record against the world that the modem plays; differences are test
/// failures. Knows the records that change the screens, by their log codes.
class LteShown : private ShownSection {
public:
    LteShown(Played& played, const simulation::lte::Modem& modem) : ShownSection(played), _modem(modem) {}

    void compare(std::uint32_t code);

private:
    void servingCell();
    void connectedMeasurement();
    void servingMeasurement();
    void neighborMeasurement();
    void candidates();
    void candidate(const simulation::lte::Candidate& candidate);
    void candidateCell(const simulation::lte::Candidate::Lte& cell);
    void candidateCell(const simulation::lte::Candidate::Utran& cell);
    void candidateCell(const simulation::lte::Candidate::Geran& cell);
    void candidateCell(const simulation::lte::Candidate::OneX& cell);
    void candidateCell(const simulation::lte::Candidate::Hrpd& cell);
    void candidatePilot(const simulation::lte::Candidate::Cdma& cell);
    void monitoredCell();
    void contexts();

    const simulation::lte::Modem& _modem;
};

}  // namespace kelvo::test
