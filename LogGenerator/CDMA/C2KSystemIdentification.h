#pragma once

#include "platform/values/Bytes.h"
#include "platform/values/Dictionary.h"

namespace kelvo {

/// 0x134f: roaming indicator (3GPP2 C.R1001), system and network identification, packet zone, base station and
/// protocol revision. Records below version 2 are refused.
void decodeSystemIdentification(ByteView packet, Dictionary& state, const DictionaryRef& lookup);

}  // namespace kelvo
