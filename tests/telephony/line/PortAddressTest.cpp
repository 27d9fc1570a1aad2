#include "telephony/line/PortAddress.h"

#include <gtest/gtest.h>

namespace kelvo {

TEST(PortAddress, IsAutoAPathATcpPortOrAUnixSocket) {
    EXPECT_EQ(*PortAddress::parse("auto", false), PortAddress{PortAddress::Automatic{}});
    EXPECT_EQ(*PortAddress::parse("/dev/ttyUSB2", false), PortAddress{PortAddress::Node{"/dev/ttyUSB2"}});
    EXPECT_EQ(*PortAddress::parse("unix:/run/router", false), PortAddress{PortAddress::Unix{"/run/router"}});
    EXPECT_EQ(*PortAddress::parse("tcp:localhost:2500", false), (PortAddress{PortAddress::Tcp{"localhost", 2500}}));
    EXPECT_EQ(*PortAddress::parse("tcp:127.0.0.1:65535", false), (PortAddress{PortAddress::Tcp{"127.0.0.1", 65535}}));
    EXPECT_EQ(*PortAddress::parse("tcp:127.8.9.1:1", false), (PortAddress{PortAddress::Tcp{"127.8.9.1", 1}}));
    EXPECT_EQ(*PortAddress::parse("tcp:[::1]:2500", false), (PortAddress{PortAddress::Tcp{"::1", 2500}}));
}

TEST(PortAddress, LeadsToOtherMachinesOnlyWhenThatIsAllowed) {
    for (const char* other : {"tcp:192.168.1.2:2500", "tcp:example.org:2500", "tcp:[fe80::1]:2500",
                              "tcp:127.0.0.1.example.org:2500", "tcp:0.0.0.0:2500"}) {
        const auto refused = PortAddress::parse(other, false);
        ASSERT_FALSE(refused) << other;
        EXPECT_NE(refused.error().reason.find("is not this machine"), std::string::npos);
        EXPECT_TRUE(PortAddress::parse(other, true));
    }
}

TEST(PortAddress, RefusesWhatIsNone) {
    for (const char* bad : {"", "unix:", "tcp:", "tcp:localhost", "tcp:localhost:", "tcp::2500", "tcp:localhost:0",
                            "tcp:localhost:65536", "tcp:localhost:-1", "tcp:localhost:x"})
        EXPECT_FALSE(PortAddress::parse(bad, true)) << bad;
}

TEST(PortAddress, IsDescribed) {
    EXPECT_EQ(PortAddress::parse("auto", false)->description(), "the modem that is plugged in");
    EXPECT_EQ(PortAddress::parse("/dev/x", false)->description(), "the modem at /dev/x");
    EXPECT_EQ(PortAddress::parse("tcp:localhost:1", false)->description(), "the modem at tcp:localhost:1");
    EXPECT_EQ(PortAddress::parse("unix:/x", false)->description(), "the modem at unix:/x");
}

}  // namespace kelvo
