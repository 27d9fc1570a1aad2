#include "platform/host/PortDatagram.h"

#include <gtest/gtest.h>

#include "tests/platform/host/RawPort.h"

namespace kelvo {
namespace {

std::string problemOf(const Bytes& bytes) {
    const auto parsed = parsePortDatagram(bytes);
    return parsed ? "" : parsed.error().reason;
}

TEST(PortDatagram, IsTakenApart) {
    const Bytes bytes = test::datagram(2, 1, -7, 0x01020304, "hello");
    const auto parsed = parsePortDatagram(bytes);
    ASSERT_TRUE(parsed);
    EXPECT_EQ(parsed->header.kind, 2);
    EXPECT_EQ(parsed->header.flags, 1);
    EXPECT_EQ(parsed->header.id, -7);
    EXPECT_EQ(parsed->header.sequence, 0x01020304U);
    EXPECT_EQ(textOf(parsed->data), "hello");
    EXPECT_EQ(parsed->data.data(), bytes.data() + 20);  // not a copy
}

TEST(PortDatagram, SaysWhatIsWrongWithEveryFieldThatLies) {
    const Bytes good = test::datagram(1, 0, 0, 0, "x");
    const auto with = [&](std::size_t at, std::uint8_t byte) {
        Bytes bytes = good;
        bytes[at] = byte;
        return problemOf(bytes);
    };
    EXPECT_EQ(problemOf(good), "");
    EXPECT_EQ(problemOf({}), "it is shorter than a header");
    EXPECT_EQ(problemOf(Bytes(good.begin(), good.begin() + 19)), "it is shorter than a header");
    EXPECT_EQ(with(0, 0), "it has an unknown format");
    EXPECT_EQ(with(6, 1), "it has an unknown format");
    EXPECT_EQ(with(4, 0), "it is of unknown kind");
    EXPECT_EQ(with(4, 3), "it is of unknown kind");
    EXPECT_EQ(with(5, 2), "it has unknown flags");
    EXPECT_EQ(with(16, 0), "its length is wrong");
    EXPECT_EQ(with(19, 0xff), "its length is wrong");
}

}  // namespace
}  // namespace kelvo
