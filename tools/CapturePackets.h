#pragma once

#include <fmt/format.h>

#include <string>

#include "LogGenerator/LogGenerator.h"
#include "LogGenerator/RecordLedger.h"
#include "tools/CommandFailure.h"

namespace kelvo {

/// Hands `message` to the generator; what it shows bears its number in `records`.
void update(LogGenerator& generator, Dictionary& state, RecordLedger& records, ByteView message,
            RecordLedger::Arrival arrival);

/// What ends the program elsewhere ends the command here, with the packet that did it.
template <class Work>
void orTell(const std::string& path, std::size_t packet, Work work) {
    try {
        work();
    } catch (...) {
        throw CommandFailure(fmt::format("packet {} of {} ends the program: {}", packet, path, currentExceptionText()));
    }
}

}  // namespace kelvo
