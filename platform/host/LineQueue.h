#pragma once

#include <condition_variable>
#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "platform/system/Mutex.h"
#include "platform/system/SystemLog.h"

namespace kelvo {

/// Lines on their way to the thread that writes them out. One thread adds, another takes; adding a line costs a copy of
/// its text and never waits for the taker, and the taker is woken once for many lines.
class LineQueue {
public:
    /// Lines in their order, side by side in one text.
    class Batch {
    public:
        std::size_t size() const { return _lines.size() - _dropped; }
        std::size_t lost() const { return _lost; }  ///< lines that had to make room since the batch before

        /// Calls `write(level, text)` for each line, the oldest first.
        template <class Write>
        void forEach(Write write) const {
            const char* at = _text.data() + _droppedText;
            for (std::size_t i = _dropped; i < _lines.size(); at += _lines[i++].size) {
                write(_lines[i].level, std::string_view(at, _lines[i].size));
            }
        }

    private:
        friend class LineQueue;
        struct Line {
            Level level;
            std::size_t size;
        };
        void add(Level level, std::string_view text);
        void dropOldest();
        void clear();

        std::string _text;
        std::vector<Line> _lines;
        std::size_t _dropped = 0;      // of _lines, and
        std::size_t _droppedText = 0;  // their part of _text: cut off now and then
        std::size_t _lost = 0;
    };

    /// Holds `length` lines; in an overflow the oldest go.
    explicit LineQueue(std::size_t length) : _length(length) {}

    void add(Level level, std::string_view text);
    /// Fills `batch` with all lines there are. Waits for the first, and then a moment for others to gather. False when
    /// the queue is closed and empty.
    bool take(Batch& batch);
    /// Ends the waiting: what is there is taken at once.
    void close();

private:
    const std::size_t _length;
    Mutex _mutex;
    std::condition_variable _changed;
    Batch _batch KELVO_GUARDED_BY(_mutex);
    bool _closed KELVO_GUARDED_BY(_mutex) = false;
};

}  // namespace kelvo
