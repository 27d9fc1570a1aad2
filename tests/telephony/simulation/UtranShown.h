#pragma once

#include "telephony/simulation/UTRAN/Modem.h"
#include "tests/telephony/simulation/Played.h"

namespace kelvo::test {

/// Holds what the screens show after a UTRAN record against the world that the modem plays; differences are test
/// failures. Knows the records that change the screens, by their log codes.
class UtranShown {
public:
    UtranShown(Played& played, const simulation::utran::Modem& modem) : _played(played), _modem(modem) {}

    void compare(std::uint32_t code);

private:
    void rrcState();
    void servingCell();
    void cells();
    void channels();
    void monitoredCell();
    void contexts();

    /// The text shown under `key` of the section last opened.
    std::string at(const std::string& key) { return _played.text(_section + "/" + key); }
    double number(const std::string& key) { return _played.number(_section + "/" + key); }
    void equals(const std::string& key, const std::string& text);
    void equals(const std::string& key, std::int64_t number) { equals(key, std::to_string(number)); }

    Played& _played;
    const simulation::utran::Modem& _modem;
    std::string _section;
};

}  // namespace kelvo::test
