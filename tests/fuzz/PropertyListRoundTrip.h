#pragma once

#include <cstdio>
#include <cstdlib>
#include <string_view>

#include "platform/encodings/PropertyList.h"

namespace kelvo::fuzz {

inline void require(bool condition, const char* what) {
    if (condition) return;
    std::fprintf(stderr, "%s\n", what);
    std::abort();
}

inline Value mustRead(const Bytes& document) {
    Result<Value> value = readPropertyList(document);
    require(static_cast<bool>(value), "what was written does not read back");
    return std::move(value).value();
}

inline Bytes mustWrite(const Value& value) {
    Result<Bytes> document = writeXmlPropertyList(value);
    require(static_cast<bool>(document), "what was read cannot be written");
    return std::move(document).value();
}

/// Characters that XML cannot carry may make two keys one, which only then changes the document once more.
inline bool hasReplacements(const Bytes& document) {
    return textOf(document).find("\xEF\xBF\xBD") != std::string_view::npos;
}

/// Any bytes may be refused, in one line. What is read can be written, and what was written reads back as the same
/// document.
inline void checkRoundTrip(const Result<Value>& value) {
    if (!value) return require(value.error().reason.find('\n') == std::string::npos, "a reason of more than one line");
    require(static_cast<bool>(*value), "a none value was read");
    const Bytes document = mustWrite(*value);
    const Bytes again = mustWrite(mustRead(document));
    require(document == again || hasReplacements(document), "what was written reads back as something else");
}

}  // namespace kelvo::fuzz
