#include "tools/CommandFailure.h"

#include <gtest/gtest.h>

#include "LogGenerator/ArrayOutOfBoundsException.h"
#include "LogGenerator/UnknownDataException.h"

namespace kelvo {
namespace {

template <class Exception>
std::string told(const Exception& exception) {
    try {
        throw exception;
    } catch (...) {
        return currentExceptionText();
    }
}

TEST(CommandFailure, TellsWhatAnExceptionSays) {
    EXPECT_EQ(told(std::invalid_argument("Unknown object of type number encountered")),
              "Unknown object of type number encountered");
    EXPECT_EQ(told(CommandFailure("reason")), "reason");
}

TEST(CommandFailure, NamesAnExceptionThatSaysNothing) {
    EXPECT_EQ(told(ArrayOutOfBoundsException()), "kelvo::ArrayOutOfBoundsException");
    EXPECT_EQ(told(LogCode_0xFF0000::UnknownDataException()), "kelvo::LogCode_0xFF0000::UnknownDataException");
    EXPECT_EQ(told(std::runtime_error("")), "std::runtime_error");
}

}  // namespace
}  // namespace kelvo
