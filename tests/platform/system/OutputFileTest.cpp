#include "platform/system/OutputFile.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>

#include "tests/support/FileSizeLimit.h"
#include "tests/support/TemporaryDirectory.h"

namespace kelvo {
namespace {

using test::contentsOf;

struct OutputFileTest : testing::Test {
    /// Why `text` could not be written to `path`; nothing when it was.
    static std::string failure(const std::string& path, std::string_view text, OutputTerms terms = {}) {
        const auto written = writeFile(path, bytesOf(text), std::move(terms));
        return written ? "" : written.error().reason;
    }
    std::size_t files() const {
        return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(directory.path()), {}));
    }

    test::TemporaryDirectory directory;
    const std::string path = directory.file("out");
};

TEST_F(OutputFileTest, AppearsWholeForTheUserAlone) {
    const mode_t mask = ::umask(0);
    auto file = OutputFile::create(path);
    ASSERT_TRUE(file);
    EXPECT_EQ(files(), 0U);
    EXPECT_TRUE(file->write(bytesOf("one ")));
    EXPECT_TRUE(file->write(bytesOf("two")));
    EXPECT_FALSE(std::filesystem::exists(path));
    EXPECT_TRUE(file->appear());
    EXPECT_TRUE(file->appear());
    ::umask(mask);
    EXPECT_EQ(contentsOf(path), "one two");
    EXPECT_EQ(files(), 1U);
    EXPECT_EQ(std::filesystem::status(path).permissions(), std::filesystem::perms(0600));
    EXPECT_TRUE(file->write(bytesOf(" three")));
    EXPECT_EQ(contentsOf(path), "one two three");
}

TEST_F(OutputFileTest, LeavesNothingWhenItDoesNotAppear) {
    {
        auto file = OutputFile::create(path);
        EXPECT_TRUE(file->write(bytesOf("half")));
        EXPECT_EQ(files(), 1U);
    }
    EXPECT_EQ(files(), 0U);
}

TEST_F(OutputFileTest, ReplacesNoFileUnlessTold) {
    directory.write("out", bytesOf("precious"));
    EXPECT_EQ(failure(path, "new"), path + " exists already; --force replaces it");
    EXPECT_EQ(contentsOf(path), "precious");
    EXPECT_EQ(failure(path, "new", {.replace = true}), "");
    EXPECT_EQ(contentsOf(path), "new");
    EXPECT_EQ(files(), 1U);
}

TEST_F(OutputFileTest, ReplacesNoFileThatCameMeanwhile) {
    auto file = OutputFile::create(path);
    ASSERT_TRUE(file);
    EXPECT_TRUE(file->write(bytesOf("new")));
    directory.write("out", bytesOf("precious"));
    const auto appeared = file->appear();
    ASSERT_FALSE(appeared);
    EXPECT_EQ(appeared.error().reason, path + " exists already; --force replaces it");
    EXPECT_EQ(contentsOf(path), "precious");
}

TEST_F(OutputFileTest, KeepsTheEarlierFileWhenTheDiskIsFull) {
    directory.write("out", bytesOf("precious"));
    {
        const test::FileSizeLimit full(10);
        EXPECT_EQ(failure(path, "more than ten bytes", {.replace = true}), path + " cannot be written: File too large");
    }
    EXPECT_EQ(contentsOf(path), "precious");
    EXPECT_EQ(files(), 1U);
}

TEST_F(OutputFileTest, NeverReplacesAFileThatIsBeingReadUnderAnyOfItsNames) {
    const std::string read = directory.write("in", bytesOf("precious"));
    const std::string hard = directory.file("hard");
    const std::string soft = directory.file("soft");
    ASSERT_EQ(::link(read.c_str(), hard.c_str()), 0);
    ASSERT_EQ(::symlink("in", soft.c_str()), 0);
    for (const std::string& name : {read, directory.file("./in"), hard, soft}) {
        EXPECT_EQ(failure(name, "new", {.replace = true, .beingRead = {read}}), name + " is the file being read");
    }
    EXPECT_EQ(contentsOf(read), "precious");
    EXPECT_EQ(files(), 3U);
}

TEST_F(OutputFileTest, ALinkStaysAndWhatItLeadsToIsReplaced) {
    std::filesystem::create_directory(directory.file("elsewhere"));
    const std::string target = directory.write("elsewhere/target", bytesOf("old"));
    ASSERT_EQ(::symlink("elsewhere/target", path.c_str()), 0);
    EXPECT_EQ(failure(path, "new"), path + " exists already; --force replaces it");
    EXPECT_EQ(failure(path, "new", {.replace = true}), "");
    EXPECT_TRUE(std::filesystem::is_symlink(path));
    EXPECT_EQ(contentsOf(target), "new");
}

TEST_F(OutputFileTest, ALinkToNothingIsNoPlaceForANewFile) {
    ASSERT_EQ(::symlink("nowhere", path.c_str()), 0);
    EXPECT_EQ(failure(path, "new"), path + " exists already; --force replaces it");
    EXPECT_FALSE(std::filesystem::exists(directory.file("nowhere")));
}

TEST_F(OutputFileTest, WritesToADeviceAsItIs) {
    EXPECT_EQ(failure("/dev/null", "text"), "");
    EXPECT_EQ(failure("/dev/full", "text"), "/dev/full cannot be written: No space left on device");
    EXPECT_TRUE(std::filesystem::is_character_file("/dev/full"));
}

TEST_F(OutputFileTest, RefusesAtOnceWhatCannotBeMade) {
    const std::string inNoDirectory = directory.file("none/out");
    EXPECT_EQ(OutputFile::create(inNoDirectory).error().reason,
              inNoDirectory + " cannot be written: No such file or directory");
    const std::string itself = directory.path();
    EXPECT_EQ(OutputFile::create(itself, {.replace = true}).error().reason,
              itself + " cannot be written: Is a directory");
}

TEST_F(OutputFileTest, TakesANameAsLongAsNamesMayBe) {
    const std::string longest = directory.file(std::string(255, 'x'));
    EXPECT_EQ(failure(longest, "text"), "");
    EXPECT_EQ(contentsOf(longest), "text");
}

}  // namespace
}  // namespace kelvo
