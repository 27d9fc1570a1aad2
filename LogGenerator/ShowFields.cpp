#include "LogGenerator/ShowFields.h"

#include <bit>

#include "LogGenerator/RowWriter.h"

namespace kelvo {

void showReal(Value& value, double number, const ShownReal& quantity) {
    showValue(value, std::bit_cast<std::int64_t>(number), quantity);
}

namespace {

/// Marks the values of a tree as written by the record `number`. Recursive: a tree that was read is at most
/// `kMaxPropertyListDepth` deep.
void mark(Value& value, std::uint64_t number) {
    value.setRecord(number);
    if (value.array()) {
        for (std::size_t i = 0; i < value.array()->size(); ++i) mark((*value.array())[i], number);
    } else if (value.dictionary()) {
        value.dictionary()->forEachValue([number](Value& child) { mark(child, number); });
    }
}

}  // namespace

void showDelivered(Value& value, const Value& delivered) {
    value = delivered;
    mark(value, RecordBeingShown::number());
}

void showFields(Dictionary& shown, RecordView record, std::size_t base, std::span<const Field> fields) {
    const std::uint64_t number = RecordBeingShown::number();
    for (const Field& field : fields) {
        const std::int64_t raw = record.read(base + field.at, field.raw);
        if (field.shown.leavesOut(raw)) {
            shown.remove(field.key);
        } else {
            showValue(shown.slot(field.key), raw, field.shown, field.place.from(base), number);
        }
    }
}

void showFields(Dictionary::Rewrite& row, RecordView record, std::size_t base, std::span<const Field> fields) {
    const std::uint64_t number = RecordBeingShown::number();
    for (const Field& field : fields) {
        const std::int64_t raw = record.read(base + field.at, field.raw);
        if (!field.shown.leavesOut(raw)) {
            showValue(row.next(field.key), raw, field.shown, field.place.from(base), number);
        }
    }
}

void showValues(const ArrayRef& values, RecordView record, const RecordEntries& entries, Raw raw, const Shown& shown) {
    const std::uint64_t number = RecordBeingShown::number();
    const Place place = raw.placeAt(0);
    const ArrayLock::Held held;
    values->resize(entries.count());
    for (std::size_t i = 0; i < entries.count(); ++i) {
        const std::size_t at = entries.offsetOf(i);
        showValue((*values)[i], record.read(at, raw), shown, place.from(at), number);
    }
}

void showRows(const ArrayRef& list, ByteView data, const RecordEntries& entries, std::span<const Field> fields) {
    RowWriter rows(list);
    const RecordView record(data);
    const RecordEntries present = entries.within(data.size());
    for (std::size_t i = 0; i < present.count(); ++i) {
        Dictionary::Rewrite row = rows.next();
        showFields(row, record, present.offsetOf(i), fields);
    }
}

}  // namespace kelvo
