#pragma once

#include <string>

#include "platform/Result.h"
#include "platform/Value.h"

namespace kelvo {

/// The service's answer to "GetStatus" for people, with a newline at the end; a failure when it is no such answer.
Result<std::string> statusText(const Value& answer);

}  // namespace kelvo
