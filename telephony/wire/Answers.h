#pragma once

#include <cstdint>

#include "platform/values/Bytes.h"

namespace kelvo::wire {

/// What the body of a frame is to a request.
enum class Match {
    No,        ///< something else: an answer to another request, or the request itself, sent back
    Answer,    ///< whole: as long as its kind must be
    TooShort,  ///< an answer that breaks off
    Refusal,   ///< a refusal that echoes the request
};

/// Answers are matched by command and operation, those to masks by equipment too.
Match match(ByteView request, ByteView body);

}  // namespace kelvo::wire
