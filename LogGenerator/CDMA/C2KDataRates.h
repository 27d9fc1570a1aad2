#pragma once

#include "platform/values/Bytes.h"
#include "platform/values/Dictionary.h"

/// EV-DO data rates. Each record holds counters that grow with what was sent, each worth a fixed number of bits; the
/// rate is the growth of their sum over the growth of the record's sequence number, in kbps of 1024 bits.
///
/// The running values live in the state: "FLDataSeqNum" (32 bits, unsigned) and "FLDataSent" (64 bits, in bits), the
/// same with "RL" for the reverse link. The state's "ExtraInfo" has them with a "1" behind their names, the previous
/// pair with a "2". The first record of a link primes them and shows "".
///
/// The sequence number wraps around; a record whose number has not grown leaves the rate shown, and takes part in the
/// next one. A total that has shrunk, as after a restart of the counters alone, gives a negative rate, which is
/// plainly wrong and replaced by the next record.
namespace kelvo {

/// 0x1192: the forward link.
void decodeForwardDataRate(ByteView packet, Dictionary& state, const DictionaryRef& lookup);
/// 0x127e: the reverse link.
void decodeReverseDataRate(ByteView packet, Dictionary& state, const DictionaryRef& lookup);

}  // namespace kelvo
