#include "ui/RecordDump.h"

#include <QStringList>
#include <algorithm>
#include <cstdint>

namespace kelvo {
namespace {

constexpr std::size_t kInLine = 8;
constexpr std::size_t kMostLines = 12;

struct Span {
    std::size_t begin;
    std::size_t end;
    bool has(std::size_t at) const { return at >= begin && at < end; }
};

Span fieldOf(const Place& place) {
    if (!place) return {0, 0};
    return {place.at(), place.at() + static_cast<std::size_t>(place.bytes())};
}

QString marked(const QString& text) { return QStringLiteral("<b><u>%1</u></b>").arg(text); }

QString lineAt(std::size_t begin, ByteView bytes, const Span& field) {
    QString line = QStringLiteral("%1:").arg(begin, 4, 10, QLatin1Char('0'));
    for (std::size_t at = begin; at < std::min(begin + kInLine, bytes.size()); ++at) {
        const QString byte = QStringLiteral("%1").arg(bytes[at], 2, 16, QLatin1Char('0'));
        line += QStringLiteral("&nbsp;") + (field.has(at) ? marked(byte) : byte);
    }
    return line;
}

/// The field's bytes in the order of their number, its own bits marked: the number's highest bit comes first.
QString bitsOf(ByteView bytes, const Place& place) {
    QString text;
    bool isMarked = false;
    const auto mark = [&](bool on) {
        if (isMarked != on) text += on ? QStringLiteral("<b><u>") : QStringLiteral("</u></b>");
        isMarked = on;
    };
    for (int bit = place.bytes() * 8 - 1; bit >= 0; --bit) {
        const int fromLow = bit / 8;
        const int inRecord = place.isBigEndian() ? place.bytes() - 1 - fromLow : fromLow;
        const std::size_t at = place.at() + static_cast<std::size_t>(inRecord);
        const unsigned byte = at < bytes.size() ? bytes[at] : 0;  // as it was read
        mark(bit >= place.lowBit() && bit < place.lowBit() + place.bits());
        text += (byte >> (bit % 8) & 1U) != 0 ? QLatin1Char('1') : QLatin1Char('0');
        if (bit % 8 == 0 && bit > 0) text += QStringLiteral("&nbsp;");
    }
    mark(false);
    return text;
}

}  // namespace

QString recordDump(ByteView bytes, const Place& place) {
    if (bytes.empty()) return {};
    const Span field = fieldOf(place);
    const std::size_t lines = (bytes.size() + kInLine - 1) / kInLine;
    const std::size_t ofField = std::min(field.begin / kInLine, lines - 1);
    const std::size_t first =
        lines <= kMostLines ? 0 : std::min(ofField - std::min(ofField, kMostLines / 2), lines - kMostLines);
    const std::size_t end = std::min(lines, first + kMostLines);
    QStringList shown;
    if (first > 0) shown.append(QStringLiteral("…"));
    for (std::size_t line = first; line < end; ++line) shown.append(lineAt(line * kInLine, bytes, field));
    if (end < lines) shown.append(QStringLiteral("…"));
    if (place && place.bits() < place.bytes() * 8) shown.append(bitsOf(bytes, place));
    return shown.join(QStringLiteral("<br>"));
}

QString placeText(ByteView bytes, const Place& place) {
    if (bytes.empty()) return {};
    if (!place) return QStringLiteral("%1 bytes").arg(bytes.size());
    QString text =
        place.bytes() == 1
            ? QStringLiteral("Byte %1 of %2").arg(place.at()).arg(bytes.size())
            : QStringLiteral("Bytes %1 to %2 of %3").arg(place.at()).arg(fieldOf(place).end - 1).arg(bytes.size());
    if (place.bits() == place.bytes() * 8) return text;
    const int last = place.lowBit() + place.bits() - 1;
    return text + (place.bits() == 1 ? QStringLiteral(", bit %1").arg(last)
                                     : QStringLiteral(", bits %1 to %2").arg(place.lowBit()).arg(last));
}

}  // namespace kelvo
