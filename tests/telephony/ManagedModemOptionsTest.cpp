#include <gtest/gtest.h>

#include <vector>

#include "telephony/ServiceOptions.h"

namespace kelvo {
namespace {

std::optional<ServiceOptions> parsed(std::vector<const char*> arguments) {
    arguments.insert(arguments.begin(), "kelvo-telephonyd");
    testing::internal::CaptureStderr();
    const auto options = parseServiceOptions(static_cast<int>(arguments.size()), arguments.data(), {}).options;
    const std::string told = testing::internal::GetCapturedStderr();
    EXPECT_EQ(std::ranges::count(told, '\n'), options ? 0 : 1) << told;
    return options;
}

TEST(ManagedModemOptions, NameAModemOrTakeTheFirst) {
    const auto first = parsed({"--modemmanager"});
    ASSERT_TRUE(first);
    EXPECT_EQ(first->modemManager, "");
    EXPECT_FALSE(first->port);
    EXPECT_EQ(parsed({"--modemmanager", "1"})->modemManager, "1");
    EXPECT_EQ(parsed({"--modemmanager=/org/freedesktop/ModemManager1/Modem/3"})->modemManager,
              "/org/freedesktop/ModemManager1/Modem/3");
    EXPECT_EQ(parsed({"--simulate", "lte"})->modemManager, std::nullopt);
}

TEST(ManagedModemOptions, StandBesideAPortAlone) {
    const auto both = parsed({"--port", "auto", "--modemmanager", "--technology", "lte"});
    ASSERT_TRUE(both);
    EXPECT_EQ(both->modemManager, "");
    EXPECT_TRUE(both->port);
    EXPECT_TRUE(parsed({"--modemmanager", "0", "--port", "/dev/ttyUSB0", "--record", "x.pcap"}));
    EXPECT_FALSE(parsed({"--modemmanager", "--simulate", "lte"}));
    EXPECT_FALSE(parsed({"--modemmanager", "--replay", "x.pcap"}));
    EXPECT_FALSE(parsed({"--modemmanager", "--status"}));
    EXPECT_FALSE(parsed({"--modemmanager", "--technology", "lte"}));
    EXPECT_FALSE(parsed({"--modemmanager", "--speed", "2"}));
    EXPECT_FALSE(parsed({"--simulate", "lte", "--port", "auto"}));
}

}  // namespace
}  // namespace kelvo
