#pragma once

#include <cstddef>
#include <deque>
#include <utility>

#include "platform/values/Bytes.h"

namespace kelvo {

/// Records that wait for a client that does not read them fast enough. Bounded: the oldest make room for the newest.
class ClientQueue {
public:
    struct Limits {
        std::size_t records = 32'768;
        std::size_t bytes = std::size_t{4} * 1024 * 1024;
    };

    explicit ClientQueue(Limits limits) : _limits(limits) {}

    bool empty() const { return _records.empty(); }
    std::size_t size() const { return _records.size(); }
    ByteView front() const { return _records.front(); }
    void pop();
    /// Appends a copy; what no longer fits is lost, from the oldest on (a record beyond the limits goes itself).
    void push(ByteView record);
    /// How many records were lost since the last call.
    std::size_t takeLost() { return std::exchange(_lost, 0); }
    /// How many records were lost in all.
    std::size_t lostInAll() const { return _lostInAll; }

private:
    const Limits _limits;
    std::deque<Bytes> _records;
    std::size_t _bytes = 0;
    std::size_t _lost = 0;
    std::size_t _lostInAll = 0;
};

}  // namespace kelvo
