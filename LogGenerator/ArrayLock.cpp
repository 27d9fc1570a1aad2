#include "LogGenerator/ArrayLock.h"

#include <atomic>
#include <cstdint>
#include <mutex>
#include <thread>

#include "platform/system/Mutex.h"

namespace kelvo {

namespace {

/// Taken again freely by the thread that holds it; one release frees it whatever the depth.
class KELVO_LOCK OwnedLock {
public:
    void take() KELVO_TAKES() KELVO_UNCHECKED {
        const auto self = std::this_thread::get_id();
        if (_owner.load(std::memory_order_relaxed) == self) return;
        _mutex.lock();
        _owner.store(self, std::memory_order_relaxed);
    }
    void release() KELVO_GIVES_BACK() KELVO_UNCHECKED {
        if (_owner.load(std::memory_order_relaxed) != std::this_thread::get_id()) return;  // after the depth wrapped
        _owner.store(std::thread::id(), std::memory_order_relaxed);
        _mutex.unlock();
    }

private:
    std::mutex _mutex;
    std::atomic<std::thread::id> _owner{};
};

OwnedLock arrayLock;
std::uint8_t depth KELVO_GUARDED_BY(arrayLock) = 0;  // wraps at 256

}  // namespace

// Taken in one call and given back in another: clang follows neither.
void ArrayLock::lockArray() KELVO_UNCHECKED {
    arrayLock.take();
    ++depth;
}

void ArrayLock::unlockArray() KELVO_UNCHECKED {
    --depth;
    if (depth == 0) arrayLock.release();
}

}  // namespace kelvo
