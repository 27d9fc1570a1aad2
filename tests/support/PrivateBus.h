#pragma once

#include <stdlib.h>

#include <QProcess>
#include <QString>

#include "tests/support/EventLoop.h"

namespace kelvo::test {

/// A session bus of the test's own, for as long as it lives. False where no bus is installed.
class PrivateBus {
public:
    PrivateBus() {
        _daemon.start("dbus-daemon", {"--session", "--nofork", "--print-address"});
        if (!_daemon.waitForStarted() || !runUntil([this] { return _daemon.canReadLine(); })) return;
        _address = _daemon.readLine().trimmed();
        ::setenv("DBUS_SESSION_BUS_ADDRESS", _address.constData(), 1);
    }
    ~PrivateBus() {
        ::unsetenv("DBUS_SESSION_BUS_ADDRESS");
        _daemon.kill();
        _daemon.waitForFinished();
    }

    explicit operator bool() const { return !_address.isEmpty(); }
    QString address() const { return QString::fromLatin1(_address); }

private:
    QProcess _daemon;
    QByteArray _address;
};

}  // namespace kelvo::test
