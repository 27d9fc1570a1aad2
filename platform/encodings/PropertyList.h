#pragma once

#include <cstddef>

#include "platform/values/Bytes.h"
#include "platform/values/Result.h"
#include "platform/values/Value.h"

namespace kelvo {

/// Property lists as bytes. Readers treat their input as hostile: nesting deeper than `kMaxPropertyListDepth`, cyclic
/// or dangling object references, lying counts and unknown encodings are failures with a reason, never a crash; no
/// external entity is followed.
inline constexpr int kMaxPropertyListDepth = 512;
/// Larger ones are refused unread.
inline constexpr std::size_t kMaxPropertyListSize = std::size_t{1} << 30;

/// Whether what begins so is meant as a property list, XML in UTF-8 or binary; nothing but the beginning is looked at.
bool beginsPropertyList(ByteView beginning);

/// Reads a property list in any encoding: XML, binary ("bplist00") or the old text form, the two texts in UTF-8 or
/// UTF-16. The result is never none, its strings are always UTF-8 (U+FFFD stands for what was not), and no array or
/// dictionary in it is shared. In the old text form every scalar but data is a string. The reason of a failure names
/// what was wrong and where: an offset in bytes, of the text as UTF-8 without its byte-order mark.
Result<Value> readPropertyList(ByteView data);

/// Encodes `value` as XML: the XML declaration and <plist version="1.0">, no document type. Fails when a none value or
/// a date outside the years 0 to 9999 stands anywhere in the tree or the tree is deeper than readers accept. Dates are
/// written down to the second. A character that XML 1.0 cannot carry, and a byte that is not UTF-8, is written as
/// U+FFFD.
Result<Bytes> writeXmlPropertyList(const Value& value);

}  // namespace kelvo
