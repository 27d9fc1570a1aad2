#include "tools/doctor/PortHolders.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <fstream>

#include "tests/support/TemporaryDirectory.h"

namespace kelvo {
namespace {

namespace fs = std::filesystem;

/// A directory of processes that the test makes up.
class PortHoldersTest : public testing::Test {
protected:
    void add(const std::string& number, const std::string& name, const std::vector<std::string>& files) {
        const fs::path process = _directory.path() / "proc" / number;
        fs::create_directories(process / "fd");
        std::ofstream(process / "comm") << name << '\n';
        for (std::size_t i = 0; i < files.size(); ++i) fs::create_symlink(files[i], process / "fd" / std::to_string(i));
    }
    PortHolders look() const { return holdersOf(port, _directory.path() / "proc"); }

    test::TemporaryDirectory _directory;
    const std::string port = _directory.write("ttyUSB7", {});
};

TEST_F(PortHoldersTest, AreTheProcessesThatHaveThePortOpen) {
    add("812", "ModemManager", {"/dev/null", port, "socket:[77]"});
    add("33", "reader", {port});
    add("34", "another", {"/dev/null"});
    add("self", "no process", {port});
    const PortHolders holders = look();
    ASSERT_EQ(holders.known.size(), 2U);
    EXPECT_EQ(holders.known[0].process, 33);
    EXPECT_EQ(holders.known[0].name, "reader");
    EXPECT_EQ(holders.known[1].process, 812);
    EXPECT_EQ(holders.known[1].name, "ModemManager");
    EXPECT_FALSE(holders.someHidden);
}

TEST_F(PortHoldersTest, HaveTheirWholeNames) {
    add("33", "kelvo-telephony", {port});
    std::ofstream(_directory.path() / "proc/33/cmdline") << "/usr/bin/kelvo-telephonyd" << '\0' << "--port" << '\0';
    add("34", "renamed", {port});
    std::ofstream(_directory.path() / "proc/34/cmdline") << "/usr/bin/python3" << '\0';
    const PortHolders holders = look();
    ASSERT_EQ(holders.known.size(), 2U);
    EXPECT_EQ(holders.known[0].name, "kelvo-telephonyd");
    EXPECT_EQ(holders.known[1].name, "renamed");
}

TEST_F(PortHoldersTest, OfALinkAreThoseOfWhatItLeadsTo) {
    const fs::path link = _directory.path() / "modem";
    fs::create_symlink(port, link);
    add("33", "reader", {port});
    EXPECT_EQ(holdersOf(link, _directory.path() / "proc").known.size(), 1U);
}

TEST_F(PortHoldersTest, DoNotCountWhoeverAsks) {
    add(std::to_string(::getpid()), "me", {port});
    EXPECT_TRUE(look().known.empty());
}

TEST_F(PortHoldersTest, MayBeHiddenInProcessesOfOthers) {
    if (::geteuid() == 0) GTEST_SKIP() << "nothing is hidden from root";
    add("33", "other", {port});
    fs::permissions(_directory.path() / "proc/33/fd", fs::perms::none);
    EXPECT_TRUE(look().someHidden);
    fs::permissions(_directory.path() / "proc/33/fd", fs::perms::owner_all);
}

TEST_F(PortHoldersTest, AreNobodyWhereThereAreNoProcesses) {
    EXPECT_TRUE(look().known.empty());
    EXPECT_FALSE(look().someHidden);
}

}  // namespace
}  // namespace kelvo
