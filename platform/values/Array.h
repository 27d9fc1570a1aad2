#pragma once

#include <cstddef>
#include <initializer_list>
#include <vector>

#include "platform/values/Value.h"

namespace kelvo {

/// A shared, mutable, ordered list of values. An index past the end is the caller's error.
class Array {
public:
    Array() = default;
    explicit Array(std::vector<Value> elements) : _elements(std::move(elements)) {}
    static ArrayRef make(std::initializer_list<Value> elements = {}) {
        return std::make_shared<Array>(std::vector<Value>(elements));
    }

    std::size_t size() const { return _elements.size(); }
    bool empty() const { return _elements.empty(); }
    const Value& operator[](std::size_t index) const { return _elements[index]; }
    Value& operator[](std::size_t index) { return _elements[index]; }
    auto begin() const { return _elements.begin(); }
    auto end() const { return _elements.end(); }

    void append(Value value) { _elements.push_back(std::move(value)); }
    void clear() { _elements.clear(); }
    /// Removes `count` elements from the front; `count` is at most `size()`.
    void removeFirst(std::size_t count);
    /// Removes elements at the end, or appends none values, until there are `size`.
    void resize(std::size_t size) { _elements.resize(size); }

    ArrayRef copy() const;  ///< deep
    friend bool operator==(const Array& a, const Array& b);

private:
    std::vector<Value> _elements;
};

}  // namespace kelvo
