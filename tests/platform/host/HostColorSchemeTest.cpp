#include "platform/host/HostColorScheme.h"

#include <gtest/gtest.h>
#include <stdlib.h>

#include <QDBusMessage>
#include <QDBusVirtualObject>
#include <vector>

#include "tests/support/EventLoop.h"
#include "tests/support/PrivateBus.h"

namespace kelvo {
namespace {

using Scheme = HostColorScheme::Scheme;

/// The desktop's portal: answers with one setting and tells that it changed.
class Portal : public QDBusVirtualObject {
public:
    explicit Portal(const QString& address) : _bus(QDBusConnection::connectToBus(address, "portal")) {
        _bus.registerVirtualObject("/org/freedesktop/portal/desktop", this);
        _bus.registerService("org.freedesktop.portal.Desktop");
    }
    ~Portal() override { QDBusConnection::disconnectFromBus("portal"); }

    QString introspect(const QString&) const override { return {}; }
    bool handleMessage(const QDBusMessage& message, const QDBusConnection& bus) override {
        ++asked;
        const bool known = message.member() == "Read" &&
                           message.arguments() == QVariantList{"org.freedesktop.appearance", "color-scheme"};
        if (!known || refuses) return bus.send(message.createErrorReply("org.freedesktop.portal.Error.NotFound", "no"));
        return bus.send(
            message.createReply(QVariant::fromValue(QDBusVariant(QVariant::fromValue(QDBusVariant(setting))))));
    }
    void change(const QString& group, const QString& key, uint value) {
        QDBusMessage signal = QDBusMessage::createSignal("/org/freedesktop/portal/desktop",
                                                         "org.freedesktop.portal.Settings", "SettingChanged");
        signal << group << key << QVariant::fromValue(QDBusVariant(value));
        _bus.send(signal);
    }

    uint setting = 0;
    bool refuses = false;
    int asked = 0;

private:
    QDBusConnection _bus;
};

class HostColorSchemeTest : public testing::Test {
protected:
    void SetUp() override {
        if (!bus) GTEST_SKIP() << "no bus is installed";
        portal = std::make_unique<Portal>(bus.address());
    }
    bool hears(const std::vector<Scheme>& expected) {
        return test::runUntil([&] { return told == expected; });
    }

    test::PrivateBus bus;
    std::unique_ptr<Portal> portal;
    std::vector<Scheme> told;
    const std::function<void(Scheme)> note = [this](Scheme scheme) { told.push_back(scheme); };
};

TEST_F(HostColorSchemeTest, TellsWhatTheDesktopWants) {
    portal->setting = 1;
    const HostColorScheme scheme(note);
    EXPECT_TRUE(told.empty());  // asking does not wait for the answer
    EXPECT_TRUE(hears({Scheme::Dark}));
}

TEST_F(HostColorSchemeTest, TellsEveryChangeOfItWhileItRuns) {
    portal->setting = 2;
    const HostColorScheme scheme(note);
    ASSERT_TRUE(hears({Scheme::Light}));
    portal->change("org.freedesktop.appearance", "color-scheme", 2);  // no change
    portal->change("org.freedesktop.appearance", "accent-color", 1);
    portal->change("org.gnome.desktop.interface", "color-scheme", 1);
    portal->change("org.freedesktop.appearance", "color-scheme", 1);
    EXPECT_TRUE(hears({Scheme::Light, Scheme::Dark}));
    portal->change("org.freedesktop.appearance", "color-scheme", 0);
    EXPECT_TRUE(hears({Scheme::Light, Scheme::Dark, Scheme::NoPreference}));
}

TEST_F(HostColorSchemeTest, TakesANumberItDoesNotKnowForNoPreference) {
    portal->setting = 7;
    const HostColorScheme scheme(note);
    EXPECT_TRUE(hears({Scheme::NoPreference}));
}

TEST_F(HostColorSchemeTest, TellsNothingWhenThePortalDoesNotKnowButHearsOfALaterChange) {
    portal->refuses = true;
    const HostColorScheme scheme(note);
    ASSERT_TRUE(test::runUntil([&] { return portal->asked == 1; }));
    test::settle();
    EXPECT_TRUE(told.empty());
    portal->change("org.freedesktop.appearance", "color-scheme", 1);
    EXPECT_TRUE(hears({Scheme::Dark}));
}

TEST(HostColorScheme, TellsNothingWithoutABus) {
    ::unsetenv("DBUS_SESSION_BUS_ADDRESS");
    ::unsetenv("XDG_RUNTIME_DIR");
    bool told = false;
    const HostColorScheme none([&](Scheme) { told = true; });
    ::setenv("DBUS_SESSION_BUS_ADDRESS", "unix:path=/nonexistent/bus", 1);
    const HostColorScheme unreachable([&](Scheme) { told = true; });
    ::unsetenv("DBUS_SESSION_BUS_ADDRESS");
    test::settle();
    EXPECT_FALSE(told);
}

}  // namespace
}  // namespace kelvo
