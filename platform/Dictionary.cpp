#include "platform/Dictionary.h"

#include <algorithm>
#include <random>

namespace kelvo {

namespace {

/// A hash that nobody outside this process can foresee.
std::uint32_t secretHash(std::string_view text) {
    static const std::uint32_t kSecret = std::random_device()();
    std::uint32_t hash = kSecret;
    for (const char c : text) hash = (hash ^ static_cast<std::uint8_t>(c)) * 16777619U;
    return hash;
}

}  // namespace

DictionaryRef Dictionary::make(std::initializer_list<std::pair<std::string_view, Value>> entries) {
    auto dictionary = std::make_shared<Dictionary>();
    for (const auto& [key, value] : entries) dictionary->set(key, value);
    return dictionary;
}

std::size_t Dictionary::indexOf(Key key) const {
    if (_index) {
        const auto [first, last] = _index->equal_range(indexHash(key));
        const auto at =
            std::find_if(first, last, [&](const auto& hit) { return _entries[hit.second].key == key.text(); });
        return at != last ? at->second : kNotFound;
    }
    for (std::size_t i = 0; i < _hashes.size(); ++i) {
        if (_hashes[i] == key.hash() && _entries[i].key == key.text()) return i;
    }
    return kNotFound;
}

// Keys that share the public hash would make every look-up a walk over all of them.
std::uint32_t Dictionary::indexHash(Key key) const {
    return _entries.size() > kTrustLimit ? secretHash(key.text()) : key.hash();
}

const Value* Dictionary::find(Key key) const {
    const std::size_t index = indexOf(key);
    return index != kNotFound ? &_entries[index].value : nullptr;
}

const Value& Dictionary::operator[](Key key) const {
    static const Value kNone;
    const Value* value = find(key);
    return value != nullptr ? *value : kNone;
}

Value& Dictionary::slot(Key key) {
    if (const std::size_t index = indexOf(key); index != kNotFound) return _entries[index].value;
    _entries.push_back({std::string(key.text()), Value()});
    _hashes.push_back(key.hash());
    const std::size_t size = _entries.size();
    if (size == kScanLimit + 1 || size == kTrustLimit + 1) {
        buildIndex();
    } else if (_index) {
        _index->emplace(indexHash(key), size - 1);
    }
    return _entries.back().value;
}

bool Dictionary::remove(Key key) {
    const std::size_t index = indexOf(key);
    if (index == kNotFound) return false;
    _entries.erase(_entries.begin() + static_cast<std::ptrdiff_t>(index));
    _hashes.erase(_hashes.begin() + static_cast<std::ptrdiff_t>(index));
    if (_index) buildIndex();  // positions behind the removed entry have moved
    return true;
}

void Dictionary::clear() {
    _entries.clear();
    _hashes.clear();
    _index.reset();
}

void Dictionary::reserve(std::size_t entries) {
    _entries.reserve(entries);
    _hashes.reserve(entries);
}

void Dictionary::buildIndex() {
    _index = std::make_unique<Index>();
    _index->reserve(_entries.size());
    for (std::size_t i = 0; i < _entries.size(); ++i) _index->emplace(indexHash(_entries[i].key), i);
}

DictionaryRef Dictionary::copy() const {
    auto copy = std::make_shared<Dictionary>();
    copy->_entries.reserve(size());
    for (const auto& [key, value] : _entries) copy->_entries.push_back({key, value.copy()});
    copy->_hashes = _hashes;
    if (_index) copy->_index = std::make_unique<Index>(*_index);
    return copy;
}

bool operator==(const Dictionary& a, const Dictionary& b) {
    if (&a == &b) return true;
    return a.size() == b.size() && std::all_of(a.begin(), a.end(), [&](const Dictionary::Entry& entry) {
               const Value* other = b.find(entry.key);
               return other != nullptr && *other == entry.value;
           });
}

}  // namespace kelvo
