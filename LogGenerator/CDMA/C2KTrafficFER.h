#pragma once

#include "platform/values/Bytes.h"
#include "platform/values/Dictionary.h"

/// The frame error rate of a 1x call: each traffic frame, erased or good, moves it by 1/64 of the way. The running
/// fraction (0 to 1) is the state's "TrafficFER".
namespace kelvo {

/// 0x119d: one more traffic frame.
void decodeTrafficFER(ByteView packet, Dictionary& state, const DictionaryRef& lookup);

/// The call has ended: shows its last rate as "(old)", if there is one, and forgets it, so that the next call begins
/// at zero.
void endTrafficFER(Dictionary& state, const DictionaryRef& lookup);

}  // namespace kelvo
