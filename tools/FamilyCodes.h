#pragma once

#include <optional>
#include <vector>

#include "LogGenerator/LogCode.h"
#include "platform/telephony/Technology.h"
#include "platform/values/Bytes.h"
#include "platform/values/Dictionary.h"

namespace kelvo {

/// The records that a family's generator asks the modem for, and so understands.
class FamilyCodes {
public:
    /// By the family's start command; one that names no codes takes every message.
    explicit FamilyCodes(const Dictionary& startCommand);
    static FamilyCodes of(Technology technology);

    /// Whether `message` is a record of this family.
    bool include(ByteView message) const;

private:
    std::optional<std::vector<LogCode>> _codes;  // sorted; none: every message
};

}  // namespace kelvo
