#pragma once

#include <QString>

#include "platform/values/Bytes.h"
#include "platform/values/Reading.h"

namespace kelvo {

/// A record's bytes, eight in a line behind their offset, as styled text: the bytes of the field at `place` are bold
/// and underlined, and below them stand its bits. Of a long record the lines around the field alone, or the first ones.
/// Empty without bytes.
QString recordDump(ByteView bytes, const Place& place);

/// Where the field is: "Bytes 21 to 24 of 40, bits 0 to 8"; "40 bytes" for a value that no single field holds. Empty
/// without bytes.
QString placeText(ByteView bytes, const Place& place);

}  // namespace kelvo
