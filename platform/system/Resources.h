#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "platform/values/Result.h"
#include "platform/values/Value.h"

namespace kelvo {

/// The files that belong to the application: display templates, icons, captures.
class Resources {
public:
    virtual ~Resources() = default;

    /// The resource `name` of type "plist" as a dictionary. The error says what was missing or wrong.
    virtual Result<DictionaryRef> dictionary(std::string_view name) const = 0;

    /// Paths of all resources of `type` (a file extension without its dot), in the order of the listing.
    virtual std::vector<std::string> pathsOfType(std::string_view type) const = 0;
};

}  // namespace kelvo
