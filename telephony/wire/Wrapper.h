#pragma once

#include <cstdint>
#include <optional>

#include "telephony/wire/FrameReader.h"

namespace kelvo::wire {

/// A frame's body that a modem of several SIMs has wrapped.
struct Wrapped {
    std::int32_t subscription = 0;  ///< from 1; 0 and -1 name none
    MutableBytes body;              ///< what lies inside
};

/// Opens a wrapper (a body that begins with 0x98); none when it is too short to hold a body or of another kind.
std::optional<Wrapped> unwrap(MutableBytes body);

/// `body` in a wrapper.
Bytes wrap(std::int32_t subscription, ByteView body);

}  // namespace kelvo::wire
