#pragma once

#include <QtQml/qqmlregistration.h>
#include <QColor>
#include <QQuickPaintedItem>

namespace kelvo {

/// A small drawn sign, stroked in one colour and as sharp as the screen allows.
class Glyph : public QQuickPaintedItem {
    Q_OBJECT
    QML_ELEMENT
    Q_PROPERTY(Shape shape READ shape WRITE setShape NOTIFY appearanceChanged)
    Q_PROPERTY(QColor color READ color WRITE setColor NOTIFY appearanceChanged)
public:
    enum class Shape { Disclosure, Back, Check };
    Q_ENUM(Shape)

    explicit Glyph(QQuickItem* parent = nullptr);

    Shape shape() const { return _shape; }
    void setShape(Shape shape);
    QColor color() const { return _color; }
    void setColor(const QColor& color);

    void paint(QPainter* painter) override;

Q_SIGNALS:
    void appearanceChanged();

private:
    Shape _shape = Shape::Disclosure;
    QColor _color = Qt::black;
};

}  // namespace kelvo
