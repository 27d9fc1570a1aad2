#pragma once

#include <chrono>
#include <condition_variable>
#include <mutex>

// What a lock guards stands in the declaration, and clang refuses to compile a use without the lock (-Wthread-safety).
#if defined(__clang__)
#define KELVO_THREAD_SAFETY(attribute) __attribute__((attribute))
#else
#define KELVO_THREAD_SAFETY(attribute)
#endif

#define KELVO_LOCK KELVO_THREAD_SAFETY(capability("lock"))                     // a class that is a lock
#define KELVO_LOCK_HOLDER KELVO_THREAD_SAFETY(scoped_lockable)                 // one that holds it in a scope
#define KELVO_GUARDED_BY(lock) KELVO_THREAD_SAFETY(guarded_by(lock))           // data
#define KELVO_NEEDS(lock) KELVO_THREAD_SAFETY(requires_capability(lock))       // a function that is called under it
#define KELVO_TAKES(...) KELVO_THREAD_SAFETY(acquire_capability(__VA_ARGS__))  // one that takes it
#define KELVO_GIVES_BACK(...) KELVO_THREAD_SAFETY(release_capability(__VA_ARGS__))  // one that gives it back
#define KELVO_UNCHECKED KELVO_THREAD_SAFETY(no_thread_safety_analysis)              // beyond what clang can follow

namespace kelvo {

/// std::mutex as clang's check knows it.
class KELVO_LOCK Mutex {
public:
    void lock() KELVO_TAKES() { _mutex.lock(); }
    void unlock() KELVO_GIVES_BACK() { _mutex.unlock(); }

private:
    friend class MutexHeld;
    std::mutex _mutex;
};

/// Holds a mutex for as long as it lives, apart from waits.
class KELVO_LOCK_HOLDER MutexHeld {
public:
    explicit MutexHeld(Mutex& mutex) KELVO_TAKES(mutex) : _lock(mutex._mutex) {}
    ~MutexHeld() KELVO_GIVES_BACK() {}
    MutexHeld(const MutexHeld&) = delete;
    MutexHeld& operator=(const MutexHeld&) = delete;

    /// Waits until `isTrue()`, which is called under the mutex; whoever makes it true notifies `changed`.
    template <class Condition>
    void wait(std::condition_variable& changed, Condition isTrue) {
        changed.wait(_lock, isTrue);
    }
    /// The same for `limit` at most.
    template <class Condition>
    void waitFor(std::condition_variable& changed, std::chrono::nanoseconds limit, Condition isTrue) {
        changed.wait_for(_lock, limit, isTrue);
    }

private:
    std::unique_lock<std::mutex> _lock;
};

}  // namespace kelvo
