#pragma once

#include <initializer_list>
#include <string_view>
#include <utility>

#include "platform/encodings/PropertyList.h"
#include "platform/telephony/TelephonyProtocol.h"

namespace kelvo {

/// A dictionary of the service's own making, as the bytes of a reply.
inline Bytes encodeAnswer(const DictionaryRef& answer) {
    auto encoded = writeXmlPropertyList(answer);
    return encoded ? std::move(encoded).value() : Bytes{};
}
inline Bytes encodeAnswer(std::initializer_list<std::pair<std::string_view, Value>> entries) {
    return encodeAnswer(Dictionary::make(entries));
}

/// The reply that names an error of the service.
inline Bytes errorAnswer(long error) {
    return encodeAnswer({{kPLError, std::int64_t{error}}, {kPLErrorDomain, std::int64_t{kPLErrorDomainService}}});
}

}  // namespace kelvo
