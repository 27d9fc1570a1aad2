#include "model/Snapshot.h"

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
    std::string failure(const std::string& path, std::string_view text, WriteOver over = WriteOver::OwnFile) const {
        const auto failed = writeFileInPlace(path, bytesOf(text), over);
        return failed ? failed->reason : "";
    }
    static bool exists(const std::string& path) { return ::access(path.c_str(), F_OK) == 0; }

    test::TemporaryDirectory directory;
    const std::string path = directory.file("a.kelvo");
};

TEST_F(WriteFileInPlace, MakesAFileThatNobodyElseCanRead) {
    const mode_t mask = ::umask(0);
    EXPECT_EQ(failure(path, "secret"), "");
    EXPECT_EQ(failure(directory.file("b.dlf"), "secret", WriteOver::Any), "");
    ::umask(mask);
    for (const std::string& file : {path, directory.file("b.dlf")}) {
        struct stat status {};
        ASSERT_EQ(::stat(file.c_str(), &status), 0);
        EXPECT_EQ(status.st_mode & 0777, 0600u);
        EXPECT_EQ(test::contentsOf(file), "secret");
    }
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

TEST_F(WriteFileInPlace, KeepsADeviceThatIsFull) {
    EXPECT_EQ(failure("/dev/full", "text", WriteOver::Any), "No space left on device");
    EXPECT_TRUE(exists("/dev/full"));
}

TEST_F(WriteFileInPlace, FollowsNoLinkThatSomebodyLeftThere) {
    directory.write("victim", bytesOf("precious"));
    ASSERT_EQ(::symlink(directory.file("victim").c_str(), path.c_str()), 0);
    EXPECT_NE(failure(path, "snapshot"), "");
    EXPECT_EQ(test::contentsOf(directory.file("victim")), "precious");
    EXPECT_EQ(failure(path, "snapshot", WriteOver::Any), "");  // on a command line a link is what the user asked for
    EXPECT_EQ(test::contentsOf(directory.file("victim")), "snapshot");
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
