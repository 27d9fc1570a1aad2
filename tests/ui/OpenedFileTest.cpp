#include "ui/OpenedFile.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include "tests/support/TemporaryDirectory.h"
#include "tests/ui/SavedSample.h"

namespace kelvo {
namespace {

using test::sampleSnapshot;

class OpenedFileOf : public testing::Test {
protected:
    std::string write(const char* name, const std::string& text) { return directory.write(name, bytesOf(text)); }
    static Result<OpenedFile> open(const std::string& path) { return OpenedFile::open(path, KELVO_TELEPHONYD); }
    /// Why a file of that content cannot be shown, without the name that it begins with.
    std::string refusal(const char* name, const std::string& text) {
        const std::string path = write(name, text);
        const auto opened = open(path);
        EXPECT_FALSE(opened) << name;
        const std::string reason = opened ? path : opened.error().reason;
        EXPECT_EQ(reason.rfind(path, 0), 0U) << reason;
        EXPECT_EQ(reason.find('\n'), std::string::npos) << reason;
        return reason.substr(path.size());
    }

    test::TemporaryDirectory directory;
};

TEST_F(OpenedFileOf, ASnapshotWhateverItsNameHasItsScreens) {
    for (const char* name : {"KelvoSnapshot-1299230102.kelvo", "renamed.pcap", "without"}) {
        const auto opened = open(write(name, sampleSnapshot()));
        ASSERT_TRUE(opened) << opened.error().reason;
        ASSERT_NE(opened->screens, nullptr);
        EXPECT_EQ(opened->replay, nullptr);
        EXPECT_NE(opened->screens->topLevelNodes(), nullptr);
    }
}

TEST_F(OpenedFileOf, ACaptureWhateverItsNameIsReplayed) {
    const std::string path = write("renamed.kelvo", test::contentsOf(KELVO_CAPTURES "/cdma.pcap"));
    const auto opened = open(path);
    ASSERT_TRUE(opened) << opened.error().reason;
    EXPECT_NE(opened->replay, nullptr);
    EXPECT_EQ(opened->screens, nullptr);
}

TEST_F(OpenedFileOf, OneFileHasOneWindowAndAnotherFileAnother) {
    const std::string path = write("a.kelvo", sampleSnapshot());
    const std::string window = open(path)->window;
    EXPECT_EQ(open(directory.path().string() + "/./a.kelvo")->window, window);
    EXPECT_NE(open(write("b.kelvo", sampleSnapshot()))->window, window);
    write("a.kelvo", sampleSnapshot() + "\n");
    EXPECT_NE(open(path)->window, window);
}

TEST_F(OpenedFileOf, WhatIsNoSnapshotIsRefusedInOneLine) {
    EXPECT_EQ(refusal("empty.kelvo", ""), " is empty");
    EXPECT_EQ(refusal("notes.kelvo", "no snapshot"), " is neither a snapshot nor a capture");
    EXPECT_EQ(refusal("other.plist", "<plist version=\"1.0\"><dict><key>Name</key><string>x</string></dict></plist>"),
              " is not a snapshot: it has neither \"Timestamp\" nor \"Data\"");
    EXPECT_EQ(refusal("list.plist", "<plist version=\"1.0\"><array/></plist>"), " is not a snapshot: it holds a array");
    EXPECT_EQ(refusal("page.xml", "<?xml version=\"1.0\"?><html/>").rfind(" is not a snapshot: ", 0), 0U);
    EXPECT_EQ(refusal("notes.txt", "no capture").rfind(" is not a pcap file: ", 0), 0U);
}

TEST_F(OpenedFileOf, ACutSnapshotIsRefusedInOneLineWhereverItIsCut) {
    const std::string whole = sampleSnapshot();
    const std::size_t declaration = whole.find('\n');
    for (std::size_t length = declaration; length + 10 < whole.size(); length += 97)
        EXPECT_EQ(refusal("cut.kelvo", whole.substr(0, length)).rfind(" is not a snapshot: ", 0), 0U) << length;
}

TEST_F(OpenedFileOf, ADeepOrAHugeListIsRefusedInOneLine) {
    std::string deep = "<plist version=\"1.0\">";
    for (int i = 0; i < 100'000; ++i) deep += "<array>";
    EXPECT_EQ(refusal("deep.kelvo", deep).rfind(" is not a snapshot: ", 0), 0U);

    const std::string huge = write("huge.kelvo", "<plist version=\"1.0\">");
    ASSERT_EQ(::truncate(huge.c_str(), (off_t{1} << 30) + 1), 0);  // a hole, and not read
    EXPECT_EQ(open(huge).error().reason, huge + " is not a snapshot: larger than 1073741824 bytes");
}

TEST_F(OpenedFileOf, WhatIsNotThereIsRefusedInOneLine) {
    EXPECT_EQ(open("/nowhere/a.kelvo").error().reason, "/nowhere/a.kelvo cannot be opened: No such file or directory");
    EXPECT_EQ(open(directory.path().string()).error().reason, directory.path().string() + " is a directory");
    if (::geteuid() == 0) return;  // who may read everything
    const std::string path = write("secret.kelvo", sampleSnapshot());
    std::filesystem::permissions(path, std::filesystem::perms::none);
    EXPECT_EQ(open(path).error().reason, path + " cannot be opened: Permission denied");
}

TEST_F(OpenedFileOf, ANameThatWouldTakeTheTerminalOverIsShownWithout) {
    EXPECT_EQ(open("/nowhere/\x1b[2Ja.kelvo").error().reason,
              "/nowhere/\xEF\xBF\xBD[2Ja.kelvo cannot be opened: No such file or directory");
}

TEST(PathFromArgument, TakesWhatDesktopsHandOver) {
    EXPECT_EQ(pathFromArgument("file:///home/me/at%20the%20bridge.kelvo"), "/home/me/at the bridge.kelvo");
    EXPECT_EQ(pathFromArgument("file:///home/me/100%25.kelvo"), "/home/me/100%.kelvo");
    EXPECT_EQ(pathFromArgument("drive/a b%20c.kelvo"), "drive/a b%20c.kelvo");
    EXPECT_EQ(pathFromArgument("/home/me/file:.kelvo"), "/home/me/file:.kelvo");
    EXPECT_EQ(pathFromArgument("file://"), "file://");
}

}  // namespace
}  // namespace kelvo
