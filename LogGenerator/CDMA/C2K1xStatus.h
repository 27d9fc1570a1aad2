#pragma once

#include "platform/values/Bytes.h"
#include "platform/values/Dictionary.h"

namespace kelvo {

/// 0x119c: call state (3GPP2 C.S0005), channels, levels and active set (C.S0002) of 1x, from the sub-packets 1 to 4.
/// The second receive chain and the transmitter show "N/A" outside a call, and a frame error rate left over from one is
/// shown as old once and forgotten.
void decode1xStatus(ByteView packet, Dictionary& state, const DictionaryRef& lookup);

}  // namespace kelvo
