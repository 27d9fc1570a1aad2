#include "platform/host/LineQueue.h"

#include <algorithm>
#include <chrono>
#include <utility>

namespace kelvo {

namespace {
constexpr auto kGathering = std::chrono::milliseconds(20);
}

void LineQueue::Batch::add(Level level, std::string_view text) {
    _text += text;
    _lines.push_back({level, text.size()});
}

void LineQueue::Batch::dropOldest() {
    ++_lost;
    _droppedText += _lines[_dropped++].size;
    if (_dropped < size()) return;  // so that each line moves once at most
    _text.erase(0, _droppedText);
    _lines.erase(_lines.begin(), _lines.begin() + static_cast<std::ptrdiff_t>(_dropped));
    _dropped = _droppedText = 0;
}

void LineQueue::Batch::clear() {
    _text.clear();
    _lines.clear();
    _dropped = _droppedText = _lost = 0;
}

void LineQueue::add(Level level, std::string_view text) {
    std::size_t size = 0;
    {
        const MutexHeld lock(_mutex);
        if (_batch.size() == _length) _batch.dropOldest();
        _batch.add(level, text);
        size = _batch.size();
    }
    if (size == 1 || size == _length / 2) _changed.notify_one();
}

bool LineQueue::take(Batch& batch) {
    batch.clear();
    MutexHeld lock(_mutex);
    lock.wait(_changed, [this]() KELVO_NEEDS(_mutex) { return _batch.size() > 0 || _closed; });
    lock.waitFor(_changed, kGathering,
                 [this]() KELVO_NEEDS(_mutex) { return _batch.size() >= _length / 2 || _closed; });
    std::swap(batch, _batch);
    return batch.size() > 0;
}

void LineQueue::close() {
    {
        const MutexHeld lock(_mutex);
        _closed = true;
    }
    _changed.notify_one();
}

}  // namespace kelvo
