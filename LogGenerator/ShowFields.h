#pragma once

#include <span>

#include "LogGenerator/FieldTable.h"
#include "LogGenerator/RecordBeingShown.h"
#include "platform/values/Array.h"
#include "platform/values/Dictionary.h"

/// Writing readings to the display. A record leaves raw numbers there, each with the table line that prints it when the
/// display is read: tables are static data. Everything that is written here bears the number of the record that is
/// being shown; sections write nothing to the display in any other way.
namespace kelvo {

/// Makes `value` a reading of `quantity`, at `place` in its record when one field holds it.
inline void showValue(Value& value, std::int64_t raw, const Quantity& quantity, Place place = {},
                      std::uint64_t record = RecordBeingShown::number()) {
    value.set({.raw = raw, .quantity = &quantity, .place = place}, record);
}
void showValue(Value& value, std::int64_t raw, const Quantity&& quantity, Place place = {},
               std::uint64_t record = 0) = delete;

/// Makes `value` a text.
inline void showText(Value& value, std::string_view text) {
    value.text().assign(text);
    value.setRecord(RecordBeingShown::number());
}

/// Makes `value` what a record delivers ready-made. The arrays and dictionaries in `delivered` become the display's
/// own.
void showDelivered(Value& value, const Value& delivered);

/// Makes `value` a number that a decoder has worked out.
void showReal(Value& value, double number, const ShownReal& quantity);
void showReal(Value& value, double number, const ShownReal&& quantity) = delete;

/// Shows fields in their order; `base` is the offset from which theirs count. Keys that stand already keep their place.
void showFields(Dictionary& shown, RecordView record, std::size_t base, std::span<const Field> fields);
/// Shows fields as the next entries of a row.
void showFields(Dictionary::Rewrite& row, RecordView record, std::size_t base, std::span<const Field> fields);

/// Makes `values` hold one text for each entry, as `raw` lies at the entry's start.
void showValues(const ArrayRef& values, RecordView record, const RecordEntries& entries, Raw raw, const Shown& shown);

/// Makes `list` hold one row for each entry, in record order. Entries that lie wholly beyond the record's end are not
/// made up. A null list is ignored.
void showRows(const ArrayRef& list, ByteView data, const RecordEntries& entries, std::span<const Field> fields);

/// The same, for entries that follow one another without gaps from `start` on.
template <std::size_t N>
void showRows(const ArrayRef& list, ByteView data, std::size_t start, std::size_t count, const EntryLayout<N>& layout) {
    showRows(list, data, layout.entries(start, count), layout.fields);
}

}  // namespace kelvo
