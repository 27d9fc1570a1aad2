#pragma once

#include <span>
#include <string_view>

#include "LogGenerator/ShowFields.h"
#include "platform/values/Bytes.h"
#include "platform/values/Value.h"

/// Reading the property lists that extended records carry as payload; the cell-information array (0xff0001) is an array
/// of dictionaries with the kPLCellMonitor keys of platform/telephony/TelephonyConstants.h.
namespace kelvo {

/// The property list behind a packet's 13-byte header, in any encoding; none when it does not parse.
Value payloadPropertyList(ByteView packet);

/// The property list of a cell-information packet; none when it does not parse. It is shared by all who read one
/// record, and not to be changed.
Value cellInfo(ByteView packet);

/// The cell-information array of a packet. One that does not parse gives none and two error lines; one that parses to
/// something else than an array holds no cells.
ArrayRef cellInfoArray(ByteView packet);

/// Whether `cell` is a dictionary that says both `technology` and `cellType`.
bool isCell(const Value& cell, std::string_view technology, std::string_view cellType);

/// One number of a cell and where it is shown.
struct CellField {
    Key cellKey;
    Key displayKey;
    /// The error line when the cell lacks it or it is no 32-bit integer; null when another field has said so.
    const char* failure;
    Shown shown = decimal;
};

/// Shows each field in order; one that fails leaves its display key as it was. With a null `shown` the failures are
/// logged all the same. The fields are static data.
void showCell(const DictionaryRef& shown, const Dictionary& cell, std::span<const CellField> fields);

/// Shows the first serving cell of `technology` in a packet's cell-information array; without one nothing changes.
void showServingCell(const DictionaryRef& shown, ByteView packet, std::string_view technology,
                     std::span<const CellField> fields);

/// Makes `list` hold one row for each neighbor cell of `technology` in a packet's cell-information array, in the
/// array's order; none when there is no array. A field that fails is missing in its row.
void showNeighbors(const ArrayRef& list, ByteView packet, std::string_view technology,
                   std::span<const CellField> fields);

}  // namespace kelvo
