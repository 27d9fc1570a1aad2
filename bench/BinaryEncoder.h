#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "platform/values/Value.h"

namespace kelvo::bench {

inline void appendBigEndian(std::string& out, std::uint64_t value, int size) {
    for (int i = size - 1; i >= 0; --i) out.push_back(static_cast<char>(value >> (8 * i)));
}

/// Encodes arrays, dictionaries, integers and ASCII strings, equal strings once, as writers of the format do.
class BinaryEncoder {
public:
    Bytes encode(const Value& value) {
        const std::size_t root = add(value);
        std::string out = "bplist00";
        std::string table;
        for (const std::string& object : _objects) {
            appendBigEndian(table, out.size(), 4);
            out += object;
        }
        const std::size_t start = out.size();
        out += table + std::string(6, '\0') + "\x04\x04";
        for (std::size_t field : {_objects.size(), root, start}) appendBigEndian(out, field, 8);
        return {out.begin(), out.end()};
    }

private:
    std::size_t add(const Value& value) {
        if (value.string() != nullptr) return addString(*value.string());
        std::string object;
        if (value.number() != nullptr) {
            object = '\x13';
            appendBigEndian(object, static_cast<std::uint64_t>(value.number()->integer()), 8);
        } else if (value.array()) {
            object = header(0xA0, value.array()->size());
            for (const Value& element : *value.array()) appendBigEndian(object, add(element), 4);
        } else {
            object = header(0xD0, value.dictionary()->size());
            for (const auto& entry : *value.dictionary()) appendBigEndian(object, addString(entry.key), 4);
            for (const auto& entry : *value.dictionary()) appendBigEndian(object, add(entry.value), 4);
        }
        _objects.push_back(std::move(object));
        return _objects.size() - 1;
    }

    std::size_t addString(const std::string& text) {
        const auto [at, isNew] = _strings.try_emplace(text, _objects.size());
        if (isNew) _objects.push_back(header(0x50, text.size()) + text);
        return at->second;
    }

    static std::string header(int kind, std::size_t count) {
        if (count < 15) return {static_cast<char>(kind | static_cast<int>(count))};
        std::string out = {static_cast<char>(kind | 15), '\x12'};
        appendBigEndian(out, count, 4);
        return out;
    }

    std::vector<std::string> _objects;
    std::map<std::string, std::size_t> _strings;
};

}  // namespace kelvo::bench
