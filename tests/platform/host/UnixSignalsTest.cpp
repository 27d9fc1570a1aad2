#include "platform/host/UnixSignals.h"

#include <gtest/gtest.h>
#include <signal.h>

#include <vector>

#include "tests/support/EventLoop.h"

using kelvo::UnixSignals;
using kelvo::test::runUntil;

TEST(UnixSignals, AreDeliveredOnTheMainQueue) {
    std::vector<int> received;
    const UnixSignals handler({SIGINT, SIGTERM}, [&](int signal) { received.push_back(signal); });
    ::raise(SIGTERM);
    ::raise(SIGINT);
    EXPECT_TRUE(received.empty());
    ASSERT_TRUE(runUntil([&] { return received.size() == 2; }));
    EXPECT_EQ(received, (std::vector<int>{SIGTERM, SIGINT}));
}

TEST(UnixSignals, DoAfterwardsWhatTheyDidBefore) {
    static volatile int before = 0;
    struct sigaction old {};
    struct sigaction counting {};
    counting.sa_handler = [](int) { before = before + 1; };
    ::sigaction(SIGUSR1, &counting, &old);
    int received = 0;
    {
        const UnixSignals handler({SIGUSR1}, [&](int) { ++received; });
        ::raise(SIGUSR1);
    }
    kelvo::test::settle();
    EXPECT_EQ(received, 0);  // nobody is there any more to be told
    ::raise(SIGUSR1);
    EXPECT_EQ(before, 1);
    ::sigaction(SIGUSR1, &old, nullptr);
}
