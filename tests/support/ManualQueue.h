#pragma once

#include <algorithm>
#include <chrono>
#include <deque>
#include <memory>
#include <vector>

#include "platform/system/MainQueue.h"

namespace kelvo::test {

/// A main queue whose time moves only when the test says so.
class ManualQueue final : public MainQueue {
public:
    using nanoseconds = std::chrono::nanoseconds;

    void post(Task task) override { _ready.push_back(std::move(task)); }
    void postAfter(nanoseconds delay, Task task) override {
        _delayed.push_back({_now + delay, _order++, std::move(task)});
    }
    std::unique_ptr<RepeatingTimer> repeat(nanoseconds interval, Task task) override {
        auto timer = std::make_unique<Timer>();
        armTimer(interval, std::move(task), timer->alive);
        return timer;
    }

    /// Runs what is posted, and what that posts, until nothing is left.
    void run() {
        while (!_ready.empty()) {
            Task task = std::move(_ready.front());
            _ready.pop_front();
            task();
        }
    }

    /// Lets `by` pass: everything due runs at its time, in order.
    void advance(nanoseconds by) {
        run();
        const nanoseconds end = _now + by;
        while (true) {
            const auto next =
                std::min_element(_delayed.begin(), _delayed.end(), [](const Delayed& a, const Delayed& b) {
                    return std::pair(a.due, a.order) < std::pair(b.due, b.order);
                });
            if (next == _delayed.end() || next->due > end) break;
            _now = next->due;
            Task task = std::move(next->task);
            _delayed.erase(next);
            task();
            run();
        }
        _now = end;
    }

    nanoseconds now() const override { return _now; }

private:
    struct Timer final : RepeatingTimer {
        ~Timer() override { *alive = false; }
        std::shared_ptr<bool> alive = std::make_shared<bool>(true);
    };
    struct Delayed {
        nanoseconds due;
        int order;
        Task task;
    };

    void armTimer(nanoseconds interval, Task task, std::shared_ptr<bool> alive) {
        postAfter(interval, [this, interval, task, alive] {
            if (!*alive) return;
            task();
            if (*alive) armTimer(interval, task, alive);
        });
    }

    std::deque<Task> _ready;
    std::vector<Delayed> _delayed;
    nanoseconds _now{0};
    int _order = 0;
};

}  // namespace kelvo::test
