#pragma once

#include <memory>

#include "LogGenerator/LogGenerator.h"
#include "platform/system/Environment.h"
#include "platform/telephony/Technology.h"
#include "platform/values/Dictionary.h"

namespace kelvo {

/// A family's decoder for records that are read from files: it keeps no raw records, and as long as it lives nothing is
/// logged.
class QuietDecoder {
public:
    explicit QuietDecoder(Technology technology);

    LogGenerator& generator() const { return *_generator; }
    Dictionary& state() const { return *_state; }
    const Value& display() const { return (*_state)["Display"]; }

private:
    Environment::Scope _silence;
    std::unique_ptr<LogGenerator> _generator;
    DictionaryRef _state;
};

}  // namespace kelvo
