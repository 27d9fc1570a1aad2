#pragma once

#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <memory>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "platform/Key.h"
#include "platform/Value.h"

namespace kelvo {

/// A shared, mutable map from string keys to values that keeps the order in which keys were first set.
/// References into it hold until a key is added or removed.
class Dictionary {
public:
    struct Entry {
        std::string key;
        Value value;
    };

    Dictionary() = default;
    Dictionary(const Dictionary&) = delete;
    Dictionary& operator=(const Dictionary&) = delete;
    static DictionaryRef make(std::initializer_list<std::pair<std::string_view, Value>> entries = {});

    std::size_t size() const { return _entries.size(); }
    bool empty() const { return _entries.empty(); }
    auto begin() const { return _entries.begin(); }  ///< entries in order
    auto end() const { return _entries.end(); }

    /// The value under `key`, null when there is none.
    const Value* find(Key key) const;
    /// The value under `key`, a none value when there is none; for reading through in one expression.
    const Value& operator[](Key key) const;
    /// The value under `key` for writing; a key that is not there yet is appended with a none value.
    Value& slot(Key key);
    /// Sets the value under `key`; a key that is there keeps its place, another is appended.
    void set(Key key, Value value) { slot(key) = std::move(value); }
    /// Removes `key` and keeps the order of the others; false when it was not there.
    bool remove(Key key);
    void clear();
    void reserve(std::size_t entries);

    DictionaryRef copy() const;  ///< deep
    friend bool operator==(const Dictionary& a, const Dictionary& b);

private:
    static constexpr std::size_t kNotFound = static_cast<std::size_t>(-1);
    static constexpr std::size_t kScanLimit = 32;     ///< up to here comparing hashes in a row beats any index
    static constexpr std::size_t kTrustLimit = 1024;  ///< from here on keys may have been made to share one hash

    std::size_t indexOf(Key key) const;
    std::uint32_t indexHash(Key key) const;
    void buildIndex();

    std::vector<Entry> _entries;
    std::vector<std::uint32_t> _hashes;  // of the entries' keys, side by side
    using Index = std::unordered_multimap<std::uint32_t, std::size_t>;
    std::unique_ptr<Index> _index;  // indexHash to position, once past kScanLimit
};

}  // namespace kelvo
