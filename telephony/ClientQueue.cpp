#include "telephony/ClientQueue.h"

namespace kelvo {

void ClientQueue::pop() {
    _bytes -= _records.front().size();
    _records.pop_front();
}

void ClientQueue::push(ByteView record) {
    _records.emplace_back(record.begin(), record.end());
    _bytes += record.size();
    while (_records.size() > _limits.records || _bytes > _limits.bytes) {
        pop();
        ++_lost;
        ++_lostInAll;
    }
}

}  // namespace kelvo
