#include "platform/host/HostTelephonyClient.h"

#include <gtest/gtest.h>

#include <thread>

#include "platform/host/HostMessagePorts.h"
#include "tests/platform/host/RawPort.h"
#include "tests/support/EventLoop.h"
#include "tests/support/TemporaryDirectory.h"

using namespace kelvo;
using test::runUntil;

namespace {

// A service that knows only sockets and answers one request.
class HostTelephonyClientTest : public testing::Test {
protected:
    void SetUp() override {
        (void)_ports.openRemote("x");  // makes the directory
        _listener = test::rawListen(_directory / "com.zorvik.TelephonyService.port");
        _connection = _client.createServerConnection([this](std::string_view notification) { _told += notification; });
        ASSERT_TRUE(_connection);
        _service = UniqueFd(::accept(_listener.get(), nullptr, nullptr));
    }
    PLLogChannel askAndAnswer(const std::string& answer) {
        std::thread service([&] {
            _request = test::rawReceive(_service);
            test::rawSend(_service, test::datagram(2, 0, 0, ++_count, answer));
        });
        const PLLogChannel channel = _connection->networkMonitorCreateLogChannel("my.port");
        service.join();
        return channel;
    }

    test::TemporaryDirectory _temporary;
    std::filesystem::path _directory = _temporary.path() / "ports";
    HostMessagePorts _ports{_directory};
    HostTelephonyClient _client{_ports};
    UniqueFd _listener;
    UniqueFd _service;
    std::optional<Bytes> _request;
    std::uint32_t _count = 0;
    std::string _told;
    std::unique_ptr<PLServerConnection> _connection;
};

}  // namespace

TEST_F(HostTelephonyClientTest, AsksWithThePortNameAndGivesTheServicesPort) {
    const PLLogChannel channel = askAndAnswer(
        "<plist version=\"1.0\"><dict><key>Error</key><integer>0</integer><key>ErrorDomain</key><integer>0</integer>"
        "<key>PortName</key><string>channel.7</string></dict></plist>");
    EXPECT_EQ(channel.error.error, 0);
    EXPECT_EQ(channel.error.domain, 0);
    EXPECT_EQ(channel.portName, "channel.7");
    const std::string request(textOf(ByteView(*_request).subspan(20)));
    EXPECT_NE(request.find("<?xml"), std::string::npos);
    EXPECT_NE(request.find("<key>CreateLogChannel</key>"), std::string::npos);
    EXPECT_NE(request.find("<string>my.port</string>"), std::string::npos);
}

TEST_F(HostTelephonyClientTest, HandsTheServicesErrorOn) {
    const PLLogChannel channel = askAndAnswer(
        "<plist version=\"1.0\"><dict><key>Error</key><integer>2</integer><key>ErrorDomain</key><integer>1</integer>"
        "</dict></plist>");
    EXPECT_EQ(channel.error.error, 2);
    EXPECT_EQ(channel.error.domain, 1);
    EXPECT_EQ(channel.portName, "");
}

TEST_F(HostTelephonyClientTest, CallsAnAnswerItCannotReadAnError) {
    for (const char* answer : {"", "garbage", "<plist version=\"1.0\"><array/></plist>",
                               "<plist version=\"1.0\"><dict><key>PortName</key><string>p</string></dict></plist>"}) {
        const PLLogChannel channel = askAndAnswer(answer);
        EXPECT_EQ(channel.error.error, 3);
        EXPECT_EQ(channel.error.domain, 2);
        EXPECT_EQ(channel.portName, "");
    }
}

TEST_F(HostTelephonyClientTest, CallsAServiceThatDoesNotAnswerAnError) {
    const PLLogChannel channel = _connection->networkMonitorCreateLogChannel("my.port");
    EXPECT_EQ(channel.error.error, 2);
    EXPECT_EQ(channel.error.domain, 2);
}

TEST_F(HostTelephonyClientTest, CallsAServiceThatEndsAnErrorAndTellsTheCallback) {
    _service.reset();
    EXPECT_EQ(_connection->networkMonitorCreateLogChannel("my.port").error.error, 1);
    EXPECT_EQ(_told, "");
    ASSERT_TRUE(runUntil([&] { return !_told.empty(); }));
    EXPECT_EQ(_told, "kPLNotificationServiceGone");
}

TEST_F(HostTelephonyClientTest, TellsNothingOnceItIsClosed) {
    _connection.reset();
    _service.reset();
    test::settle();
    EXPECT_EQ(_told, "");
}

TEST_F(HostTelephonyClientTest, GivesNoConnectionWhereNoServiceIs) {
    _listener.reset();
    EXPECT_FALSE(_client.createServerConnection({}));
}
