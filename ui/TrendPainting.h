#pragma once

#include <QColor>
#include <QList>
#include <QRectF>
#include <QString>
#include <span>
#include <vector>

#include "model/LevelGrades.h"
#include "ui/AxisSteps.h"
#include "ui/DetailsController.h"
#include "ui/TrendView.h"

class QPainter;

namespace kelvo {

/// One painting of a chart. What distinguishes things is never colour alone: grades have their names, the other value's
/// line is dashed, marks say which cell.
class TrendPainting {
public:
    // Around the lines, in pixels: values left, cells above, times below.
    static constexpr qreal kLeft = 44;
    static constexpr qreal kRight = 10;
    static constexpr qreal kTop = 18;
    static constexpr qreal kBottom = 20;

    // Around a small chart's line: the ends of its axis right, its two times below.
    static constexpr qreal kSmallRight = 34;
    static constexpr qreal kSmallTop = 8;
    static constexpr qreal kSmallBottom = 18;

    struct Colors {
        QColor line, other, text, grid, background;
    };

    TrendPainting(QPainter& painter, QSizeF size, QRectF area, const TrendView& view, const Colors& colors);

    /// `cursor` may be null.
    void paint(const DetailsController& details, const Trend::Point* cursor);
    /// One line alone, for a glance: which way it goes, between what, and where another cell began to serve.
    void paintSmall(const Trend& trend, const std::vector<TrendChange>& servingCells);

private:
    AxisRange axisOf(std::span<const Trend* const> trends, double shortest = 0) const;
    void paintGrades(std::span<const LevelGrade> grades);
    void paintValueAxis(const AxisRange& axis, bool right);
    void paintTimeAxis();
    void paintServingCells(const std::vector<TrendChange>& changes);
    void paintLine(const Trend& trend, const AxisRange& axis, const QColor& color, bool dashed);
    void paintStrokes(const QList<QLineF>& lines, const QColor& color, bool dashed);
    void paintDot(QPointF at, const QColor& color);
    void paintCursor(const Trend::Point& point);
    qreal xOf(Trend::Time time) const { return _area.left() + _view.shareOf(time) * _area.width(); }
    QPointF placeOf(const Trend::Point& point, const AxisRange& axis) const {
        return {xOf(point.at), yOf(point.number, axis)};
    }
    qreal yOf(double number, const AxisRange& axis) const {
        return _area.bottom() - (number - axis.low) / (axis.high - axis.low) * _area.height();
    }

    QPainter& _painter;
    const QSizeF _size;
    const QRectF _area;
    const TrendView& _view;
    const Colors& _colors;
    AxisRange _axis{0, 1, 1};
};

}  // namespace kelvo
