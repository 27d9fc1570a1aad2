#pragma once

#include <QObject>
#include <QThreadPool>
#include <exception>
#include <list>

#include "platform/Worker.h"

namespace kelvo {

/// A worker with one thread, which ends when nothing has been there to do for a while. The destructor waits for the
/// work that was handed over and calls what is to follow it, so that nothing stays half written when the program ends.
class HostWorker final : public Worker {
public:
    HostWorker();
    ~HostWorker() override;
    void run(Task work, Task done) override;

private:
    struct Job {
        Task work;
        Task done;
        std::exception_ptr failure = nullptr;  // written by the thread before it says that it is done
    };
    void finishFirst();

    std::list<Job> _jobs;  // main queue only; the thread holds on to its own job
    QObject _context;
    QThreadPool _thread;
};

}  // namespace kelvo
