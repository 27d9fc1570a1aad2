#pragma once

namespace kelvo {

/// The one lock around every array that sections rewrite while the display tree may be reading it. It is recursive and
/// counts its depth in 8 bits: the release at depth 0 undoes all the nested takes of its thread at once. Every
/// `lockArray` is followed by exactly one `unlockArray`; `Held` sees to that.
class ArrayLock {
public:
    ArrayLock() = delete;

    static void lockArray();
    static void unlockArray();

    struct Held;
};

/// Holds the lock for as long as it lives.
struct ArrayLock::Held {
    Held() { lockArray(); }
    ~Held() { unlockArray(); }
    Held(const Held&) = delete;
    Held& operator=(const Held&) = delete;
};

}  // namespace kelvo
