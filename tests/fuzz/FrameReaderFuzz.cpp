// Any bytes may come from a modem. Wherever they are cut into reads, the same frames are found and the same damage is
// counted; no more than one frame is kept; and what is written as a frame is read as it was.

#include "telephony/wire/FrameReader.h"

#include <algorithm>
#include <vector>

#include "telephony/wire/FrameWriter.h"
#include "telephony/wire/RecordFrame.h"
#include "tests/fuzz/PropertyListRoundTrip.h"

namespace {

using namespace kelvo;

struct Found {
    std::vector<Bytes> bodies;
    wire::FrameReader::Counts counts;
};

// `step` bytes a read, which changes from one to the next; 0: all at once.
Found read(ByteView stream, std::size_t step) {
    wire::FrameReader reader;
    Found found;
    std::size_t size = step == 0 ? stream.size() : step;
    while (!stream.empty()) {
        Bytes copy(stream.begin(), stream.begin() + static_cast<std::ptrdiff_t>(std::min(size, stream.size())));
        stream = stream.subspan(copy.size());
        size = size % 7 + step;
        wire::MutableBytes input = copy;
        while (const auto body = reader.next(input)) {
            found.bodies.emplace_back(body->begin(), body->end());
            if (wire::parseRecord(*body)) wire::packetOf(*body);
        }
        fuzz::require(input.empty(), "bytes were left over");
    }
    reader.reset();
    found.counts = reader.counts();
    return found;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const ByteView stream(data, size);
    const Found whole = read(stream, 0);
    for (const std::size_t step : {1U, 2U, 5U}) {
        const Found cut = read(stream, step);
        fuzz::require(cut.bodies == whole.bodies, "other frames where reads are cut");
        fuzz::require(cut.counts == whole.counts, "other counts where reads are cut");
    }
    fuzz::require(whole.counts.bytes == size, "bytes were not counted");
    if (size > 0 && size < 65'536) {
        const Found one = read(wire::frameOf(stream), 3);
        fuzz::require(one.bodies.size() == 1 && std::ranges::equal(one.bodies[0], stream),
                      "a frame that is not the body");
    }
    return 0;
}
