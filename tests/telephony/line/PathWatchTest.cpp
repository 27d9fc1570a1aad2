#include "telephony/line/PathWatch.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include "tests/support/EventLoop.h"
#include "tests/support/TemporaryDirectory.h"

namespace kelvo {

TEST(PathWatch, TellsWhenANodeHasCome) {
    const test::TemporaryDirectory directory;
    int changes = 0;
    const PathWatch watch(directory.path() / "modem", [&] { ++changes; });
    std::ofstream(directory.path() / "modem") << "x";
    EXPECT_TRUE(test::runUntil([&] { return changes > 0; }));
}

TEST(PathWatch, TellsWhenADirectoryOnTheWayHasCome) {
    const test::TemporaryDirectory directory;
    int changes = 0;
    const PathWatch watch(directory.path() / "by-id/modem", [&] { ++changes; });
    std::filesystem::create_directory(directory.path() / "by-id");
    EXPECT_TRUE(test::runUntil([&] { return changes > 0; }));
}

}  // namespace kelvo
