// Any bytes may come as a datagram; one that is accepted is whole, and the same header says it again.

#include "platform/host/PortDatagram.h"

#include <algorithm>
#include <cstring>

#include "tests/fuzz/PropertyListRoundTrip.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace kelvo;
    const auto parsed = parsePortDatagram({data, size});
    if (!parsed) {
        fuzz::require(!parsed.error().reason.empty(), "refused without a reason");
        return 0;
    }
    Bytes again(sizeof parsed->header);
    std::memcpy(again.data(), &parsed->header, sizeof parsed->header);
    again.insert(again.end(), parsed->data.begin(), parsed->data.end());
    fuzz::require(std::equal(again.begin(), again.end(), data, data + size), "a datagram that was read as another");
    return 0;
}
