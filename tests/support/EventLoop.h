#pragma once

#include <QCoreApplication>
#include <chrono>
#include <thread>

namespace kelvo::test {

/// Runs the event loop until `condition` holds; false when it does not within ten seconds.
template <class Condition>
bool runUntil(Condition condition) {
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(10);
    while (!condition()) {
        if (std::chrono::steady_clock::now() > deadline) return false;
        QCoreApplication::processEvents(QEventLoop::AllEvents);
        std::this_thread::yield();
    }
    return true;
}

/// Runs what is ready now, several turns of it; what was to happen at once has happened then.
inline void settle() {
    for (int turn = 0; turn < 20; ++turn) QCoreApplication::processEvents(QEventLoop::AllEvents);
}

}  // namespace kelvo::test
