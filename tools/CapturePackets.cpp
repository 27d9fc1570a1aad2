#include "tools/CapturePackets.h"

#include "platform/values/Dictionary.h"

namespace kelvo {

Technology technologyOf(const std::string& path, std::optional<Technology> chosen, const CaptureReader& reader) {
    const auto technology = chosen ? chosen : reader.technology();
    if (technology) return *technology;
    throw CommandFailure(path + " has a link type that names no technology; --technology names one");
}

void update(LogGenerator& generator, Dictionary& state, RecordLedger& records, ByteView message,
            RecordLedger::Arrival arrival) {
    if (records.isFull()) records.forgetAllBut(state["Display"]);
    const ByteView packet = generator.takesPackets() ? RecordLedger::packetOf(message) : ByteView();
    const RecordLedger::Counted counted(records, packet, arrival);
    generator.updateState(state, message);
}

}  // namespace kelvo
