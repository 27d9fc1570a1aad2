#pragma once

#include <stdexcept>
#include <string>
#include <utility>

#include "platform/values/Result.h"

namespace kelvo {

/// Ends a command: main tells the reason in one line on standard error and exits with status 1.
class CommandFailure : public std::runtime_error {
public:
    explicit CommandFailure(const std::string& reason) : std::runtime_error(reason) {}
    explicit CommandFailure(const Failure& failure) : CommandFailure(failure.reason) {}
};

/// The value of a result whose failure ends the command.
template <class T>
T orFail(Result<T> result) {
    if (!result) throw CommandFailure(result.error());
    return std::move(result).value();
}

/// The same for what gives nothing.
inline void orFail(const Result<void>& result) {
    if (!result) throw CommandFailure(result.error());
}

/// What the exception being handled says of itself, or its type's name when it says nothing. Only in a catch block.
std::string currentExceptionText();

}  // namespace kelvo
