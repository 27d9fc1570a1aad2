#pragma once

#include <QtQml/qqmlregistration.h>
#include <QColor>
#include <QPointer>
#include <QQuickPaintedItem>

#include "ui/OverviewMeasure.h"

namespace kelvo {

/// How the serving cell's level or quality has gone in the last two minutes, small: the line, the ends of its axis, and
/// where it begins and ends. Painted for the same reason as `TrendChart`.
class MeasureChart : public QQuickPaintedItem {
    Q_OBJECT
    QML_ELEMENT
    Q_PROPERTY(kelvo::OverviewMeasure* measure READ measure WRITE setMeasure NOTIFY measureChanged REQUIRED)
    Q_PROPERTY(QColor lineColor MEMBER _lineColor NOTIFY coloursChanged)
    Q_PROPERTY(QColor textColor MEMBER _textColor NOTIFY coloursChanged)
    Q_PROPERTY(QColor gridColor MEMBER _gridColor NOTIFY coloursChanged)
    Q_PROPERTY(QColor backgroundColor MEMBER _backgroundColor NOTIFY coloursChanged)
public:
    explicit MeasureChart(QQuickItem* parent = nullptr);

    OverviewMeasure* measure() const { return _measure; }
    void setMeasure(OverviewMeasure* measure);

    void paint(QPainter* painter) override;

Q_SIGNALS:
    void measureChanged();
    void coloursChanged();

private:
    QPointer<OverviewMeasure> _measure;
    QColor _lineColor = Qt::black;
    QColor _textColor = Qt::gray;
    QColor _gridColor = Qt::lightGray;
    QColor _backgroundColor = Qt::white;
};

}  // namespace kelvo
