#include "ui/Glyph.h"

#include <QPainter>
#include <QPolygonF>

namespace kelvo {
namespace {

/// Strokes through points of a 16 by 16 square.
QPolygonF strokeOf(Glyph::Shape shape) {
    switch (shape) {
        case Glyph::Shape::Disclosure: return QPolygonF({{6, 3.5}, {10.5, 8}, {6, 12.5}});
        case Glyph::Shape::Back: return QPolygonF({{10.5, 2}, {4.5, 8}, {10.5, 14}});
        case Glyph::Shape::Check: return QPolygonF({{2.5, 8.5}, {6, 12}, {13.5, 4.5}});
    }
    return {};
}

}  // namespace

Glyph::Glyph(QQuickItem* parent) : QQuickPaintedItem(parent) {
    setAntialiasing(true);
    setImplicitSize(16, 16);
}

void Glyph::setShape(Shape shape) {
    if (_shape == shape) return;
    _shape = shape;
    update();
    Q_EMIT appearanceChanged();
}

void Glyph::setColor(const QColor& color) {
    if (_color == color) return;
    _color = color;
    update();
    Q_EMIT appearanceChanged();
}

void Glyph::paint(QPainter* painter) {
    painter->scale(width() / 16, height() / 16);
    painter->setPen(QPen(_color, 1.8, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    painter->drawPolyline(strokeOf(_shape));
}

}  // namespace kelvo
