#pragma once

#include <span>
#include <string_view>

#include "platform/Bytes.h"
#include "platform/Value.h"

/// Reading the property lists that extended records carry as payload; the cell-information array (0xff0001) is an array
/// of dictionaries with the kPLCellMonitor keys of platform/TelephonyConstants.h.
namespace kelvo {

/// The property list behind a packet's 13-byte header, in any encoding; none when it does not parse.
Value payloadPropertyList(ByteView packet);

/// The cell-information array of a packet. A payload that does not parse gives none and two error lines; one that
/// parses to something else than an array holds no cells.
ArrayRef cellInfoArray(ByteView packet);

/// Whether `cell` is a dictionary that says both `technology` and `cellType`.
bool isCell(const Value& cell, std::string_view technology, std::string_view cellType);

/// The first such cell of the array; null when there is none.
const Dictionary* firstCell(const Array& cells, std::string_view technology, std::string_view cellType);

/// One number of a cell and where it is shown.
struct CellField {
    std::string_view cellKey;
    Key displayKey;
    const char* failure;  ///< the error line when the cell lacks it or it is no 32-bit integer
};

/// Shows each field with "%d", in order; one that fails leaves its display key as it was.
void showCell(Dictionary& shown, const Dictionary& cell, std::span<const CellField> fields);

}  // namespace kelvo
