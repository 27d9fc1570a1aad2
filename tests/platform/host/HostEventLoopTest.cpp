#include "platform/host/HostEventLoop.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <QCoreApplication>
#include <stdexcept>
#include <string>

#include "platform/host/FdWatcher.h"
#include "platform/host/HostMainQueue.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;

int runLoop() { return HostEventLoop::run(QCoreApplication::exec); }

std::string whatEndsTheLoop() {
    try {
        return "status " + std::to_string(runLoop());
    } catch (const std::exception& failure) {
        return failure.what();
    }
}

/// Qt warns when an exception comes to its own code: none may.
class HostEventLoopTest : public testing::Test {
protected:
    void SetUp() override {
        qInstallMessageHandler([](QtMsgType, const QMessageLogContext&, const QString& message) {
            ADD_FAILURE() << message.toStdString();
        });
    }
    void TearDown() override { qInstallMessageHandler(nullptr); }

    HostMainQueue queue;
};

TEST_F(HostEventLoopTest, EndsWithTheStatusOfAProgramThatQuits) {
    queue.post([] { QCoreApplication::exit(3); });
    EXPECT_EQ(whatEndsTheLoop(), "status 3");
}

TEST_F(HostEventLoopTest, ThrowsWhatAPostedTaskThrewAndRunsNoneAfterIt) {
    bool later = false;
    queue.post([] { throw std::runtime_error("a record of a wrong type"); });
    queue.post([&] { later = true; });
    EXPECT_EQ(whatEndsTheLoop(), "a record of a wrong type");
    EXPECT_FALSE(later);
}

TEST_F(HostEventLoopTest, ThrowsWhatADelayedTaskAndATimerThrew) {
    queue.postAfter(1ms, [] { throw std::runtime_error("delayed"); });
    EXPECT_EQ(whatEndsTheLoop(), "delayed");
    const auto timer = queue.repeat(1ms, [] { throw std::runtime_error("repeated"); });
    EXPECT_EQ(whatEndsTheLoop(), "repeated");
}

TEST_F(HostEventLoopTest, ThrowsWhatACallbackOfADescriptorThrew) {
    int ends[2] = {-1, -1};
    ASSERT_EQ(::pipe(ends), 0);
    ASSERT_EQ(::write(ends[1], "x", 1), 1);
    {
        const FdWatcher watcher(ends[0], FdWatcher::For::Reading, [] { throw std::runtime_error("received"); });
        EXPECT_EQ(whatEndsTheLoop(), "received");
    }
    ::close(ends[0]);
    ::close(ends[1]);
}

TEST_F(HostEventLoopTest, ThrowsWhatWasThrownBeforeItBeganAndBeginsAfresh) {
    HostEventLoop::call([] { throw std::runtime_error("early"); });
    EXPECT_EQ(whatEndsTheLoop(), "early");
    queue.post([] { QCoreApplication::quit(); });
    EXPECT_EQ(whatEndsTheLoop(), "status 0");
}

}  // namespace
}  // namespace kelvo
