#pragma once

#include "telephony/simulation/UTRAN/Modem.h"
#include "tests/telephony/simulation/ShownSection.h"

namespace kelvo::test {

/// Holds what the screens show after a UTRAN record against the world that the modem plays; differences are test
/// failures. Knows the records that change the screens, by their log codes.
class UtranShown : private ShownSection {
public:
    UtranShown(Played& played, const simulation::utran::Modem& modem) : ShownSection(played), _modem(modem) {}

    void compare(std::uint32_t code);

private:
    void rrcState();
    void servingCell();
    void cells();
    void channels();
    void monitoredCell();
    void contexts();

    const simulation::utran::Modem& _modem;
};

}  // namespace kelvo::test
