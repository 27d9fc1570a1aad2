#include <gtest/gtest.h>
#include <unistd.h>

#include <QProcess>
#include <QProcessEnvironment>

#include "tests/support/EventLoop.h"
#include "tests/support/PrivateBus.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/telephony/modemmanager/MockManager.h"

namespace kelvo {
namespace {

/// The service itself, with a system bus of the test's own.
class ManagedDaemonTest : public testing::Test {
protected:
    void SetUp() override {
        if (!bus) GTEST_SKIP() << "no bus is installed";
        manager = std::make_unique<test::MockManager>(bus.address());
        manager->addModem(0);
        prepare(daemon, {"--modemmanager"});
        daemon.start();
        ASSERT_TRUE(daemon.waitForStarted());
    }
    void TearDown() override {
        daemon.terminate();
        if (daemon.state() != QProcess::NotRunning) daemon.waitForFinished();
    }
    void prepare(QProcess& process, const QStringList& arguments) {
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert("XDG_RUNTIME_DIR", QString::fromStdString(directory.path()));
        environment.insert("DBUS_SYSTEM_BUS_ADDRESS", bus.address());
        process.setProcessEnvironment(environment);
        process.setProgram(KELVO_TELEPHONYD);
        process.setArguments(arguments);
    }
    bool statusSays(const std::string& words) {
        return test::runUntil([&] {
            QProcess status;
            prepare(status, {"--status"});
            status.start();
            status.waitForFinished();
            told = status.readAllStandardOutput().toStdString();
            return told.find(words) != std::string::npos;
        });
    }

    test::PrivateBus bus;
    test::TemporaryDirectory directory;
    std::unique_ptr<test::MockManager> manager;
    QProcess daemon;
    std::string told;
};

TEST_F(ManagedDaemonTest, BelievesAManagerThatIsRootsAndNoOther) {
    if (::getuid() != 0) {
        EXPECT_TRUE(statusSays("not to user 0: nothing is believed")) << told;
        EXPECT_TRUE(manager->asked.isEmpty());
        return;
    }
    EXPECT_TRUE(statusSays("Technology  LTE\n")) << told;
    EXPECT_TRUE(statusSays("  SIM                       …3450\n")) << told;
    EXPECT_EQ(told.find("8900101"), std::string::npos);
    manager.reset();
    EXPECT_TRUE(statusSays("State       ModemManager does not run\n")) << told;
}

}  // namespace
}  // namespace kelvo
