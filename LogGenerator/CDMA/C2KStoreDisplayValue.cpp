#include "LogGenerator/CDMA/C2KStoreDisplayValue.h"

namespace kelvo {

void C2KStoreDisplayValue(Key lookupKey, const Value& value, const DictionaryRef& lookup) {
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
        display->slot(*key) = value;
    }
}

void C2KStoreFields(RecordView record, std::size_t base, std::span<const Field> fields, const DictionaryRef& lookup) {
    Value value;
    for (const Field& field : fields) {
        showValue(value, record.read(base + field.at, field.raw), field.shown);
        C2KStoreDisplayValue(field.key, value, lookup);
    }
}

void C2KStoreNotAvailable(std::span<const Field> fields, const DictionaryRef& lookup) {
    const Value notAvailable = "N/A";
    for (const Field& field : fields) C2KStoreDisplayValue(field.key, notAvailable, lookup);
}

}  // namespace kelvo
