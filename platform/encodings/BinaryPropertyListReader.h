#pragma once

#include <string_view>

#include "platform/values/Bytes.h"
#include "platform/values/Result.h"
#include "platform/values/Value.h"

namespace kelvo {

/// Whether `data` announces itself as a binary property list, of whatever version.
bool isBinaryPropertyList(std::string_view data);

/// Reads a binary property list of version 00, all numbers in it big-endian:
///
///     "bplist00", objects, offset table (one offset per object), trailer of 32 bytes
///
///     trailer   6 unused or for sorting, 6: bytes per offset, 7: bytes per object reference,
///               8: number of objects (u64), 16: the root object (u64), 24: where the offset table starts (u64)
///
/// An object is a marker byte (kind in the high half, size in the low half) and its bytes. Every reference to an object
/// gives a value of its own; what references multiply in this way is limited. Kinds without a value of ours (null, UID,
/// sets) and integers beyond 64 signed bits are failures.
Result<Value> readBinaryPropertyList(ByteView data);

}  // namespace kelvo
