#pragma once

#include <QObject>

#include "platform/system/MainQueue.h"

namespace kelvo {

/// The main queue on the event loop of a QCoreApplication. What is still waiting when the queue is destroyed never
/// runs. No wait ends early: it is rounded up to whole milliseconds, and one of more than 24 days ends after 24.
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
