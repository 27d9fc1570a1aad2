#pragma once

#include <cstddef>

#include "LogGenerator/ArrayLock.h"
#include "platform/values/Array.h"
#include "platform/values/Dictionary.h"

namespace kelvo {

/// Rewrites the rows of a list under ArrayLock: for as long as it lives, so that readers see the rows before or the
/// rows after. A row that nobody else holds is written over where it stands; the rows that were not written again are
/// gone with the writer.
class RowWriter {
public:
    /// A null list is ignored: its rows go nowhere.
    explicit RowWriter(const ArrayRef& list) : _list(list ? list : Array::make()) {}
    ~RowWriter() { _list->resize(_written); }
    RowWriter(const RowWriter&) = delete;
    RowWriter& operator=(const RowWriter&) = delete;

    /// The next row, to be written from its first entry on.
    Dictionary::Rewrite next();

private:
    const ArrayLock::Held _held;
    const ArrayRef _list;
    std::size_t _written = 0;
};

/// The array in `value` to be written over: the one that is there, or a new one when it is none or somebody else holds
/// it.
const ArrayRef& ownArray(Value& value);

}  // namespace kelvo
