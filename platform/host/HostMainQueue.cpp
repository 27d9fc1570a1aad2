#include "platform/host/HostMainQueue.h"

#include <QTimer>
#include <algorithm>
#include <limits>

#include "platform/host/HostEventLoop.h"

namespace kelvo {
namespace {

using std::chrono::milliseconds;

constexpr Qt::TimerType kNeverEarly = Qt::PreciseTimer;  // coarse ones come up to a twentieth of their time early

// Qt's timers count whole milliseconds in an int: never early by rounding, at most 24 days.
milliseconds wholeMilliseconds(std::chrono::nanoseconds time) {
    constexpr milliseconds kLongest{std::numeric_limits<int>::max()};
    return std::clamp(std::chrono::ceil<milliseconds>(time), milliseconds{0}, kLongest);
}

class HostTimer final : public RepeatingTimer {
public:
    HostTimer(milliseconds interval, MainQueue::Task task) : _timer(new QTimer) {
        QObject::connect(_timer, &QTimer::timeout, _timer, [run = std::move(task)] { HostEventLoop::call(run); });
        _timer->setTimerType(kNeverEarly);
        _timer->start(interval);
    }
    ~HostTimer() override {
        _timer->stop();
        _timer->deleteLater();  // its own task may be what destroys it
    }

private:
    QTimer* _timer;
};

}  // namespace

void HostMainQueue::post(Task task) {
    QMetaObject::invokeMethod(
        &_context, [run = std::move(task)] { HostEventLoop::call(run); }, Qt::QueuedConnection);
}

void HostMainQueue::postAfter(std::chrono::nanoseconds delay, Task task) {
    QTimer::singleShot(wholeMilliseconds(delay), kNeverEarly, &_context,
                       [run = std::move(task)] { HostEventLoop::call(run); });
}

std::unique_ptr<RepeatingTimer> HostMainQueue::repeat(std::chrono::nanoseconds interval, Task task) {
    return std::make_unique<HostTimer>(wholeMilliseconds(interval), std::move(task));
}

std::chrono::nanoseconds HostMainQueue::now() const { return std::chrono::steady_clock::now().time_since_epoch(); }

}  // namespace kelvo
