#include "platform/values/Result.h"

#include <gtest/gtest.h>

#include <memory>

namespace kelvo {
namespace {

TEST(Result, HoldsTheValueThatWasAskedFor) {
    Result<std::unique_ptr<int>> made = std::make_unique<int>(7);
    ASSERT_TRUE(made);
    EXPECT_EQ(**made, 7);
    const std::unique_ptr<int> taken = std::move(made).value();
    EXPECT_EQ(*taken, 7);
}

TEST(Result, HoldsWhyThereIsNone) {
    const Result<int> failed = Failure{"no such file"};
    ASSERT_FALSE(failed);
    EXPECT_EQ(failed.error().reason, "no such file");
}

TEST(Result, OfNothingSaysThatItWentWell) {
    const auto work = []() -> Result<void> { return {}; };
    EXPECT_TRUE(work());
}

TEST(Result, OfNothingSaysWhyItDidNotGoWell) {
    const auto work = []() -> Result<void> { return Failure{"disk full"}; };
    const Result<void> failed = work();
    ASSERT_FALSE(failed);
    EXPECT_EQ(failed.error().reason, "disk full");
}

TEST(Result, TellsTheKindOfAFailureWhereTheCallerActsUponIt) {
    enum class Refusal { Taken, Failed };
    const Result<void, Refusal> failed = Refusal::Failed;
    ASSERT_FALSE(failed);
    EXPECT_EQ(failed.error(), Refusal::Failed);
}

}  // namespace
}  // namespace kelvo
