#pragma once

#include <QObject>
#include <deque>
#include <future>

#include "platform/system/Worker.h"

namespace kelvo {

/// A worker with a thread for each piece of work. The destructor waits for what was handed over and calls what is to
/// follow it, so that nothing stays half written when the program ends.
class HostWorker final : public QObject, public Worker {
public:
    ~HostWorker() override;
    void run(Task work, Task done) override;

private:
    struct Job {
        Task work;
        Task done;
    };
    void startFirst();
    void finishFirst();
    void customEvent(QEvent* event) override;

    std::deque<Job> _jobs;        // in their order; the first is being worked on
    std::future<void> _atWork{};  // the first one's
};

}  // namespace kelvo
