#pragma once

#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <map>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "platform/values/Key.h"
#include "platform/values/Value.h"

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
    const Value* find(const Key& key) const;
    /// The value under `key`, a none value when there is none; for reading through in one expression.
    const Value& operator[](const Key& key) const;
    /// The value under `key` for writing; a key that is not there yet is appended with a none value. Records write the
    /// same keys in the same order over and over: the position behind the last one written is looked at first.
    Value& slot(const Key& key) {
        const std::size_t at = _next < _hashes.size() ? _next : 0;
        if (at == _hashes.size() || !isAt(at, key)) return slotElsewhere(key);
        _next = at + 1;
        return _entries[at].value;
    }
    /// Sets the value under `key`; a key that is there keeps its place, another is appended.
    void set(const Key& key, Value value) { slot(key) = std::move(value); }
    /// Calls `visit` with every value, in order, for writing.
    template <class Visit>
    void forEachValue(Visit visit) {
        for (Entry& entry : _entries) visit(entry.value);
    }
    /// Removes `key` and keeps the order of the others; false when it was not there.
    bool remove(const Key& key);
    void reserve(std::size_t entries);

    DictionaryRef copy() const;  ///< deep
    friend bool operator==(const Dictionary& a, const Dictionary& b);

    class Rewrite;

private:
    static const Value kNone;
    static constexpr std::size_t kNotFound = static_cast<std::size_t>(-1);
    static constexpr std::size_t kScanLimit = 64;  ///< up to here comparing hashes in a row beats any index

    bool isAt(std::size_t index, const Key& key) const {
        return _hashes[index] == key.hash() && isSameText(_entries[index].key, key.text());
    }
    std::size_t indexOf(const Key& key) const;
    std::size_t indexOfIndexed(const Key& key) const;
    Value& slotElsewhere(const Key& key);
    Value& append(const Key& key);
    void truncate(std::size_t size) {
        if (size < _hashes.size()) eraseFrom(size);
    }
    void eraseFrom(std::size_t index);
    void buildIndex();

    std::vector<Entry> _entries;
    std::vector<std::uint32_t> _hashes;  // of the entries' keys, side by side
    std::size_t _next = 0;               // behind the entry that `slot` handed out last; may lie past the end
    // Key to position, once past kScanLimit; ordered, because keys can be chosen so that their hashes are all the same.
    using Index = std::map<std::string, std::size_t, std::less<>>;
    std::unique_ptr<Index> _index;
};

/// Writes a dictionary anew, from its first entry to its last. Entries that come again in their old places keep their
/// storage; what was not written is gone when the object goes. No key is written twice.
class Dictionary::Rewrite {
public:
    explicit Rewrite(Dictionary& dictionary) : _dictionary(dictionary) {}
    ~Rewrite() { _dictionary.truncate(_written); }
    Rewrite(const Rewrite&) = delete;
    Rewrite& operator=(const Rewrite&) = delete;

    /// The value under `key`, behind those written so far; it holds what it held before, or none.
    Value& next(const Key& key) {
        const std::size_t at = _written++;
        if (at < _dictionary._hashes.size() && _dictionary.isAt(at, key)) return _dictionary._entries[at].value;
        _dictionary.truncate(at);
        return _dictionary.append(key);
    }

private:
    Dictionary& _dictionary;
    std::size_t _written = 0;
};

}  // namespace kelvo
