// A modem may answer anything at any time. The input is a row of frame bodies with their lengths before them (u16); an
// empty one lets time pass. The session never crashes or reads outside a frame, hands over whole records only, and ends
// in silence within two seconds.

#include "telephony/wire/Session.h"

#include "telephony/wire/FrameWriter.h"
#include "telephony/wire/LittleEndian.h"
#include "tests/fuzz/PropertyListRoundTrip.h"

namespace {

using namespace kelvo;
using namespace std::chrono_literals;

struct Owner final : wire::Session::Owner {
    void sendToModem(ByteView bytes) override { fuzz::require(bytes.back() == 0x7E, "half a frame was sent"); }
    wire::Session::Taken takeRecord(ByteView packet, std::uint64_t) override {
        fuzz::require(packet.size() >= 13 && packet[0] == 1, "a record that is no packet");
        fuzz::require(wire::u16At(packet, 1) + 1U == packet.size(), "a record whose length lies");
        return wire::Session::Taken::Delivered;
    }
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    ByteView input(data, size);
    Owner owner;
    std::chrono::nanoseconds now = 1000s;
    wire::Session session(owner, [&now] { return now; }, {});
    wire::RecordCodes codes;
    for (const LogCode code : {0xB0C2U, 0xB17FU, 0x5134U, 0x119CU}) codes.set(code);
    session.want(codes);
    session.begin("port");
    now += 200ms;
    session.tick();
    while (input.size() >= 2) {
        const std::size_t length = std::min<std::size_t>(wire::u16At(input, 0), input.size() - 2);
        Bytes frame = wire::frameOf(input.subspan(2, length));
        input = input.subspan(2 + length);
        if (length > 0) {
            session.receive(frame);
        } else if (const auto deadline = session.deadline()) {
            now = std::max(now, *deadline);
            session.tick();
        }
        const auto& counts = session.counts();
        fuzz::require(counts.records == counts.delivered + counts.otherSubscriptions, "a record went missing");
    }
    session.end();
    now += 2s;
    session.tick();
    fuzz::require(session.state() == wire::Session::State::Closed, "the session does not end");
    return 0;
}
