#include "tools/CapturePackets.h"

#include "platform/values/Dictionary.h"

namespace kelvo {

void update(LogGenerator& generator, Dictionary& state, RecordLedger& records, ByteView message,
            RecordLedger::Arrival arrival) {
    if (records.isFull()) records.forgetAllBut(state["Display"]);
    const ByteView packet = generator.takesPackets() ? RecordLedger::packetOf(message) : ByteView();
    const RecordLedger::Counted counted(records, packet, arrival);
    generator.updateState(state, message);
}

}  // namespace kelvo
