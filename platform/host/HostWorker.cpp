#include "platform/host/HostWorker.h"

#include <utility>

#include "platform/host/HostEventLoop.h"

namespace kelvo {

HostWorker::HostWorker() { _thread.setMaxThreadCount(1); }

HostWorker::~HostWorker() {
    _thread.waitForDone();
    while (!_jobs.empty()) {
        if (!_jobs.front().failure) _jobs.front().done();
        _jobs.pop_front();
    }
}

void HostWorker::run(Task work, Task done) {
    Job& job = _jobs.emplace_back(Job{std::move(work), std::move(done)});
    _thread.start([this, &job] {
        try {
            job.work();
        } catch (...) {
            job.failure = std::current_exception();
        }
        QMetaObject::invokeMethod(
            &_context, [this] { HostEventLoop::call([this] { finishFirst(); }); }, Qt::QueuedConnection);
    });
}

void HostWorker::finishFirst() {
    const Job job = std::move(_jobs.front());
    _jobs.pop_front();
    if (job.failure) std::rethrow_exception(job.failure);
    job.done();
}

}  // namespace kelvo
