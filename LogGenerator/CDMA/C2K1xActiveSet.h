#pragma once

#include <cstddef>

#include "LogGenerator/RecordView.h"
#include "platform/values/Dictionary.h"

namespace kelvo {

/// The pilots of the 1x active set with their Ec/Io in dB, never below -50 dB; the reference pilot says so. A set
/// without pilots is an empty list, not "(none)". `base` is the offset of the active-set sub-packet in the record.
DictionaryRef C2K1xActiveSet(RecordView record, std::size_t base);

}  // namespace kelvo
