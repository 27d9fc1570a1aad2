#pragma once

#include <exception>

namespace kelvo {

/// An entry was asked for that the record's own count does not cover. The decoding loops never do; nothing catches it.
class ArrayOutOfBoundsException : public std::exception {};

}  // namespace kelvo
