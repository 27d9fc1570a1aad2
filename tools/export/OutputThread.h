#pragma once

#include <condition_variable>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <thread>

#include "platform/system/Mutex.h"
#include "platform/values/Result.h"

namespace kelvo {

/// Writes text on a thread of its own, in the order in which it was handed over: a quick reader's in large pieces, a
/// slow one's soon, so that whoever reads a pipe sees rows as they come. What is handed over at once is written at once
/// or not at all. Memory: a few megabytes; a sink that is slower holds up whoever appends.
class OutputThread {
public:
    /// Takes a piece; called on the thread alone.
    using Sink = std::function<Result<void>(std::string_view)>;

    explicit OutputThread(Sink sink);
    /// Writes what was handed over, unless the sink has failed.
    ~OutputThread();
    OutputThread(const OutputThread&) = delete;
    OutputThread& operator=(const OutputThread&) = delete;

    /// A failure is the sink's, of an earlier piece; nothing more is written then.
    Result<void> append(std::string_view text);
    /// Waits until everything is written.
    Result<void> finish();

private:
    void run();
    Result<void> failure() const KELVO_NEEDS(_mutex);

    const Sink _sink;
    Mutex _mutex;
    std::condition_variable _changed;
    std::string _waiting KELVO_GUARDED_BY(_mutex);
    bool _isWriting KELVO_GUARDED_BY(_mutex) = false;
    bool _isHurried KELVO_GUARDED_BY(_mutex) = false;  // somebody waits for the end
    bool _isOver KELVO_GUARDED_BY(_mutex) = false;
    std::optional<Failure> _failure KELVO_GUARDED_BY(_mutex);
    std::thread _thread;
};

}  // namespace kelvo
