#include "LogGenerator/CDMA/C2KStoreDisplayValue.h"

namespace kelvo {

namespace {

/// Hands every place that is bound to `lookupKey` to `store`.
template <class Store>
void atEachPlace(const Key& lookupKey, const DictionaryRef& lookup, Store store) {
    static constexpr Key kDict("dict");
    static constexpr Key kKey("key");
    if (!lookup) return;
    const ArrayRef& bindings = (*lookup)[lookupKey].array();
    if (!bindings) return;
    for (const Value& binding : *bindings) {
        if (!binding.dictionary()) return;
        const DictionaryRef& display = (*binding.dictionary())[kDict].dictionary();
        const std::string* key = (*binding.dictionary())[kKey].string();
        if (!display || key == nullptr) return;
        store(display->slot(*key));
    }
}

}  // namespace

void C2KStoreDisplayValue(Key lookupKey, const Value& value, const DictionaryRef& lookup) {
    atEachPlace(lookupKey, lookup, [&, record = RecordBeingShown::number()](Value& place) {
        place = value;
        place.setRecord(record);
    });
}

void C2KStoreFields(RecordView record, std::size_t base, std::span<const Field> fields, const DictionaryRef& lookup) {
    const std::uint64_t number = RecordBeingShown::number();
    for (const Field& field : fields) {
        const std::int64_t raw = record.read(base + field.at, field.raw);
        atEachPlace(field.key, lookup,
                    [&](Value& value) { showValue(value, raw, field.shown, field.place.from(base), number); });
    }
}

void C2KStoreNotAvailable(std::span<const Field> fields, const DictionaryRef& lookup) {
    const Value notAvailable = "N/A";
    for (const Field& field : fields) C2KStoreDisplayValue(field.key, notAvailable, lookup);
}

}  // namespace kelvo
