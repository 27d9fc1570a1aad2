#include "tools/FollowedCapture.h"

#include <limits>

#include "tools/CapturePackets.h"
#include "tools/QuietDecoder.h"

namespace kelvo {

FollowedCapture followCapture(Input& input) {
    const Technology technology = input.technology();
    const QuietDecoder decoder(technology);
    RecordLedger records;
    FollowedCapture followed;
    followed.tracker =
        overview::Tracker({.events = std::numeric_limits<std::size_t>::max(), .span = overview::Time::duration::max()});
    while (const auto packet = input.next()) {
        followed.end = std::chrono::floor<std::chrono::microseconds>(packet->time);
        orTell(input.name(), input.count(), [&] {
            update(decoder.generator(), decoder.state(), records, packet->bytes, packet->time.time_since_epoch());
        });
        followed.tracker.note(overview::observe(technology, decoder.display()), followed.end);
    }
    followed.messages = input.count();
    followed.breakOff = input.breakOff();
    if (followed.breakOff && followed.messages == 0) throw CommandFailure(*followed.breakOff);
    return followed;
}

}  // namespace kelvo
