#include "tools/export/TextRows.h"

#include <cstring>

#include "tools/CommandFailure.h"

namespace kelvo {

namespace {

constexpr std::size_t kRendered = 16'384;  // a power of two; about a megabyte

std::size_t placeOf(const Reading& reading) {
    const auto quantity = reinterpret_cast<std::uintptr_t>(reading.quantity);
    const std::uint64_t mixed = (static_cast<std::uint64_t>(reading.raw) ^ quantity) * 0x9E3779B97F4A7C15;
    return mixed >> 50;  // 14 bits
}
static_assert(kRendered == std::size_t{1} << 14);

}  // namespace

TextRows::TextRows(std::unique_ptr<Notation> notation, OutputThread& output)
    : _notation(std::move(notation)), _output(output), _rows(_notation->heading()), _readings(kRendered) {}

void TextRows::write(const Moment& moment, std::span<const Written> readings) {
    if (readings.empty()) return;
    _start.clear();
    _end.clear();
    _notation->appendStart(_start, moment, _time.of(moment.time));
    _notation->appendEnd(_end, moment);
    for (const auto& [series, value] : readings) {
        if (series->rendered.empty()) _notation->appendSeries(series->rendered, *series);
        const std::string& reading = rendered(*value);
        _rows.append(_start).append(series->rendered).append(reading).append(_end);
    }
    orFail(_output.append(_rows));
    _rows.clear();
}

void TextRows::finish() {
    orFail(_output.append(_rows));  // the heading, when there was no reading
    _rows.clear();
    orFail(_output.finish());
}

const std::string& TextRows::rendered(const Value& value) {
    const Reading* reading = value.reading();
    if (reading == nullptr) {
        _otherText.clear();
        _notation->appendReading(_otherText, *value.string(), std::nullopt);
        return _otherText;
    }
    Rendered& known = _readings[placeOf(*reading)];
    if (known.quantity != reading->quantity || known.raw != reading->raw) {
        known.raw = reading->raw;
        known.quantity = reading->quantity;
        known.text.clear();
        _notation->appendReading(known.text, *value.string(), measurementOf(value));
    }
    return known.text;
}

}  // namespace kelvo
