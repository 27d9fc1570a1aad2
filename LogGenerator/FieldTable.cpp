#include "LogGenerator/FieldTable.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstring>

namespace kelvo {

namespace {

/// A text under construction on the stack; longer than any number with the texts around it.
class Line {
public:
    void append(std::string_view text) {
        const std::size_t length = std::min(text.size(), room());
        std::memcpy(_end, text.data(), length);
        _end += length;
    }
    void append(char c) { append(std::string_view(&c, 1)); }
    template <class... How>
    void appendNumber(How... how) {
        _end = std::to_chars(_end, _text.data() + _text.size(), how...).ptr;
    }
    /// Pads what was written since `from` on its left.
    void padSince(std::size_t from, int width, char filler) {
        const std::size_t length = size() - from;
        if (length >= static_cast<std::size_t>(width)) return;
        const std::size_t missing = std::min(static_cast<std::size_t>(width) - length, room());
        std::memmove(_text.data() + from + missing, _text.data() + from, length);
        std::memset(_text.data() + from, filler, missing);
        _end += missing;
    }
    std::size_t size() const { return static_cast<std::size_t>(_end - _text.data()); }
    std::string_view text() const { return {_text.data(), size()}; }

private:
    std::size_t room() const { return _text.size() - size(); }

    std::array<char, 512> _text;  // a double without an exponent takes at most 309 digits before its point
    char* _end = _text.data();
};

template <class Digits>
void printBetween(std::string& text, const NumberFormat& format, bool negative, Digits digits) {
    Line line;
    line.append(format.before);
    const std::size_t from = line.size();
    if (format.plus && !negative) line.append('+');
    digits(line);
    line.padSince(from, format.width, format.zeros ? '0' : ' ');
    line.append(format.after);
    text.assign(line.text());
}

void printInteger(std::string& text, std::int64_t value, const NumberFormat& format) {
    if (format.conversion == 0) {
        text.assign(format.before);
        return;
    }
    if (format.conversion == 'x') {
        printBetween(text, format, false,
                     [value](Line& line) { line.appendNumber(static_cast<std::uint64_t>(value), 16); });
        return;
    }
    printBetween(text, format, value < 0, [value](Line& line) { line.appendNumber(value); });
}

/// Two decimals of a number of eighths. 1/8 is 12.5 hundredths; the half goes to the even neighbour, as printf rounds.
void printEighths(std::string& text, std::int64_t eighths, const NumberFormat& format) {
    const std::uint64_t magnitude = static_cast<std::uint64_t>(eighths < 0 ? -eighths : eighths);
    const std::uint64_t doubled = magnitude * 25;  // twice the hundredths
    std::uint64_t hundredths = doubled / 2;
    if (doubled % 2 == 1 && hundredths % 2 == 1) ++hundredths;
    printBetween(text, format, eighths < 0, [&](Line& line) {
        if (eighths < 0) line.append('-');
        line.appendNumber(hundredths / 100);
        const std::uint64_t rest = hundredths % 100;
        line.append('.');
        line.append(static_cast<char>('0' + rest / 10));
        line.append(static_cast<char>('0' + rest % 10));
    });
}

void printLabel(std::string& text, std::int64_t raw, const Shown& shown) {
    const auto value = static_cast<std::uint32_t>(raw);
    if (value < shown.rows.size() && shown.rows[value].raw == value) {  // a table without gaps
        text.assign(shown.rows[value].text);
        return;
    }
    for (const ValueRow& row : shown.rows) {
        if (row.raw == value) {
            text.assign(row.text);
            return;
        }
    }
    printInteger(text, raw, shown.format);
}

}  // namespace

void print(std::string& text, std::int64_t raw, const Shown& shown) {
    if (raw == shown.exception) {
        text.assign(shown.exceptionText);
        return;
    }
    switch (shown.how) {
        case Shown::How::Nothing: break;
        case Shown::How::Decimal:
        case Shown::How::Unsigned: printInteger(text, raw, shown.format); break;
        case Shown::How::Signed32: printInteger(text, static_cast<std::int32_t>(raw), shown.format); break;
        case Shown::How::Label: printLabel(text, raw, shown); break;
        case Shown::How::Linear: print(text, shown.real(raw), shown.format); break;
        case Shown::How::Eighths: printEighths(text, raw * shown.factor + shown.summand, shown.format); break;
        case Shown::How::Whole: printInteger(text, raw * shown.factor + shown.summand, shown.format); break;
    }
}

void print(std::string& text, double value, const NumberFormat& format) {
    printBetween(text, format, std::signbit(value),
                 [&](Line& line) { line.appendNumber(value, std::chars_format::fixed, format.precision); });
}

void showFields(Dictionary& shown, RecordView record, std::size_t base, std::span<const Field> fields) {
    for (const Field& field : fields) {
        const std::int64_t raw = record.read(base + field.at, field.raw);
        if (field.shown.leavesOut(raw)) {
            shown.remove(field.key);
        } else {
            print(shown.slot(field.key).text(), raw, field.shown);
        }
    }
}

std::vector<Value> rowsOf(ByteView data, const RecordEntries& entries, std::span<const Field> fields) {
    std::vector<Value> rows;
    const RecordView record(data);
    for (std::size_t i = 0; i < entries.count() && entries.offsetOf(i) < data.size(); ++i) {
        const DictionaryRef row = Dictionary::make();
        row->reserve(fields.size());
        showFields(*row, record, entries.offsetOf(i), fields);
        rows.emplace_back(row);
    }
    return rows;
}

}  // namespace kelvo
