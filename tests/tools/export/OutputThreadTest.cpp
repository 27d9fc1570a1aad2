#include "tools/export/OutputThread.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

TEST(OutputThread, WritesEverythingInItsOrder) {
    std::string written;
    std::string expected;
    {
        OutputThread thread([&written](std::string_view text) {
            written += text;
            return Result<void>();
        });
        for (int i = 0; i < 200'000; ++i) {
            const std::string row = std::to_string(i) + "\n";
            expected += row;
            ASSERT_TRUE(thread.append(row));
        }
        ASSERT_TRUE(thread.finish());
        EXPECT_EQ(written, expected);
        ASSERT_TRUE(thread.append("more"));
    }
    EXPECT_EQ(written, expected + "more");  // what nobody waited for is written all the same
}

TEST(OutputThread, NeverDividesWhatWasHandedOverAtOnce) {
    bool isWhole = true;
    OutputThread thread([&isWhole](std::string_view text) {
        isWhole = isWhole && text.size() % 1000 == 0;
        return Result<void>();
    });
    for (int i = 0; i < 20'000; ++i) ASSERT_TRUE(thread.append(std::string(1000, 'x')));
    ASSERT_TRUE(thread.finish());
    EXPECT_TRUE(isWhole);
}

TEST(OutputThread, TellsAFailureOfTheSinkAndWritesNoMore) {
    int calls = 0;
    OutputThread thread([&calls](std::string_view) -> Result<void> {
        ++calls;
        return Failure{"the disk is full"};
    });
    static_cast<void>(thread.append("one"));
    const auto finished = thread.finish();
    ASSERT_FALSE(finished);
    EXPECT_EQ(finished.error().reason, "the disk is full");
    ASSERT_FALSE(thread.append("two"));
    EXPECT_EQ(thread.append("three").error().reason, "the disk is full");
    EXPECT_FALSE(thread.finish());
    EXPECT_EQ(calls, 1);
}

TEST(OutputThread, OneThatIsHeldUpIsNotHeldUpForeverByASinkThatFails) {
    OutputThread thread([](std::string_view) -> Result<void> { return Failure{"gone"}; });
    bool hasFailed = false;
    for (int i = 0; i < 100 && !hasFailed; ++i) hasFailed = !thread.append(std::string(1 << 20, 'x'));
    EXPECT_TRUE(hasFailed);
}

}  // namespace
}  // namespace kelvo
