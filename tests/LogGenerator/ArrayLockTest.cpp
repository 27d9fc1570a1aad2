#include "LogGenerator/ArrayLock.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>

namespace kelvo {
namespace {

TEST(ArrayLock, IsFreeForOthersOnceEveryNestedTakeIsUndone) {
    ArrayLock::lockArray();
    ArrayLock::lockArray();
    ArrayLock::unlockArray();
    std::atomic<bool> taken = false;
    std::thread other([&] {
        const ArrayLock::Held held;
        taken = true;
    });
    EXPECT_FALSE(taken);  // still held once
    ArrayLock::unlockArray();
    other.join();
    EXPECT_TRUE(taken);
}

TEST(ArrayLock, KeepsWritersOfTwoThreadsApart) {
    int counter = 0;
    const auto count = [&] {
        for (int i = 0; i < 10000; ++i) {
            const ArrayLock::Held outer;
            const ArrayLock::Held inner;
            ++counter;
        }
    };
    std::thread other(count);
    count();
    other.join();
    EXPECT_EQ(counter, 20000);
}

}  // namespace
}  // namespace kelvo
