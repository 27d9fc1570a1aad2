#include "platform/host/HostWorker.h"

#include <gtest/gtest.h>

#include <QCoreApplication>
#include <future>
#include <optional>
#include <stdexcept>
#include <string>
#include <thread>
#include <vector>

#include "platform/host/HostEventLoop.h"
#include "tests/support/EventLoop.h"

namespace kelvo {
namespace {

TEST(HostWorker, WorksBesideTheMainQueueAndFinishesOnIt) {
    const std::thread::id mainThread = std::this_thread::get_id();
    std::thread::id worked;
    std::thread::id finished;
    HostWorker worker;
    worker.run([&] { worked = std::this_thread::get_id(); }, [&] { finished = std::this_thread::get_id(); });
    EXPECT_EQ(finished, std::thread::id());  // not before the caller has returned to the queue
    ASSERT_TRUE(test::runUntil([&] { return finished != std::thread::id(); }));
    EXPECT_EQ(finished, mainThread);
    EXPECT_NE(worked, mainThread);
}

TEST(HostWorker, LeavesTheMainQueueFreeWhileItWorks) {
    std::promise<void> release;
    bool finished = false;
    bool turned = false;
    HostWorker worker;
    worker.run([until = release.get_future().share()] { until.wait(); }, [&] { finished = true; });
    QMetaObject::invokeMethod(
        QCoreApplication::instance(), [&] { turned = true; }, Qt::QueuedConnection);
    ASSERT_TRUE(test::runUntil([&] { return turned; }));
    EXPECT_FALSE(finished);
    release.set_value();
    EXPECT_TRUE(test::runUntil([&] { return finished; }));
}

TEST(HostWorker, DoesOnePieceOfWorkAfterAnother) {
    std::vector<std::string> worked;  // by the worker's threads; nobody else looks before the last has told
    std::vector<std::string> told;
    HostWorker worker;
    for (const char* name : {"a", "b", "c"})
        worker.run([&, name] { worked.emplace_back(name); }, [&, name] { told.emplace_back(name); });
    ASSERT_TRUE(test::runUntil([&] { return told.size() == 3; }));
    EXPECT_EQ(worked, (std::vector<std::string>{"a", "b", "c"}));
    EXPECT_EQ(told, worked);
}

TEST(HostWorker, FinishesWhatItWasHandedBeforeItGoes) {
    std::vector<std::string> order;
    {
        HostWorker worker;
        worker.run([&] { order.emplace_back("written"); }, [&] { order.emplace_back("told"); });
    }
    EXPECT_EQ(order, (std::vector<std::string>{"written", "told"}));
    test::settle();
    EXPECT_EQ(order.size(), 2U);
}

TEST(HostWorker, FinishesAlsoWhatWaitsForItsTurnAndWhatFollowsAFailure) {
    std::vector<std::string> order;
    {
        HostWorker worker;
        worker.run([] { throw std::runtime_error("disk"); }, [&] { order.emplace_back("never"); });
        worker.run([&] { order.emplace_back("written"); }, [&] { order.emplace_back("told"); });
    }
    EXPECT_EQ(order, (std::vector<std::string>{"written", "told"}));
}

TEST(HostWorker, EndsTheProgramWithWhatItsWorkThrew) {
    HostWorker worker;
    bool finished = false;
    worker.run([] { throw std::runtime_error("out of memory"); }, [&] { finished = true; });
    try {
        HostEventLoop::run(QCoreApplication::exec);
        FAIL() << "the failure is lost";
    } catch (const std::runtime_error& failure) {
        EXPECT_STREQ(failure.what(), "out of memory");
    }
    EXPECT_FALSE(finished);
}

}  // namespace
}  // namespace kelvo
