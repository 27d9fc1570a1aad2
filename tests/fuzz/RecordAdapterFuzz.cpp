// A modem may send any bytes as a record. The input is a row of packets with their lengths before them (u16). An
// adapter never crashes or reads outside a packet; what passes is what came in, and what it makes is a whole packet
// that passes.

#include "telephony/adaptation/AdaptationMeter.h"
#include "telephony/wire/LittleEndian.h"
#include "tests/fuzz/PropertyListRoundTrip.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace kelvo;
    using adaptation::Adapted;
    ByteView input(data, size);
    adaptation::RecordAdapter adapter;
    adaptation::RecordAdapter again;
    adaptation::AdaptationMeter meter;
    while (input.size() >= 2) {
        const std::size_t length = std::min<std::size_t>(wire::u16At(input, 0), input.size() - 2);
        const Bytes packet(input.begin() + 2, input.begin() + 2 + static_cast<std::ptrdiff_t>(length));
        input = input.subspan(2 + length);
        const Adapted adapted = adapter.adapt(packet);
        meter.count(adapted);
        if (adapted.outcome == Adapted::Outcome::Passed) {
            fuzz::require(adapted.packet.data() == packet.data() && adapted.packet.size() == packet.size(),
                          "what passes is another");
        }
        if (adapted.outcome != Adapted::Outcome::Turned) continue;
        fuzz::require(wire::u16At(adapted.packet, 1) + 1U == adapted.packet.size(), "a length that lies");
        const Bytes made(adapted.packet.begin(), adapted.packet.end());
        fuzz::require(again.adapt(made).outcome == Adapted::Outcome::Passed, "what was turned does not pass");
    }
    meter.lines();
    return 0;
}
