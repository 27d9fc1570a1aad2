#pragma once

#include <span>

#include "LogGenerator/RecordView.h"
#include "LogGenerator/ShowFields.h"
#include "platform/values/Dictionary.h"

/// How a decoded value reaches the screens. A lookup maps lookup keys to arrays of bindings; a binding is a dictionary
/// with "dict", the live display dictionary itself, and "key", the display key in it. A null lookup shows nothing.
namespace kelvo {

/// Shows one value at every place that is bound to `lookupKey`; a key that the template does not use is dropped.
/// A malformed binding ends the call: the places before it have the new value, those behind it keep theirs.
void C2KStoreDisplayValue(Key lookupKey, const Value& value, const DictionaryRef& lookup);

/// Shows the fields of a layout in their order; their keys are lookup keys. `base` is the offset from which theirs
/// count.
void C2KStoreFields(RecordView record, std::size_t base, std::span<const Field> fields, const DictionaryRef& lookup);

/// Shows "N/A" for every field of a layout, without a look at the record.
void C2KStoreNotAvailable(std::span<const Field> fields, const DictionaryRef& lookup);

}  // namespace kelvo
