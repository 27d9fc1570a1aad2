#pragma once

#include <deque>
#include <utility>

#include "platform/system/Worker.h"

namespace kelvo::test {

/// A worker that is done as soon as it is asked, or, when it is `held`, once the test says so.
class ManualWorker final : public Worker {
public:
    void run(Task work, Task done) override {
        _jobs.emplace_back(std::move(work), std::move(done));
        if (!held) finish();
    }
    /// Does what was asked for, in order.
    void finish() {
        while (!_jobs.empty()) {
            const auto [work, done] = std::move(_jobs.front());
            _jobs.pop_front();
            work();
            done();
        }
    }

    bool held = false;

private:
    std::deque<std::pair<Task, Task>> _jobs;
};

}  // namespace kelvo::test
