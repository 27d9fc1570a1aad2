#include "platform/values/Array.h"

#include <algorithm>

namespace kelvo {

void Array::removeFirst(std::size_t count) {
    _elements.erase(_elements.begin(), _elements.begin() + static_cast<std::ptrdiff_t>(count));
}

ArrayRef Array::copy() const {
    auto copy = std::make_shared<Array>();
    copy->_elements.reserve(size());
    for (const Value& element : _elements) copy->append(element.copy());
    return copy;
}

bool operator==(const Array& a, const Array& b) {
    return &a == &b || std::equal(a.begin(), a.end(), b.begin(), b.end());
}

}  // namespace kelvo
