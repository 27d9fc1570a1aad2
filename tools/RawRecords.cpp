#include "tools/RawRecords.h"

namespace kelvo {

namespace {

constexpr std::size_t kPrefixLength = 2;
constexpr std::size_t kLengthEnd = 3;  // the log type and the length itself

/// How many bytes the message at the front of `bytes` takes up; 0 when it is not whole.
std::size_t firstMessageLength(ByteView bytes) {
    const std::size_t prefix = !bytes.empty() && bytes[0] == 0x81 ? kPrefixLength : 0;
    if (bytes.size() < prefix + kLengthEnd) return 0;
    const std::size_t recordLength = bytes[prefix + 1] | bytes[prefix + 2] << 8;
    const std::size_t length = prefix + 1 + recordLength;
    return recordLength >= 2 && length <= bytes.size() ? length : 0;
}

}  // namespace

RawRecords splitRawRecords(ByteView bytes) {
    RawRecords records;
    while (const std::size_t length = firstMessageLength(bytes)) {
        records.messages.push_back(bytes.first(length));
        bytes = bytes.subspan(length);
    }
    records.leftOver = bytes.size();
    return records;
}

}  // namespace kelvo
