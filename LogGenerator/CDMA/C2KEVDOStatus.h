#pragma once

#include "platform/values/Bytes.h"
#include "platform/values/Dictionary.h"

namespace kelvo {

/// 0x1183: channel, levels, states and addresses of EV-DO (3GPP2 C.S0024), in a record of exactly 50 bytes. The second
/// receive chain and the transmitter show "N/A" in the device states below Access; the reserved ones are above it.
void decodeEVDOStatus(ByteView packet, Dictionary& state, const DictionaryRef& lookup);

}  // namespace kelvo
