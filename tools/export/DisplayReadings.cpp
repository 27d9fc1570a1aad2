#include "tools/export/DisplayReadings.h"

#include "LogGenerator/RecordLedger.h"

namespace kelvo {

DisplayReadings::DisplayReadings(Technology technology, const Choice& choice, ValueGlobs& globs, ReadingRows& rows)
    : _rows(rows),
      _written(technology, [&globs](const std::string& path) { return globs.want(path); }),
      _chosen(choice, rows) {}

void DisplayReadings::take(const Moment& moment, const Value& display) {
    if (!_chosen.wants(moment.time)) return;
    _chosen.take(moment, _written.by(moment.record, display));
    if (_written.isFull()) end();
}

void DisplayReadings::end() {
    _chosen.endInterval();
    _rows.letSeriesGo();
    _written.forget();
}

std::optional<LogCode> codeOf(Technology technology, ByteView message) {
    const ByteView packet = hasCodes(technology) ? RecordLedger::packetOf(message) : ByteView();
    return packet.empty() ? std::nullopt : std::optional(logCode(packet.data()));
}

}  // namespace kelvo
