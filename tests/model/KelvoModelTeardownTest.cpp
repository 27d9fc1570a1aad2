#include <gtest/gtest.h>

#include <chrono>
#include <memory>
#include <string>
#include <vector>

#include "model/KelvoModel.h"
#include "tests/support/FakeTelephony.h"
#include "tests/support/ManualQueue.h"

namespace kelvo {
namespace {

using Steps = std::vector<std::string>;

/// A port that writes down what is done to it, under its name.
template <class Port>
class WritingPort : public Port {
public:
    WritingPort(std::string name, Steps& steps) : _name(std::move(name)), _steps(steps) {}
    ~WritingPort() override { _steps.push_back(_name + " released"); }
    void setInvalidationCallback(std::function<void(Port&)> callback) override {
        _steps.push_back(_name + (callback ? " callback set" : " callback removed"));
    }
    void invalidate() override { _steps.push_back(_name + " invalidated"); }
    bool isValid() const override { return true; }

protected:
    const std::string _name;
    Steps& _steps;
};

class Receiving final : public WritingPort<LocalPort> {
public:
    using WritingPort::WritingPort;
    void schedule() override { _steps.push_back(_name + " scheduled"); }
    const std::string& name() const override { return _name; }
};

class Sending final : public WritingPort<RemotePort> {
public:
    using WritingPort::WritingPort;
    Result<Bytes, Error> request(std::int32_t, ByteView, std::chrono::nanoseconds,
                                 std::optional<std::chrono::nanoseconds> replyLimit) override {
        if (!replyLimit) return Bytes();
        return test::technologyAnswer("kPLLogChannelTechnology_Oskra_LTE");
    }
    void notifyWhenWritable(std::function<void()>) override {}
};

class WritingPorts final : public MessagePorts {
public:
    explicit WritingPorts(Steps& steps) : _steps(steps) {}
    Local createLocal(std::string_view, MessageCallback) override {
        return {.port = std::make_unique<Receiving>("receiving", _steps)};
    }
    std::unique_ptr<RemotePort> openRemote(std::string_view) override {
        return std::make_unique<Sending>("sending", _steps);
    }

private:
    Steps& _steps;
};

/// A queue whose timers write down that they are made and stopped.
class WritingQueue final : public MainQueue {
public:
    explicit WritingQueue(Steps& steps) : _steps(steps) {}
    void post(Task) override {}
    void postAfter(std::chrono::nanoseconds, Task) override {}
    std::unique_ptr<RepeatingTimer> repeat(std::chrono::nanoseconds, Task) override {
        return std::make_unique<Timer>(_steps);
    }
    std::chrono::nanoseconds now() const override { return {}; }

private:
    struct Timer final : RepeatingTimer {
        explicit Timer(Steps& to) : steps(to) { steps.push_back("timer made"); }
        ~Timer() override { steps.push_back("timer stopped"); }
        Steps& steps;
    };

    Steps& _steps;
};

class KelvoModelTeardown : public testing::Test {
protected:
    Steps taken() {
        Steps until = steps;
        steps.clear();
        return until;
    }

    Steps steps;
    WritingQueue queue{steps};
    WritingPorts ports{steps};
    test::FakeTelephony telephony;
    std::unique_ptr<KelvoModel> model = std::make_unique<KelvoModel>(KelvoModel::Services{
        .queue = queue, .ports = ports, .telephony = telephony, .updateViewControllerFromModel = [] {}});

    // The timer first, so that no tick finds half a connection; then each port, silenced before it goes.
    const Steps teardown = {"timer stopped",      "receiving callback removed", "receiving invalidated",
                            "receiving released", "sending callback removed",   "sending invalidated",
                            "sending released"};
};

TEST_F(KelvoModelTeardown, StopsTheTimerThenEachPortAfterItsCallback) {
    model->startMonitor();
    ASSERT_TRUE(model->isConnected());
    taken();
    model.reset();
    EXPECT_EQ(taken(), teardown);
}

TEST_F(KelvoModelTeardown, ComesWholeBeforeANewStart) {
    model->startMonitor();
    ASSERT_TRUE(model->isConnected());
    taken();
    model->restartMonitor();
    Steps expected = teardown;
    expected.insert(expected.end(), {"receiving scheduled", "receiving callback set", "timer made"});
    EXPECT_EQ(taken(), expected);
}

}  // namespace
}  // namespace kelvo
