#include "tools/export/OutputThread.h"

#include <pthread.h>
#include <signal.h>

#include <chrono>
#include <utility>

namespace kelvo {

namespace {

constexpr std::size_t kPiece = std::size_t{256} * 1024;
constexpr std::size_t kMostWaiting = std::size_t{4} * 1024 * 1024;
constexpr auto kSoon = std::chrono::milliseconds(50);

}  // namespace

OutputThread::OutputThread(Sink sink) : _sink(std::move(sink)) {
    sigset_t all;
    sigset_t before;
    sigfillset(&all);
    sigdelset(&all, SIGPIPE);                     // whoever reads no more ends the program as ever
    pthread_sigmask(SIG_SETMASK, &all, &before);  // signals are for the thread that reads
    _thread = std::thread([this] { run(); });
    pthread_sigmask(SIG_SETMASK, &before, nullptr);
}

OutputThread::~OutputThread() {
    {
        const MutexHeld held(_mutex);
        _isOver = true;
    }
    _changed.notify_all();
    _thread.join();
}

Result<void> OutputThread::append(std::string_view text) {
    bool isWorthTelling = false;
    {
        MutexHeld held(_mutex);
        if (_waiting.size() + text.size() > kMostWaiting) {
            held.wait(_changed, [this]() KELVO_UNCHECKED { return _waiting.empty() || _failure; });
        }
        if (_failure) return *_failure;
        const bool wasPiece = _waiting.size() >= kPiece;
        isWorthTelling = _waiting.empty() || (!wasPiece && _waiting.size() + text.size() >= kPiece);
        _waiting += text;
    }
    if (isWorthTelling) _changed.notify_all();
    return {};
}

Result<void> OutputThread::finish() {
    MutexHeld held(_mutex);
    _isHurried = true;
    _changed.notify_all();
    held.wait(_changed, [this]() KELVO_UNCHECKED { return (_waiting.empty() && !_isWriting) || _failure; });
    _isHurried = false;
    return failure();
}

Result<void> OutputThread::failure() const { return _failure ? Result<void>(*_failure) : Result<void>(); }

void OutputThread::run() {
    std::string piece;
    for (;;) {
        {
            MutexHeld held(_mutex);
            held.wait(_changed, [this]() KELVO_UNCHECKED { return _isOver || !_waiting.empty(); });
            held.waitFor(_changed, kSoon,
                         [this]() KELVO_UNCHECKED { return _isOver || _isHurried || _waiting.size() >= kPiece; });
            if (_waiting.empty() || _failure) return;  // it is over
            piece.swap(_waiting);
            _isWriting = true;
        }
        _changed.notify_all();
        const Result<void> written = _sink(piece);
        piece.clear();
        {
            const MutexHeld held(_mutex);
            _isWriting = false;
            if (!written) {
                _failure = written.error();
                _waiting.clear();
            }
        }
        _changed.notify_all();
        if (!written) return;
    }
}

}  // namespace kelvo
