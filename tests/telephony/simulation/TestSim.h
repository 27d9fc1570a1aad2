#pragma once

#include <optional>
#include <string>

#include "tests/telephony/simulation/Played.h"

namespace kelvo::test {

/// Expects the SIM of the test network under `path`, every file of it: registered in this location (or tracking) area
/// and routing area, or nowhere.
struct RegisteredArea {
    int location = 0;
    int routing = 1;
};
void expectTestSim(Played& played, const std::string& path, const std::optional<RegisteredArea>& area);

}  // namespace kelvo::test
