#include "LogGenerator/FieldTable.h"

#include <algorithm>
#include <bit>
#include <charconv>
#include <cmath>
#include <cstring>

#include "LogGenerator/RowWriter.h"

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

/// The decimals of 0 to 7 eighths. With two of them 1/8 is 12.5 hundredths; the half goes to the even neighbor, as
/// printf rounds, and never past the next whole number.
constexpr std::string_view kHundredths[] = {"00", "12", "25", "38", "50", "62", "75", "88"};
constexpr std::string_view kThousandths[] = {"000", "125", "250", "375", "500", "625", "750", "875"};

/// A number of eighths with two or more decimals.
void printEighths(std::string& text, std::int64_t eighths, const NumberFormat& format) {
    const auto magnitude = static_cast<std::uint64_t>(eighths < 0 ? -eighths : eighths);
    printBetween(text, format, eighths < 0, [&](Line& line) {
        if (eighths < 0) line.append('-');
        line.appendNumber(magnitude / 8);
        line.append('.');
        line.append(format.precision == 2 ? kHundredths[magnitude % 8] : kThousandths[magnitude % 8]);
        for (int i = 3; i < format.precision; ++i) line.append('0');
    });
}

void printLabel(std::string& text, std::int64_t raw, const Shown& shown, const NumberFormat& fallback) {
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
    printInteger(text, raw, fallback);
}

}  // namespace

void print(std::string& text, std::int64_t raw, const Shown& shown) { print(text, raw, shown, shown.format); }

void print(std::string& text, std::int64_t raw, const Shown& shown, const NumberFormat& format) {
    if (raw == shown.exception) {
        text.assign(shown.exceptionText);
        return;
    }
    switch (shown.how) {
        case Shown::How::Nothing: break;
        case Shown::How::Decimal:
        case Shown::How::Unsigned: printInteger(text, raw, format); break;
        case Shown::How::Signed32: printInteger(text, static_cast<std::int32_t>(raw), format); break;
        case Shown::How::Label: printLabel(text, raw, shown, format); break;
        case Shown::How::Linear: print(text, shown.real(raw), format); break;
        case Shown::How::Eighths:
            if (format.precision < 2) return print(text, shown.real(raw), format);
            return printEighths(text, raw * shown.factor + shown.summand, format);
        case Shown::How::Whole: printInteger(text, raw * shown.factor + shown.summand, format); break;
    }
}

void print(std::string& text, double value, const NumberFormat& format) {
    printBetween(text, format, std::signbit(value),
                 [&](Line& line) { line.appendNumber(value, std::chars_format::fixed, format.precision); });
}

void showValue(Value& value, std::int64_t raw, const Shown& shown) {
    value.set({.raw = raw, .how = &shown, .print = [](std::string& text, std::int64_t number, const void* how) {
                   print(text, number, *static_cast<const Shown*>(how));
               }});
}

void showReal(Value& value, double number, const NumberFormat& format) {
    value.set({.raw = std::bit_cast<std::int64_t>(number),
               .how = &format,
               .print = [](std::string& text, std::int64_t bits, const void* how) {
                   print(text, std::bit_cast<double>(bits), *static_cast<const NumberFormat*>(how));
               }});
}

void showFields(Dictionary& shown, RecordView record, std::size_t base, std::span<const Field> fields) {
    std::size_t next = 0;
    for (const Field& field : fields) {
        const std::int64_t raw = record.read(base + field.at, field.raw);
        if (field.shown.leavesOut(raw)) {
            shown.remove(field.key);
        } else {
            showValue(shown.slot(field.key, next), raw, field.shown);
        }
    }
}

void showFields(Dictionary::Rewrite& row, RecordView record, std::size_t base, std::span<const Field> fields) {
    for (const Field& field : fields) {
        const std::int64_t raw = record.read(base + field.at, field.raw);
        if (!field.shown.leavesOut(raw)) showValue(row.next(field.key), raw, field.shown);
    }
}

void showValues(const ArrayRef& values, RecordView record, const RecordEntries& entries, Raw raw, const Shown& shown) {
    const ArrayLock::Held held;
    values->resize(entries.count());
    for (std::size_t i = 0; i < entries.count(); ++i) {
        showValue((*values)[i], record.read(entries.offsetOf(i), raw), shown);
    }
}

void showRows(const ArrayRef& list, ByteView data, const RecordEntries& entries, std::span<const Field> fields) {
    RowWriter rows(list);
    const RecordView record(data);
    const RecordEntries present = entries.within(data.size());
    for (std::size_t i = 0; i < present.count(); ++i) {
        Dictionary::Rewrite row = rows.next();
        showFields(row, record, present.offsetOf(i), fields);
    }
}

}  // namespace kelvo
