// Any bytes may come as records, as a cell monitor's tree and as a snapshot: what is shared of them is whole and can
// be shared again.

#include "LogGenerator/Framing.h"
#include "telephony/wire/LittleEndian.h"
#include "tests/fuzz/Messages.h"
#include "tests/fuzz/PropertyListRoundTrip.h"
#include "tools/share/SharedSnapshot.h"

namespace {

using namespace kelvo;

void shareRecord(RecordSharer& sharer, RecordSharer& again, ByteView message) {
    const Bytes exact(message.begin(), message.end());
    const auto shared = sharer.shareRecord(exact);
    if (!shared) return;
    const ByteView packet = stripPrefix(*shared);
    fuzz::require(packet.size() >= kMinimumMessageSize, "half a record");
    fuzz::require(wire::u16At(packet, 1) + 1U == packet.size(), "a record of another length");
    const Bytes copy(shared->begin(), shared->end());
    fuzz::require(again.shareRecord(copy).has_value(), "what was shared cannot be shared");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const Pseudonyms::Secret kSecret = Pseudonyms::secretOf("a fuzz target");
    const ByteView bytes(data, size);
    const ShareChoices choices{.hideCells = size % 2 == 0, .hideApns = size % 3 == 0, .shiftTimes = size % 5 == 0};
    RecordSharer sharer(choices, kSecret);
    RecordSharer again(choices, kSecret);
    fuzz::forEachMessage(bytes, [&](ByteView message) {
        shareRecord(sharer, again, message);
        if (const auto tree = sharer.shareTree(message)) {
            const Bytes copy(tree->begin(), tree->end());
            fuzz::require(again.shareTree(copy).has_value(), "a shared tree cannot be shared");
        }
    });
    const Result<Value> snapshot = readPropertyList(bytes);
    const SharedSnapshot shared = snapshot ? sharedSnapshot(sharer, *snapshot) : SharedSnapshot();
    if (shared.content) fuzz::require(static_cast<bool>(writeXmlPropertyList(shared.content)), "it cannot be written");
    fuzz::require(shared.records <= shared.read, "more records than there were");
    return 0;
}
