#include "platform/values/Dictionary.h"

#include <algorithm>

namespace kelvo {

DictionaryRef Dictionary::make(std::initializer_list<std::pair<std::string_view, Value>> entries) {
    auto dictionary = std::make_shared<Dictionary>();
    for (const auto& [key, value] : entries) dictionary->set(key, value);
    return dictionary;
}

inline std::size_t Dictionary::indexOf(const Key& key) const {
    if (_index) return indexOfIndexed(key);
    for (std::size_t i = 0; i < _hashes.size(); ++i) {
        if (isAt(i, key)) return i;
    }
    return kNotFound;
}

std::size_t Dictionary::indexOfIndexed(const Key& key) const {
    const auto at = _index->find(key.text());
    return at != _index->end() ? at->second : kNotFound;
}

constinit const Value Dictionary::kNone{};

const Value* Dictionary::find(const Key& key) const {
    const std::size_t index = indexOf(key);
    return index != kNotFound ? &_entries[index].value : nullptr;
}

const Value& Dictionary::operator[](const Key& key) const {
    const std::size_t index = indexOf(key);
    return index != kNotFound ? _entries[index].value : kNone;
}

Value& Dictionary::slotElsewhere(const Key& key) {
    const std::size_t index = indexOf(key);
    _next = (index != kNotFound ? index : _entries.size()) + 1;
    return index != kNotFound ? _entries[index].value : append(key);
}

Value& Dictionary::append(const Key& key) {
    _entries.emplace_back().key = key.text();
    _hashes.push_back(key.hash());
    if (_index) {
        _index->emplace(key.text(), _entries.size() - 1);
    } else if (_entries.size() > kScanLimit) {
        buildIndex();
    }
    return _entries.back().value;
}

bool Dictionary::remove(const Key& key) {
    const std::size_t index = indexOf(key);
    if (index == kNotFound) return false;
    if (_index) {
        _index->erase(_index->find(key.text()));
        for (auto& [text, position] : *_index) position -= position > index ? 1 : 0;
    }
    _entries.erase(_entries.begin() + static_cast<std::ptrdiff_t>(index));
    _hashes.erase(_hashes.begin() + static_cast<std::ptrdiff_t>(index));
    return true;
}

void Dictionary::eraseFrom(std::size_t index) {
    _entries.erase(_entries.begin() + static_cast<std::ptrdiff_t>(index), _entries.end());
    _hashes.resize(index);
    if (_index) buildIndex();
}

void Dictionary::reserve(std::size_t entries) {
    _entries.reserve(entries);
    _hashes.reserve(entries);
}

void Dictionary::buildIndex() {
    _index.reset();
    if (_entries.size() <= kScanLimit) return;
    _index = std::make_unique<Index>();
    for (std::size_t i = 0; i < _entries.size(); ++i) _index->emplace(_entries[i].key, i);
}

DictionaryRef Dictionary::copy() const {
    auto copy = std::make_shared<Dictionary>();
    copy->_entries = _entries;
    for (Entry& entry : copy->_entries) {
        if (entry.value.array() || entry.value.dictionary()) entry.value = entry.value.copy();
    }
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
