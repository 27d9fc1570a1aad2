#include "platform/host/HostWorker.h"

#include <QCoreApplication>
#include <QScopeGuard>
#include <utility>

#include "platform/host/HostEventLoop.h"

namespace kelvo {

HostWorker::~HostWorker() {
    while (!_jobs.empty()) {
        try {
            finishFirst();
        } catch (...) {  // the loop that would have ended with it has ended
        }
    }
}

void HostWorker::run(Task work, Task done) {
    _jobs.push_back({std::move(work), std::move(done)});
    if (_jobs.size() == 1) startFirst();
}

void HostWorker::startFirst() {
    _atWork = std::async(std::launch::async, [this, work = std::move(_jobs.front().work)] {
        const auto tell = qScopeGuard([this] { QCoreApplication::postEvent(this, new QEvent(QEvent::User)); });
        work();
    });
}

void HostWorker::customEvent(QEvent* /*event*/) {
    HostEventLoop::call([this] { finishFirst(); });
}

void HostWorker::finishFirst() {
    const Task done = std::move(_jobs.front().done);
    _jobs.pop_front();
    std::future<void> worked = std::move(_atWork);
    worked.wait();
    if (!_jobs.empty()) startFirst();
    worked.get();
    done();
}

}  // namespace kelvo
