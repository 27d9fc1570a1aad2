#include "telephony/simulation/Random.h"

#include <cmath>
#include <numbers>

namespace kelvo::simulation {

double Random::uniform() { return static_cast<double>(_engine() >> 11) * 0x1.0p-53; }

double Random::between(double low, double high) { return low + (high - low) * uniform(); }

int Random::between(int low, int high) {
    return low + static_cast<int>(uniform() * (static_cast<double>(high) - low + 1));
}

double Random::normal() {
    const double radius = std::sqrt(-2 * std::log(1 - uniform()));  // Box and Muller
    return radius * std::cos(2 * std::numbers::pi * uniform());
}

double Random::exponential(double mean) { return -mean * std::log(1 - uniform()); }

}  // namespace kelvo::simulation
