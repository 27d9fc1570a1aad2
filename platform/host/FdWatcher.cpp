#include "platform/host/FdWatcher.h"

#include <QSocketNotifier>

#include "platform/host/HostEventLoop.h"

namespace kelvo {

FdWatcher::FdWatcher(int fd, For purpose, std::function<void()> onReady)
    : _notifier(new QSocketNotifier(fd, purpose == For::Reading ? QSocketNotifier::Read : QSocketNotifier::Write)) {
    QObject::connect(_notifier, &QSocketNotifier::activated, _notifier,
                     [call = std::move(onReady)] { HostEventLoop::call(call); });
}

FdWatcher::~FdWatcher() {
    _notifier->setEnabled(false);
    _notifier->disconnect();
    _notifier->deleteLater();  // its event may be the one that is running
}

void FdWatcher::setEnabled(bool enabled) { _notifier->setEnabled(enabled); }

}  // namespace kelvo
