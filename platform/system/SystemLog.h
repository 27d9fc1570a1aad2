#pragma once

#include <string_view>

namespace kelvo {

/// Priorities of the system log, by their numbers. `DlfWriter` is the DLF writer's own number; a log that knows no
/// such priority treats it as Error.
enum class Level : int { Error = 3, Warning = 4, Notice = 5, DlfWriter = 16 };

/// Where log lines go. Implementations must not call back into the program.
class SystemLog {
public:
    virtual ~SystemLog() = default;

    /// False when lines of this level are thrown away anyway, so that callers need not format them.
    virtual bool wants(Level level) const = 0;

    /// Takes one line; `text` is borrowed for the call and may hold a trailing newline of its own. Never blocks.
    virtual void write(Level level, std::string_view text) = 0;
};

}  // namespace kelvo
