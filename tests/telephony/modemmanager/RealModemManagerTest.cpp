#include <gtest/gtest.h>
#include <unistd.h>

#include <QDBusPendingCall>
#include <QProcess>
#include <QStandardPaths>

#include "platform/host/HostMainQueue.h"
#include "platform/system/Environment.h"
#include "telephony/modemmanager/ModemManager.h"
#include "tests/support/EventLoop.h"
#include "tests/support/PrivateBus.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/telephony/modemmanager/AtModem.h"

namespace kelvo::modemmanager {
namespace {

/// The daemon itself on a bus of the test's own, with a modem of ours behind a socket.
class RealModemManagerTest : public testing::Test {
protected:
    void SetUp() override {
        const QString program = QStandardPaths::findExecutable("ModemManager", {"/usr/sbin", "/usr/bin", "/sbin"});
        if (program.isEmpty()) GTEST_SKIP() << "ModemManager is not installed";
        if (!bus) GTEST_SKIP() << "no bus is installed";
        ASSERT_TRUE(modem.isListening());
        daemon.setProcessChannelMode(QProcess::MergedChannels);
        daemon.start(program, {"--test-session", "--test-enable", "--test-no-udev", "--test-no-suspend-resume",
                               "--test-no-qrtr", "--no-auto-scan", "--log-level=WARN"});
        ASSERT_TRUE(daemon.waitForStarted());
        manager.follow([] {});
        ASSERT_TRUE(test::runUntil([this] { return manager.trouble() == "ModemManager has no modem"; }))
            << manager.trouble() << daemon.readAll().toStdString();
    }
    void TearDown() override {
        daemon.kill();
        daemon.waitForFinished();
        QDBusConnection::disconnectFromBus("user");
    }
    // Whoever drives the modem: here the test.
    void ask(const QString& path, const QString& interface, const QString& method, const QVariantList& arguments) {
        auto call = QDBusMessage::createMethodCall("org.freedesktop.ModemManager1", path, interface, method);
        call.setArguments(arguments);
        QDBusConnection::connectToBus(bus.address(), "user").asyncCall(call);
    }
    void plugIn() {
        ask("/org/freedesktop/ModemManager1", "org.freedesktop.ModemManager1.Test", "SetProfile",
            {"test-0", "generic", QStringList{socket}});
        ASSERT_TRUE(test::runUntil([this] { return phone().condition == "disabled" && !phone().sim.iccid.empty(); }))
            << phone().condition << daemon.readAll().toStdString();
    }
    void enable() {
        ask("/org/freedesktop/ModemManager1/Modem/0", "org.freedesktop.ModemManager1.Modem", "Enable", {true});
        ASSERT_TRUE(test::runUntil([this] { return phone().condition == "registered" && !phone().access.empty(); }))
            << phone().condition << daemon.readAll().toStdString();
    }
    const phone::PhoneState& phone() const { return manager.phone(); }

    test::PrivateBus bus;
    test::TemporaryDirectory directory;
    QString socket = QString::fromStdString(directory.path() / "modem");
    test::AtModem modem{socket};
    test::RecordingLog log;
    Environment::Scope scope{Environment{.log = &log}};
    QProcess daemon;
    HostMainQueue queue;
    ModemManager manager{[this] { return QDBusConnection::connectToBus(bus.address(), "follower"); }, ::getuid(), "",
                         queue};
};

TEST_F(RealModemManagerTest, TellsItsModemFromPlugToPlug) {
    plugIn();
    EXPECT_EQ(manager.trouble(), "the modem is disabled");
    EXPECT_EQ(phone().modem, "0");
    EXPECT_EQ(phone().model, "Maker AT Modem");
    EXPECT_EQ(phone().equipment, "123456789012347");
    EXPECT_EQ(phone().sim.iccid, "89010101000000123456");
    EXPECT_EQ(phone().sim.msisdn, "+15550123");
    EXPECT_EQ(phone().simOperator, "Provider");
    EXPECT_EQ(phone().contexts, std::vector<phone::PdpContext>{});
    EXPECT_EQ(phone().ports, std::vector{phone::DrivenPort{.name = socket.toStdString()}});

    enable();
    EXPECT_EQ(manager.trouble(), "");
    EXPECT_EQ(phone().access, "LTE");
    EXPECT_EQ(phone().family, Technology::LTE);
    ASSERT_TRUE(test::runUntil([this] { return phone().registration == "home"; }));

    manager.measure(true);
    ASSERT_TRUE(test::runUntil([this] { return phone().cells && phone().cells->front().cellId && phone().lte.rsrp; }));
    EXPECT_EQ(phone().cells->front(), (phone::MonitoredCell{.technology = phone::MonitoredCell::Technology::LTE,
                                                            .isServing = true,
                                                            .mcc = 1,
                                                            .mnc = 1,
                                                            .tac = 0x1234,
                                                            .cellId = 0xABCDE}));
    EXPECT_EQ(phone().lte, (phone::LteLevels{.rsrp = -91, .rsrq = -10}));
    ASSERT_EQ(manager.lacks().size(), 1U);
    EXPECT_TRUE(manager.lacks()[0].starts_with("cell information: ")) << manager.lacks()[0];

    bool released = false;
    manager.release([&] { released = true; });
    EXPECT_TRUE(test::runUntil([&] { return released; }));

    daemon.kill();
    EXPECT_TRUE(test::runUntil([this] { return manager.trouble() == "ModemManager does not run"; }));
    EXPECT_TRUE(test::runUntil([this] { return phone() == phone::PhoneState{}; }));
}

}  // namespace
}  // namespace kelvo::modemmanager
