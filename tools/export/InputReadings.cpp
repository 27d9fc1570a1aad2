#include "tools/export/InputReadings.h"

#include <algorithm>

#include "LogGenerator/RecordBeingShown.h"
#include "tools/CapturePackets.h"
#include "tools/QuietDecoder.h"
#include "tools/export/DisplayReadings.h"

namespace kelvo {

ReadInput readReadings(Input& input, std::size_t number, const Choice& choice, ValueGlobs& globs, ReadingRows& rows,
                       const std::function<bool()>& goesOn) {
    const Technology technology = input.technology();
    const QuietDecoder decoder(technology);
    DisplayReadings readings(technology, choice, globs, rows);
    ReadInput read{.number = number, .name = input.name(), .technology = technology};
    while (goesOn()) {
        const auto packet = input.next();
        if (!packet) break;
        try {
            orTell(input.name(), input.count(), [&] {
                const RecordBeingShown::Scope shown(input.count());
                decoder.generator().updateState(decoder.state(), packet->bytes);
            });
        } catch (const CommandFailure& end) {
            read.breakOff = end.what();
            break;
        }
        read.records = input.count();
        read.first = std::min(packet->time, read.first.value_or(packet->time));
        read.last = std::max(packet->time, read.last.value_or(packet->time));
        readings.take({.time = packet->time,
                       .technology = technology,
                       .code = codeOf(technology, packet->bytes),
                       .record = input.count(),
                       .input = number},
                      decoder.display());
    }
    readings.end();
    if (input.breakOff() && goesOn()) read.breakOff = input.breakOff()->reason;
    rows.endInput(read);
    return read;
}

}  // namespace kelvo
