#pragma once

#include <string_view>

#include "platform/values/Result.h"
#include "platform/values/Value.h"

namespace kelvo {

/// Reads an XML property list, in UTF-8 without byte-order mark or NUL. A document type is skipped unread, so that no
/// entity but XML's own five exists; a document that uses another one fails. The root may be <plist> around one value
/// or the value itself.
Result<Value> readXmlPropertyList(std::string_view text);

}  // namespace kelvo
