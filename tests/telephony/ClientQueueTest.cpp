#include "telephony/ClientQueue.h"

#include <gtest/gtest.h>

using kelvo::Bytes;
using kelvo::ClientQueue;

TEST(ClientQueue, KeepsRecordsInOrder) {
    ClientQueue queue({10, 100});
    queue.push(Bytes{1});
    queue.push(Bytes{});
    queue.push(Bytes{2, 3});
    EXPECT_EQ(queue.front().size(), 1U);
    queue.pop();
    EXPECT_TRUE(queue.front().empty());
    queue.pop();
    EXPECT_EQ(queue.front()[1], 3);
    queue.pop();
    EXPECT_TRUE(queue.empty());
    EXPECT_EQ(queue.takeLost(), 0U);
}

TEST(ClientQueue, LosesTheOldestBeyondItsNumberOfRecords) {
    ClientQueue queue({2, 100});
    for (std::uint8_t i = 1; i <= 5; ++i) queue.push(Bytes{i});
    EXPECT_EQ(queue.front()[0], 4);
    EXPECT_EQ(queue.takeLost(), 3U);
    EXPECT_EQ(queue.takeLost(), 0U);
}

TEST(ClientQueue, LosesTheOldestBeyondItsBytes) {
    ClientQueue queue({10, 10});
    queue.push(Bytes(4, 1));
    queue.push(Bytes(6, 2));
    EXPECT_EQ(queue.takeLost(), 0U);
    queue.push(Bytes(5, 3));
    EXPECT_EQ(queue.takeLost(), 2U);
    EXPECT_EQ(queue.front()[0], 3);
    queue.pop();
    queue.push(Bytes(10, 4));  // what has left no longer counts
    EXPECT_EQ(queue.takeLost(), 0U);
}

TEST(ClientQueue, LosesARecordThatNeverFits) {
    ClientQueue queue({10, 10});
    queue.push(Bytes(11, 1));
    EXPECT_TRUE(queue.empty());
    EXPECT_EQ(queue.takeLost(), 1U);
}
