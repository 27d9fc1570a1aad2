#include "platform/system/WriteFileInPlace.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

#include "tests/support/FileSizeLimit.h"
#include "tests/support/TemporaryDirectory.h"

namespace kelvo {
namespace {

struct WriteFileInPlace : testing::Test {
    static std::string failure(const std::string& path, std::string_view text) {
        const auto written = writeFileInPlace(path, bytesOf(text));
        return written ? "" : written.error().reason;
    }
    static bool exists(const std::string& path) { return ::access(path.c_str(), F_OK) == 0; }

    test::TemporaryDirectory directory;
    const std::string path = directory.file("a.kelvo");
};

TEST_F(WriteFileInPlace, MakesAFileThatNobodyElseCanRead) {
    const mode_t mask = ::umask(0);
    EXPECT_EQ(failure(path, "secret"), "");
    ::umask(mask);
    struct stat status {};
    ASSERT_EQ(::stat(path.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777, 0600u);
    EXPECT_EQ(test::contentsOf(path), "secret");
}

TEST_F(WriteFileInPlace, LeavesNoHalfFileOnAFullDisk) {
    {
        const test::FileSizeLimit full(10);
        EXPECT_EQ(failure(path, "more than ten bytes"), "File too large");
    }
    EXPECT_FALSE(exists(path));
}

TEST_F(WriteFileInPlace, LeavesNoHalfFileInPlaceOfAnEarlierOne) {
    ASSERT_EQ(failure(path, "earlier"), "");
    {
        const test::FileSizeLimit full(10);
        EXPECT_EQ(failure(path, "more than ten bytes"), "File too large");
    }
    EXPECT_FALSE(exists(path));
}

TEST_F(WriteFileInPlace, FollowsNoLinkThatSomebodyLeftThere) {
    directory.write("victim", bytesOf("precious"));
    ASSERT_EQ(::symlink(directory.file("victim").c_str(), path.c_str()), 0);
    EXPECT_NE(failure(path, "snapshot"), "");
    EXPECT_EQ(test::contentsOf(directory.file("victim")), "precious");
}

TEST_F(WriteFileInPlace, WritesIntoNoPipeThatSomebodyLeftThere) {
    ASSERT_EQ(::mkfifo(path.c_str(), 0666), 0);
    EXPECT_EQ(failure(path, "snapshot"), std::strerror(ENXIO));  // and does not wait for a reader
}

TEST_F(WriteFileInPlace, WritesIntoNoFileOfAnotherUser) {
    if (::geteuid() != 0) GTEST_SKIP() << "only root can give a file away";
    directory.write("a.kelvo", bytesOf("mine"));
    ASSERT_EQ(::chmod(path.c_str(), 0666), 0);
    ASSERT_EQ(::chown(path.c_str(), 65534, 65534), 0);
    EXPECT_EQ(failure(path, "snapshot"), "Operation not permitted");
    EXPECT_EQ(test::contentsOf(path), "mine");
}

}  // namespace
}  // namespace kelvo
