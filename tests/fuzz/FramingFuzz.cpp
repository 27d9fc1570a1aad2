// Any bytes may come as a message; every view of it lies inside it, and raw records split apart are what was put
// together.

#include "LogGenerator/Framing.h"

#include <algorithm>

#include "tests/fuzz/PropertyListRoundTrip.h"
#include "tools/RawRecords.h"

namespace {

using namespace kelvo;

bool liesIn(ByteView part, ByteView whole) {
    return part.empty() || (part.data() >= whole.data() && part.data() + part.size() <= whole.data() + whole.size());
}

void checkFraming(ByteView message) {
    const ByteView packet = stripPrefix(message);
    fuzz::require(liesIn(packet, message), "a packet outside its message");
    fuzz::require(message.size() - packet.size() <= 2, "more than a prefix was taken off");
    fuzz::require(liesIn(payloadOf(packet), packet), "a payload outside its packet");
    if (packet.size() < 5) return;
    const LogCode code = logCode(packet.data());
    fuzz::require((code >= kExtendedLogCodes) == (packet[0] == 255), "a code in the wrong code space");
}

void checkSplitting(ByteView bytes) {
    const RawRecords records = splitRawRecords(bytes);
    Bytes joined;
    for (const ByteView record : records.messages) {
        fuzz::require(record.size() >= 3, "a record without a length");
        joined.insert(joined.end(), record.begin(), record.end());
    }
    fuzz::require(joined.size() + records.leftOver == bytes.size(), "bytes were lost or made up");
    fuzz::require(std::equal(joined.begin(), joined.end(), bytes.begin()), "records that are not the bytes");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    checkFraming({data, size});
    checkSplitting({data, size});
    return 0;
}
