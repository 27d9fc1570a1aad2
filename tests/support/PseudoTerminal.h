#pragma once

#include <fcntl.h>
#include <gtest/gtest.h>
#include <stdlib.h>
#include <unistd.h>

#include <algorithm>
#include <string>

#include "platform/host/UniqueFd.h"
#include "platform/values/Bytes.h"

namespace kelvo::test {

/// A pseudo-terminal, of which the test holds the far end.
struct PseudoTerminal {
    PseudoTerminal() : modem(::posix_openpt(O_RDWR | O_NOCTTY | O_NONBLOCK | O_CLOEXEC)) {
        EXPECT_EQ(::grantpt(modem.get()), 0);
        EXPECT_EQ(::unlockpt(modem.get()), 0);
        path = ::ptsname(modem.get());
    }
    /// What has been written to it; nothing while nobody writes.
    Bytes read() const {
        Bytes bytes(1000);
        const ssize_t size = ::read(modem.get(), bytes.data(), bytes.size());
        bytes.resize(static_cast<std::size_t>(std::max<ssize_t>(size, 0)));
        return bytes;
    }
    bool write(ByteView bytes) const {
        return ::write(modem.get(), bytes.data(), bytes.size()) == static_cast<ssize_t>(bytes.size());
    }

    UniqueFd modem;
    std::string path;
};

}  // namespace kelvo::test
