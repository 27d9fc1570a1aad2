#include "telephony/line/ReadRest.h"

#include <QSocketNotifier>

namespace kelvo {
namespace {

constexpr int kRestMs = 40;
constexpr qint64 kOftenMs = 50;      // what comes more seldom wakes nobody up too often
constexpr std::size_t kMuch = 4000;  // what a terminal holds: more waits already

}  // namespace

ReadRest::ReadRest(QIODevice& device) : _device(device) {
    _timer.setSingleShot(true);
    _timer.setTimerType(Qt::PreciseTimer);
    QObject::connect(&_timer, &QTimer::timeout, &_timer, [this] { watch(true); });
}

void ReadRest::setAllowed(bool allowed) {
    _allowed = allowed;
    if (allowed || !_timer.isActive()) return;
    _timer.stop();
    watch(true);
}

void ReadRest::after(std::size_t bytes) {
    const bool often = _last.isValid() && _last.elapsed() < kOftenMs;
    _last.start();
    if (!_allowed || !often || bytes >= kMuch) return;
    watch(false);
    _timer.start(kRestMs);
}

// Qt's serial ports and sockets have no word for this; what they watch their descriptor with is among their children.
void ReadRest::watch(bool watched) {
    for (auto* notifier : _device.findChildren<QSocketNotifier*>()) {
        if (notifier->type() == QSocketNotifier::Read) notifier->setEnabled(watched);
    }
}

}  // namespace kelvo
