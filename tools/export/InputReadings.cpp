#include "tools/export/InputReadings.h"

#include <algorithm>

#include "LogGenerator/Factory.h"
#include "LogGenerator/RecordBeingShown.h"
#include "platform/system/Environment.h"
#include "tools/CapturePackets.h"
#include "tools/export/DisplayReadings.h"

namespace kelvo {

ReadInput readReadings(Input& input, std::size_t number, const Choice& choice, ValueGlobs& globs, ReadingRows& rows,
                       const std::function<bool()>& goesOn) {
    Environment silent = Environment::current();
    silent.log = nullptr;
    const Environment::Scope scope(silent);
    const Technology technology = input.technology();
    const auto generator = generatorFromTechnology(namesOf(technology).identifier);
    generator->limitRawLog(0);
    const DictionaryRef state = Dictionary::make();
    DisplayReadings readings(technology, choice, globs, rows);
    ReadInput read{.number = number, .name = input.name(), .technology = technology};
    while (goesOn()) {
        const auto packet = input.next();
        if (!packet) break;
        try {
            orTell(input.name(), input.count(), [&] {
                const RecordBeingShown::Scope shown(input.count());
                generator->updateState(*state, packet->bytes);
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
                      (*state)["Display"]);
    }
    readings.end();
    if (input.breakOff() && goesOn()) read.breakOff = input.breakOff()->reason;
    rows.endInput(read);
    return read;
}

}  // namespace kelvo
