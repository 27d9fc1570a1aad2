#pragma once

#include <cstdint>

namespace kelvo {

/// The record whose contents a generator is showing on this thread. Whatever is written to a display meanwhile bears
/// its number, so that neither generators nor sections hand it about.
class RecordBeingShown {
public:
    RecordBeingShown() = delete;

    /// The record's number, for something that it shows now; 0 while nobody counts.
    static std::uint64_t number() {
        _shows = true;
        return _number;
    }

    struct Scope;

private:
    static inline constinit thread_local std::uint64_t _number = 0;
    static inline constinit thread_local bool _shows = false;
};

/// Makes `number` that of the record being shown, for as long as it lives. One at a time.
struct RecordBeingShown::Scope {
    explicit Scope(std::uint64_t number) {
        _number = number;
        _shows = false;
    }
    ~Scope() { _number = 0; }
    Scope(const Scope&) = delete;
    Scope& operator=(const Scope&) = delete;

    /// Whether the record has written anything to a display.
    bool showsSomething() const { return _shows; }
};

}  // namespace kelvo
