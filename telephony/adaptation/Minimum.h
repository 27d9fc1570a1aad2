#pragma once

#include "platform/values/Bytes.h"
#include "telephony/adaptation/Refusal.h"

namespace kelvo::adaptation {

/// Whether a packet of a code with one layout everywhere is as long as that layout, and its CDMA sub-packets lie within
/// it: none when it is.
std::optional<Refusal> lengthRefusal(LogCode code, ByteView packet);

}  // namespace kelvo::adaptation
