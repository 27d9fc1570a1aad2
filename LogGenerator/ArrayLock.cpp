#include "LogGenerator/ArrayLock.h"

#include <atomic>
#include <cstdint>
#include <mutex>
#include <thread>

namespace kelvo {

namespace {

/// Taken again freely by the thread that holds it; one release frees it whatever the depth.
class OwnedLock {
public:
    void take() {
        const auto self = std::this_thread::get_id();
        if (_owner.load(std::memory_order_relaxed) == self) return;
        _mutex.lock();
        _owner.store(self, std::memory_order_relaxed);
    }
    void release() {
        if (_owner.load(std::memory_order_relaxed) != std::this_thread::get_id()) return;  // after the depth wrapped
        _owner.store(std::thread::id(), std::memory_order_relaxed);
        _mutex.unlock();
    }

private:
    std::mutex _mutex;
    std::atomic<std::thread::id> _owner{};
};

OwnedLock arrayLock;
std::uint8_t depth = 0;  // guarded by arrayLock; wraps at 256

}  // namespace

void ArrayLock::lockArray() {
    arrayLock.take();
    ++depth;
}

void ArrayLock::unlockArray() {
    --depth;
    if (depth == 0) arrayLock.release();
}

}  // namespace kelvo
