#include "tools/FollowedCapture.h"

#include <limits>

#include "LogGenerator/Factory.h"
#include "platform/system/Environment.h"
#include "platform/values/Dictionary.h"
#include "tools/CapturePackets.h"

namespace kelvo {

FollowedCapture followCapture(const std::string& path, CaptureReader& reader, Technology technology) {
    Environment silent = Environment::current();
    silent.log = nullptr;
    const Environment::Scope scope(silent);
    const auto generator = generatorFromTechnology(namesOf(technology).identifier);
    generator->limitRawLog(0);
    const DictionaryRef state = Dictionary::make();
    RecordLedger records;
    FollowedCapture followed;
    followed.tracker =
        overview::Tracker({.events = std::numeric_limits<std::size_t>::max(), .span = overview::Time::duration::max()});
    for (;;) {
        const auto next = reader.next();
        if (!next) followed.breakOff = next.error();
        if (!next || !*next) break;
        const CapturePacket& packet = **next;
        ++followed.messages;
        followed.end = std::chrono::floor<std::chrono::microseconds>(packet.time);
        orTell(path, followed.messages,
               [&] { update(*generator, *state, records, packet.bytes, packet.time.time_since_epoch()); });
        followed.tracker.note(overview::observe(technology, (*state)["Display"]), followed.end);
    }
    if (followed.breakOff && followed.messages == 0) throw CommandFailure(*followed.breakOff);
    return followed;
}

}  // namespace kelvo
