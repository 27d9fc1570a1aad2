// Prints what a simulated modem writes, a message a line (nanoseconds, bytes), to compare one processor's with
// another's. Usage: simulated_log FAMILY YEAR SEED MINUTES
#include <fmt/format.h>

#include <cstdio>
#include <cstdlib>
#include <string_view>

#include "telephony/simulation/MakeSimulation.h"

using namespace kelvo;
using namespace kelvo::simulation;

int main(int count, char** arguments) {
    if (count != 5) return 1;
    const auto technology = technologyBy(&TechnologyNames::word, std::string_view(arguments[1]));
    if (!technology) return 1;
    const std::string_view year(arguments[2]);
    const auto generation = year == "2010" ? Result<Generation>(Generation::Of2010) : generationOf(*technology, year);
    if (!generation) return 1;
    const auto modem = makeSimulation(*technology, std::strtoull(arguments[3], nullptr, 10), *generation);
    const std::chrono::minutes end(std::atoi(arguments[4]));
    for (auto message = modem->next(); message.time < end; message = modem->next()) {
        fmt::print("{} {:02x}\n", message.time.count(), fmt::join(message.bytes, ""));
    }
}
