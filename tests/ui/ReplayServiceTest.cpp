#include "ui/ReplayService.h"

#include <gtest/gtest.h>

#include "platform/host/HostMessagePorts.h"
#include "platform/host/HostTelephonyClient.h"
#include "tests/support/TemporaryDirectory.h"

namespace kelvo {
namespace {

TEST(ReplayService, ServesTheCaptureAndEndsWithItsOwner) {
    auto started = ReplayService::start(KELVO_TELEPHONYD, KELVO_CAPTURES "/gsm.pcap");
    ASSERT_TRUE(started) << started.error().reason;
    const std::filesystem::path directory = (*started)->portDirectory();
    HostMessagePorts ports(directory);
    HostTelephonyClient client(ports);
    EXPECT_TRUE(client.createServerConnection({}));
    std::move(started).value().reset();
    EXPECT_FALSE(std::filesystem::exists(directory));
}

TEST(ReplayService, SaysInOneLineWhyACaptureIsNotReplayed) {
    const test::TemporaryDirectory temporary;
    const std::string path = temporary.write("notes.pcap", bytesOf("no capture"));
    const auto started = ReplayService::start(KELVO_TELEPHONYD, path);
    ASSERT_FALSE(started);
    EXPECT_EQ(started.error().reason.rfind(path + " is not a pcap file: ", 0), 0U) << started.error().reason;
    EXPECT_EQ(started.error().reason.find('\n'), std::string::npos);
}

TEST(ReplayService, SaysThatTheServiceIsNotInstalled) {
    const auto started = ReplayService::start("/nowhere/kelvo-telephonyd", "drive.pcap");
    ASSERT_FALSE(started);
    EXPECT_EQ(started.error().reason.rfind("drive.pcap: it takes kelvo-telephonyd to replay a capture: ", 0), 0U)
        << started.error().reason;
}

}  // namespace
}  // namespace kelvo
