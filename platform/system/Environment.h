#pragma once

#include <fmt/printf.h>

#include <cstdio>
#include <string>
#include <string_view>

#include "platform/system/Clock.h"
#include "platform/system/Resources.h"
#include "platform/system/SystemLog.h"

namespace kelvo {

/// The services every part of the program may call on: the system log, the clock, the application's resources and its
/// standard output. Main installs them before anything else and tests install their own; nothing here is owned.
struct Environment {
    SystemLog* log = nullptr;              ///< null: lines are thrown away
    const Clock* clock = nullptr;          ///< null: the machine's clock
    const Resources* resources = nullptr;  ///< null: no resource is found
    std::FILE* standardOutput = nullptr;   ///< null: `printLine` is silent
    std::string_view version = {};         ///< of the application; empty: it has none

    /// The environment in force.
    static const Environment& current();

    /// Puts an environment in force for as long as the object lives; the one before it returns afterwards.
    class Scope;
};

namespace detail {
extern Environment environmentInForce;  // constant-initialised; changed by Environment::Scope alone
}

inline const Environment& Environment::current() { return detail::environmentInForce; }

class Environment::Scope {
public:
    explicit Scope(const Environment& environment);
    ~Scope();
    Scope(const Scope&) = delete;
    Scope& operator=(const Scope&) = delete;

private:
    Environment _before;
};

/// The clock in force.
const Clock& clock();

/// Whether anybody reads log lines of this level.
inline bool logWants(Level level) {
    const SystemLog* log = Environment::current().log;
    return log != nullptr && log->wants(level);
}

/// Writes one line to the system log as it stands.
inline void logLine(Level level, std::string_view text) {
    if (logWants(level)) Environment::current().log->write(level, text);
}

/// Writes one line in printf's notation; nothing is formatted when nobody reads it.
template <class Arg, class... Args>
void logLine(Level level, const char* format, const Arg& arg, const Args&... args) {
    if (logWants(level)) Environment::current().log->write(level, fmt::sprintf(format, arg, args...));
}

/// Writes one line to the program's standard output.
void printLine(std::string_view text);

}  // namespace kelvo
