#include "LogGenerator/ShowFields.h"

#include <bit>

#include "LogGenerator/RowWriter.h"

namespace kelvo {

void showReal(Value& value, double number, const ShownReal& quantity) {
    showValue(value, std::bit_cast<std::int64_t>(number), quantity);
}

void showFields(Dictionary& shown, RecordView record, std::size_t base, std::span<const Field> fields) {
    std::size_t next = 0;
    for (const Field& field : fields) {
        const std::int64_t raw = record.read(base + field.at, field.raw);
        if (field.shown.leavesOut(raw)) {
            shown.remove(field.key);
        } else {
            showValue(shown.slot(field.key, next), raw, field.shown);
        }
    }
}

void showFields(Dictionary::Rewrite& row, RecordView record, std::size_t base, std::span<const Field> fields) {
    for (const Field& field : fields) {
        const std::int64_t raw = record.read(base + field.at, field.raw);
        if (!field.shown.leavesOut(raw)) showValue(row.next(field.key), raw, field.shown);
    }
}

void showValues(const ArrayRef& values, RecordView record, const RecordEntries& entries, Raw raw, const Shown& shown) {
    const ArrayLock::Held held;
    values->resize(entries.count());
    for (std::size_t i = 0; i < entries.count(); ++i) {
        showValue((*values)[i], record.read(entries.offsetOf(i), raw), shown);
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
