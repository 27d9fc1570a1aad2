#include "ui/Figures.h"

#include <QFontMetricsF>
#include <algorithm>
#include <utility>

namespace kelvo {
namespace {

bool isDigit(QChar letter) { return letter >= u'0' && letter <= u'9'; }

}  // namespace

Figures::Figures(const QFont& font)
    : Figures([metrics = QFontMetricsF(font)](const QString& text) { return metrics.horizontalAdvance(text); }) {}

Figures::Figures(Advance advance) : _advance(std::move(advance)) {
    for (std::size_t digit = 0; digit < _digits.size(); ++digit) _digits[digit] = _advance(QString::number(digit));
    _cell = *std::max_element(_digits.begin(), _digits.end());
    _tabular = std::all_of(_digits.begin(), _digits.end(), [this](qreal digit) { return _cell - digit < 0.05; });
}

qreal Figures::set(const QString& text, const std::function<void(QString, qreal)>& place) const {
    qreal x = 0;
    for (qsizetype at = 0; at < text.size();) {
        if (!_tabular && isDigit(text[at])) {
            const qreal own = _digits[static_cast<std::size_t>(text[at].unicode() - u'0')];
            place(text.mid(at, 1), x + (_cell - own) / 2);
            x += _cell;
            ++at;
            continue;
        }
        const auto end = _tabular ? text.end() : std::find_if(text.begin() + at, text.end(), isDigit);
        const QString run = text.mid(at, end - (text.begin() + at));
        place(run, x);
        x += _advance(run);
        at += run.size();
    }
    return x;
}

std::vector<Figures::Piece> Figures::pieces(const QString& text) const {
    std::vector<Piece> pieces;
    set(text, [&](QString piece, qreal x) { pieces.push_back({std::move(piece), x}); });
    return pieces;
}

qreal Figures::width(const QString& text) const {
    return set(text, [](const QString&, qreal) {});
}

QString Figures::elided(const QString& text, qreal width) const {
    if (this->width(text) <= width) return text;
    const QChar ellipsis = u'\u2026';
    for (qsizetype length = text.size() - 1; length > 0; --length) {
        const QString shorter = text.left(length).trimmed() + ellipsis;
        if (this->width(shorter) <= width) return shorter;
    }
    return ellipsis;
}

}  // namespace kelvo
