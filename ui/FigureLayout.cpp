#include "ui/FigureLayout.h"

#include <QFontMetricsF>
#include <cmath>

namespace kelvo {

void FigureLayout::setText(const QString& text) {
    if (_text == text) return;
    _text = text;
    layOut();
}

void FigureLayout::setFont(const QFont& font) {
    if (_font == font) return;
    _font = font;
    _figures = Figures(font);
    layOut();
}

void FigureLayout::setMaximumWidth(qreal width) {
    if (_maximumWidth == width) return;
    _maximumWidth = width;
    layOut();
}

void FigureLayout::layOut() {
    const QString shown = _maximumWidth > 0 ? _figures.elided(_text, _maximumWidth) : _text;
    _texts.clear();
    _positions.clear();
    for (const Figures::Piece& piece : _figures.pieces(shown)) {
        _texts.append(piece.text);
        _positions.append(piece.x);
    }
    _width = std::ceil(_figures.width(shown));
    _height = std::ceil(QFontMetricsF(_font).height());
    Q_EMIT changed();
}

}  // namespace kelvo
