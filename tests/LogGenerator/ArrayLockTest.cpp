#include "LogGenerator/ArrayLock.h"

#include <gtest/gtest.h>

#include <atomic>
#include <latch>
#include <thread>

#include "LogGenerator/LTE/MeasuredNeighborCells.h"
#include "LogGenerator/RowWriter.h"
#include "LogGenerator/ShowFields.h"
#include "tests/support/Fed.h"

namespace kelvo {
namespace {

void lockArray(int times) {
    for (int i = 0; i < times; ++i) ArrayLock::lockArray();
}

void unlockArray(int times) {
    for (int i = 0; i < times; ++i) ArrayLock::unlockArray();
}

/// Hangs while the calling thread holds the lock.
void takeInAnotherThread() {
    std::thread([] { const ArrayLock::Held held; }).join();
}

/// Hangs when `operation` does not take the lock. Held 256 times, the lock stands at a depth of 0: one more take and
/// its release, those of the operation, free it.
template <class Operation>
void expectTaken(Operation operation) {
    lockArray(256);
    operation();
    takeInAnotherThread();
    unlockArray(256);
}

TEST(ArrayLock, IsFreeForOthersOnceEveryNestedTakeIsUndone) {
    lockArray(2);
    unlockArray(1);
    std::latch started(1);
    std::atomic<bool> undone = false;
    bool seen = false;
    std::thread other([&] {
        started.count_down();
        const ArrayLock::Held held;
        seen = undone;
    });
    started.wait();
    for (int i = 0; i < 5000; ++i) std::this_thread::yield();  // time enough to take a lock that is not held
    undone = true;
    unlockArray(1);
    other.join();
    EXPECT_TRUE(seen);
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

TEST(ArrayLock, CountsItsDepthInEightBits) {
    lockArray(257);
    unlockArray(1);  // the depth was 1 again
    takeInAnotherThread();
    unlockArray(256);
}

TEST(ArrayLock, IsTakenByWhateverWritesAnArray) {
    const ArrayRef array = Array::make({"row"});
    const Bytes bytes = {1, 2};
    expectTaken([&] { Base::clearElementsInArray(array); });
    expectTaken([&] { Base::replaceArray(array, {Value("new")}); });
    expectTaken([&] { const RowWriter rows(array); });
    expectTaken([&] { showValues(array, RecordView(bytes), RecordEntries(0, 1, 2), u8, decimal); });
}

Value measuredCell(const char* id) {
    return Dictionary::make(
        {{"Physical Cell ID", id}, {"Filtered RSRP", "-140.00 dBm"}, {"Filtered RSRQ", "-20.00 dB"}});
}

TEST(ArrayLock, KeepsReadersFromRowsThatAreHalfWritten) {
    test::Fed<MeasuredNeighborCells> section(Array::make());
    std::latch started(1);
    std::thread writer([&] {
        started.count_down();
        for (int i = 0; i < 5000; ++i) {
            section.feed(test::Record(0xB179, 47).u8(27, 2).u16(29, 301).u16(35, 302));
            section.feed(test::Record(0xB179, 35).u8(27, 1).u16(29, 7));
        }
    });
    const Value none = Array::make();
    const Value one = Array::make({measuredCell("7")});
    const Value two = Array::make({measuredCell("301"), measuredCell("302")});
    started.wait();
    int halfWritten = 0;
    for (int i = 0; i < 5000; ++i) {
        const ArrayLock::Held held;  // whoever reads a text may be the first, and writes it where it stands
        const Value& shown = section.part();
        if (shown != none && shown != one && shown != two) ++halfWritten;
    }
    writer.join();
    EXPECT_EQ(halfWritten, 0);
    EXPECT_EQ(section.part(), one);
}

}  // namespace
}  // namespace kelvo
