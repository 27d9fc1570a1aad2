#pragma once

#include <string_view>

#include "platform/values/Value.h"

namespace kelvo {

/// Preferences of applications: one named store per application domain.
class Preferences {
public:
    virtual ~Preferences() = default;

    /// Sets `key` in the store of `domain` and writes the store out before it returns. False, after one log line, when
    /// it could not be written.
    virtual bool set(std::string_view domain, std::string_view key, const Value& value) = 0;

    /// Tells every process of the user that `key` in `domain` has changed.
    virtual void broadcastChange(std::string_view domain, std::string_view key) = 0;
};

}  // namespace kelvo
