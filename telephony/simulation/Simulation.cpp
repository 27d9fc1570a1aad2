#include "telephony/simulation/Simulation.h"

namespace kelvo::simulation {

Simulation::Message Simulation::next() {
    while (_waiting.empty()) {
        _now += kStep;
        step();
    }
    Message message = std::move(_waiting.front());
    _waiting.pop_front();
    return message;
}

}  // namespace kelvo::simulation
