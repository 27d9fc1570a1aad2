#include "platform/system/Environment.h"

namespace kelvo {

constinit Environment detail::environmentInForce;

Environment::Scope::Scope(const Environment& environment) : _before(detail::environmentInForce) {
    detail::environmentInForce = environment;
}

Environment::Scope::~Scope() { detail::environmentInForce = _before; }

const Clock& clock() {
    static const SystemClock kSystemClock;
    const Clock* chosen = Environment::current().clock;
    return chosen != nullptr ? *chosen : kSystemClock;
}

void printLine(std::string_view text) {
    std::FILE* output = Environment::current().standardOutput;
    if (output != nullptr) fmt::print(output, "{}\n", text);
}

}  // namespace kelvo
