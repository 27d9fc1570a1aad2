#pragma once

#include "platform/values/Bytes.h"
#include "platform/values/Dictionary.h"

/// Pilots of EV-DO with their energy over the total received, in dB. Energies are stored in steps of 1/512; one of 0
/// shows "-inf dB".
namespace kelvo {

/// 0x12b6: the active set's pilots.
void decodeActiveSetPilots(ByteView packet, Dictionary& state, const DictionaryRef& lookup);

/// 0x108a: the rake receiver's fingers; those that track no pilot are left out.
void decodeFingerC2I(ByteView packet, Dictionary& state, const DictionaryRef& lookup);

}  // namespace kelvo
