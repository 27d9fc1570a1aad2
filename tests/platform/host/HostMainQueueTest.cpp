#include "platform/host/HostMainQueue.h"

#include <gtest/gtest.h>

#include <vector>

#include "tests/support/EventLoop.h"

using namespace std::chrono_literals;
using kelvo::HostMainQueue;
using kelvo::RepeatingTimer;
using kelvo::test::runUntil;
using kelvo::test::settle;

TEST(HostMainQueue, RunsPostedTasksInOrderAfterTheCurrentOne) {
    HostMainQueue queue;
    std::vector<int> ran;
    queue.post([&] {
        queue.post([&] { ran.push_back(3); });
        ran.push_back(1);
    });
    queue.post([&] { ran.push_back(2); });
    EXPECT_TRUE(ran.empty());
    ASSERT_TRUE(runUntil([&] { return ran.size() == 3; }));
    EXPECT_EQ(ran, (std::vector<int>{1, 2, 3}));
}

TEST(HostMainQueue, RunsADelayedTaskOnceAndNotBeforeItsTime) {
    HostMainQueue queue;
    int ran = 0;
    const auto begin = std::chrono::steady_clock::now();
    queue.postAfter(20ms, [&] { ++ran; });
    ASSERT_TRUE(runUntil([&] { return ran > 0; }));
    EXPECT_GE(std::chrono::steady_clock::now() - begin, 19ms);
    bool later = false;
    queue.postAfter(30ms, [&] { later = true; });
    ASSERT_TRUE(runUntil([&] { return later; }));
    EXPECT_EQ(ran, 1);
}

TEST(HostMainQueue, ForgetsItsTasksWhenItIsDestroyed) {
    bool ran = false;
    {
        HostMainQueue queue;
        queue.post([&] { ran = true; });
        queue.postAfter(0ms, [&] { ran = true; });
    }
    settle();
    EXPECT_FALSE(ran);
}

TEST(HostMainQueue, RepeatsUntilTheTimerIsDestroyed) {
    HostMainQueue queue;
    int ran = 0;
    auto timer = queue.repeat(1ms, [&] { ++ran; });
    ASSERT_TRUE(runUntil([&] { return ran >= 3; }));
    timer.reset();
    const int before = ran;
    settle();
    EXPECT_EQ(ran, before);
}

TEST(HostMainQueue, LetsATaskDestroyTheTimerThatRunsIt) {
    HostMainQueue queue;
    int ran = 0;
    std::unique_ptr<RepeatingTimer> timer;
    timer = queue.repeat(1ms, [&, kept = std::make_shared<int>(7)] {
        timer.reset();
        ran += *kept;
    });
    ASSERT_TRUE(runUntil([&] { return ran > 0; }));
    settle();
    EXPECT_EQ(ran, 7);
}

TEST(HostMainQueue, TakesDelaysBeyondWhatATimerCanCount) {
    HostMainQueue queue;
    bool ran = false;
    queue.postAfter(std::chrono::hours(24 * 365), [&] { ran = true; });
    settle();
    EXPECT_FALSE(ran);
}
