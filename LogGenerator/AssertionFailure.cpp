#include "LogGenerator/AssertionFailure.h"

#include "platform/system/Environment.h"

namespace kelvo {

AssertionFailure::AssertionFailure(std::string_view method, std::string_view source, int line,
                                   std::string_view description)
    : std::logic_error(fmt::format("Assertion failure in {}, {}:{}: {}", method, source, line, description)) {
    logLine(Level::Error, what());
}

}  // namespace kelvo
