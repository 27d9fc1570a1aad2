#include "tools/FollowedCapture.h"

#include <limits>

#include "LogGenerator/Factory.h"
#include "platform/system/Environment.h"
#include "platform/values/Dictionary.h"
#include "tools/CapturePackets.h"

namespace kelvo {

FollowedCapture followCapture(Input& input) {
    const Technology technology = input.technology();
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
    while (const auto packet = input.next()) {
        followed.end = std::chrono::floor<std::chrono::microseconds>(packet->time);
        orTell(input.name(), input.count(),
               [&] { update(*generator, *state, records, packet->bytes, packet->time.time_since_epoch()); });
        followed.tracker.note(overview::observe(technology, (*state)["Display"]), followed.end);
    }
    followed.messages = input.count();
    followed.breakOff = input.breakOff();
    if (followed.breakOff && followed.messages == 0) throw CommandFailure(*followed.breakOff);
    return followed;
}

}  // namespace kelvo
