#pragma once

#include <stdexcept>
#include <string_view>

namespace kelvo {

/// Something that must hold does not, and the program cannot go on: nothing in the decoders or the model catches it.
/// `what()` is one line for a person, with the operation, the source, its line and the description; it is written to
/// the system log at error level when the failure is made.
class AssertionFailure : public std::logic_error {
public:
    AssertionFailure(std::string_view method, std::string_view source, int line, std::string_view description);
};

}  // namespace kelvo
