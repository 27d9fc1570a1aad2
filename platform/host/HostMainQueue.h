#pragma once

#include <QObject>

#include "platform/system/MainQueue.h"

namespace kelvo {

/// The main queue on the event loop of a QCoreApplication. What is still waiting when the queue is destroyed never
/// runs. Waits of a second and more may end up to 5 % early or late, so that the device wakes up for several at a time.
class HostMainQueue final : public MainQueue {
public:
    void post(Task task) override;
    void postAfter(std::chrono::nanoseconds delay, Task task) override;
    std::unique_ptr<RepeatingTimer> repeat(std::chrono::nanoseconds interval, Task task) override;
    std::chrono::nanoseconds now() const override;

private:
    QObject _context;
};

}  // namespace kelvo
