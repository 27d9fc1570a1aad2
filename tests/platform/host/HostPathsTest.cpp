#include "platform/host/HostPaths.h"

#include <gtest/gtest.h>

#include <QCoreApplication>
#include <cstdlib>

namespace kelvo {
namespace {

TEST(HostPaths, FindResourcesBesideTheProgram) {
    const std::filesystem::path programs = QCoreApplication::applicationDirPath().toStdString();
    EXPECT_EQ(HostPaths::resourcesDirectory(), programs.parent_path() / "share/kelvo");
}

TEST(HostPaths, FindTheConfigurationWhereTheUserHasIt) {
    ::setenv("XDG_CONFIG_HOME", "/somewhere/else", 1);
    EXPECT_EQ(HostPaths::configDirectory(), "/somewhere/else");
    ::unsetenv("XDG_CONFIG_HOME");
    ::setenv("HOME", "/home/of/somebody", 1);
    EXPECT_EQ(HostPaths::configDirectory(), "/home/of/somebody/.config");
}

}  // namespace
}  // namespace kelvo
