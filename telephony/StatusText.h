#pragma once

#include <string>

#include "platform/values/Result.h"
#include "platform/values/Value.h"

namespace kelvo {

/// The service's answer to "GetStatus" for people, with a newline at the end; a failure when it is no such answer.
Result<std::string> statusText(const Value& answer);

/// The same for programs: the answer as one JSON object, its entries as they are.
Result<std::string> statusJson(const Value& answer);

}  // namespace kelvo
