#pragma once

#include <cstddef>

#include "LogGenerator/RecordView.h"
#include "LogGenerator/Shown.h"

/// What a layout table must keep to: a throw where a constant is made ends the compilation, with the reason in its
/// text. tests/LogGenerator/refused/ has a table for each.
namespace kelvo::check {

constexpr void field(Raw raw, const Shown& shown) {
    if (raw.lowBit + raw.width > raw.bytes * 8) throw "the bits lie beyond the number";
    if (raw.width == 32 && !raw.isSigned && shown.saysNoSign()) throw "32 bits must say whether they are signed";
}

/// `size` is that of the record or entry in which the fields lie.
template <class Field, std::size_t N>
constexpr void fields(std::size_t size, const Field (&fields)[N]) {
    for (std::size_t i = 0; i < N; ++i) {
        if (fields[i].at + fields[i].raw.bytes > size) throw "a field lies past the end";
        for (std::size_t j = 0; j < i; ++j) {
            if (fields[i].key == fields[j].key) throw "a key is used twice";
        }
    }
}

}  // namespace kelvo::check
