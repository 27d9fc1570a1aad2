#include "tools/export/Interruption.h"

namespace kelvo {

namespace {

volatile sig_atomic_t hasSignalCome = 0;  // all that a signal handler can reach

extern "C" void noteSignal(int) { hasSignalCome = 1; }

}  // namespace

Interruption::Interruption() {
    hasSignalCome = 0;
    struct sigaction action {};
    action.sa_handler = noteSignal;
    action.sa_flags = static_cast<int>(SA_RESETHAND);  // and no SA_RESTART: reads end
    for (std::size_t i = 0; i < kSignals.size(); ++i) ::sigaction(kSignals[i], &action, &_before[i]);
}

Interruption::~Interruption() {
    for (std::size_t i = 0; i < kSignals.size(); ++i) ::sigaction(kSignals[i], &_before[i], nullptr);
}

bool Interruption::hasCome() const { return hasSignalCome != 0; }

}  // namespace kelvo
