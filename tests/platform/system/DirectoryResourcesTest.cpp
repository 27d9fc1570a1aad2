#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <string>

#include "platform/system/DirectoryResources.h"
#include "tests/support/TemporaryDirectory.h"

namespace kelvo {
namespace {

namespace fs = std::filesystem;

class DirectoryResourcesTest : public testing::Test {
protected:
    void put(std::string_view name, std::string_view content) { std::ofstream(directory / name) << content; }
    std::string path(std::string_view name) const { return (directory / name).string(); }
    std::string reason(std::string_view name) const {
        const auto result = DirectoryResources(directory).dictionary(name);
        return result ? "(was read)" : result.error().reason;
    }

    const test::TemporaryDirectory temporary;
    const fs::path directory = temporary.path();
};

TEST_F(DirectoryResourcesTest, LoadsADictionaryByItsName) {
    put("LTE.plist", "<plist version=\"1.0\"><dict><key>a</key><integer>1</integer></dict></plist>");
    const auto result = DirectoryResources(directory).dictionary("LTE");
    ASSERT_TRUE(result) << result.error().reason;
    EXPECT_EQ(**result, *Dictionary::make({{"a", 1}}));
}

TEST_F(DirectoryResourcesTest, SaysWhatIsMissing) { EXPECT_EQ(reason("LTE"), "no resource " + path("LTE.plist")); }

TEST_F(DirectoryResourcesTest, SaysWhatIsBroken) {
    put("LTE.plist", "<dict><key>a</key></dict>");
    EXPECT_EQ(reason("LTE"), path("LTE.plist") + ": key without a value at offset 7");
}

TEST_F(DirectoryResourcesTest, SaysWhatIsNoDictionary) {
    put("LTE.plist", "<array/>");
    EXPECT_EQ(reason("LTE"), path("LTE.plist") + ": not a dictionary");
}

TEST_F(DirectoryResourcesTest, RefusesADirectoryInPlaceOfAFile) {
    fs::create_directory(directory / "LTE.plist");
    EXPECT_EQ(reason("LTE"), "no resource " + path("LTE.plist"));
}

TEST_F(DirectoryResourcesTest, ListsPathsOfOneTypeSortedByName) {
    for (const char* name : {"b.plist", "a.plist", "C.plist", "a.png", "plist", ".plist", "a.plist.bak"}) put(name, "");
    EXPECT_EQ(DirectoryResources(directory).pathsOfType("plist"),
              (std::vector<std::string>{path("C.plist"), path("a.plist"), path("b.plist")}));
}

TEST_F(DirectoryResourcesTest, ListsNothingOfAMissingDirectory) {
    EXPECT_TRUE(DirectoryResources(directory / "none").pathsOfType("plist").empty());
}

}  // namespace
}  // namespace kelvo
