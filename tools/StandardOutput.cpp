#include "tools/StandardOutput.h"

#include <cerrno>
#include <cstdio>
#include <system_error>

#include "tools/CommandFailure.h"

namespace kelvo {

void writeToStandardOutput(std::string_view text) {
    errno = 0;
    const bool written = std::fwrite(text.data(), 1, text.size(), stdout) == text.size() && std::fflush(stdout) == 0;
    if (!written) throw CommandFailure("standard output cannot be written: " + std::generic_category().message(errno));
}

}  // namespace kelvo
