#pragma once

#include <signal.h>

#include <array>

namespace kelvo {

/// Ctrl-C and its like as a question, for as long as it lives: a command that asks it now and then ends what it has
/// begun. A read that waits gives up. A second Ctrl-C does what it always does. One object at a time.
class Interruption {
public:
    Interruption();
    ~Interruption();
    Interruption(const Interruption&) = delete;
    Interruption& operator=(const Interruption&) = delete;

    /// Whether one has come.
    bool hasCome() const;

private:
    static constexpr std::array<int, 3> kSignals = {SIGINT, SIGTERM, SIGHUP};
    std::array<struct sigaction, kSignals.size()> _before{};
};

}  // namespace kelvo
