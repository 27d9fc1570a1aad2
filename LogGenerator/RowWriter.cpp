#include "LogGenerator/RowWriter.h"

namespace kelvo {

Dictionary::Rewrite RowWriter::next() {
    const std::size_t at = _written++;
    if (at == _list->size()) _list->append(Dictionary::make());
    Value& row = (*_list)[at];
    if (!row.dictionary() || row.dictionary().use_count() > 1) row = Dictionary::make();
    return Dictionary::Rewrite(*row.dictionary());
}

const ArrayRef& ownArray(Value& value) {
    if (!value.array() || value.array().use_count() > 1) value = Array::make();
    return value.array();
}

}  // namespace kelvo
