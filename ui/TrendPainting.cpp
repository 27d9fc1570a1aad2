#include "ui/TrendPainting.h"

#include <QFontMetricsF>
#include <QLineF>
#include <QPainter>
#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <vector>

#include "model/TrendWords.h"

namespace kelvo {

using namespace std::chrono_literals;

namespace {

constexpr int kFontPixels = 11;
constexpr qreal kLineWidth = 2;

QString shown(std::string_view text) { return QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size())); }

QColor faint(QColor color, float opacity) {
    color.setAlphaF(opacity);
    return color;
}

/// The time between two lines of the grid, so that no more than six fit.
Trend::Time timeStep(Trend::Time span) {
    for (const Trend::Time step : {Trend::Time(5s), Trend::Time(10s), Trend::Time(30s), Trend::Time(1min),
                                   Trend::Time(2min), Trend::Time(5min)}) {
        if (span / step <= 6) return step;
    }
    return 10min;
}

QString beforeNow(Trend::Time time) {
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(time).count();
    if (seconds == 0) return QStringLiteral("now");
    return seconds % 60 == 0 ? QStringLiteral("-%1 min").arg(seconds / 60) : QStringLiteral("-%1 s").arg(seconds);
}

/// A line through many points, as upright strokes side by side, each as thick as the line and as high as what the line
/// passes through in its column of pixels. Strokes cost next to nothing, where a drawn line costs by its length.
class Strokes {
public:
    /// Columns are `width` wide, the first at `left`.
    Strokes(qreal left, qreal width, std::size_t columns) : _left(left), _width(width), _columns(columns) {}

    void add(QPointF from, QPointF to) {
        const double perX = to.x() > from.x() ? (to.y() - from.y()) / (to.x() - from.x()) : 0;
        const auto at = [&](double x) { return from.y() + (x - from.x()) * perX; };
        const double end = columnOf(to.x());
        for (double column = std::max(0.0, columnOf(from.x())); column <= end; ++column) {
            if (column >= static_cast<double>(_columns.size())) return;
            const double left = _left + column * _width;
            Column& reached = _columns[static_cast<std::size_t>(column)];
            reached.include(left > from.x() ? at(left) : from.y());
            reached.include(left + _width < to.x() ? at(left + _width) : to.y());
        }
    }
    void paint(QPainter& painter, const QColor& color, bool dashed) const {
        constexpr double kDash = 6;  // pixels, and two thirds of it until the next
        for (std::size_t i = 0; i < _columns.size(); ++i) {
            const Column& column = _columns[i];
            const double x = static_cast<double>(i) * _width;
            if (column.least > column.most || (dashed && std::fmod(x, kDash * 5 / 3) >= kDash)) continue;
            const double height = column.most - column.least + kLineWidth;
            painter.fillRect(QRectF(_left + x, column.least - kLineWidth / 2, _width, height), color);
        }
    }

private:
    struct Column {
        double least = std::numeric_limits<double>::infinity();
        double most = -std::numeric_limits<double>::infinity();
        void include(double y) {
            least = std::min(least, y);
            most = std::max(most, y);
        }
    };
    double columnOf(double x) const { return std::floor((x - _left) / _width); }

    const double _left;
    const double _width;
    std::vector<Column> _columns;
};

}  // namespace

TrendPainting::TrendPainting(QPainter& painter, QSizeF size, QRectF area, const TrendView& view, const Colors& colors)
    : _painter(painter), _size(size), _area(area), _view(view), _colors(colors) {
    QFont font = painter.font();
    font.setPixelSize(kFontPixels);
    _painter.setFont(font);
}

/// Not shorter than `shortest`, around what is seen.
AxisRange TrendPainting::axisOf(std::span<const Trend* const> trends, double shortest) const {
    double least = std::numeric_limits<double>::infinity();
    double most = -least;
    for (const Trend* trend : trends) {
        // A line that leaves the view at its side belongs to it.
        const auto seen = statisticsOf(*trend, _view.from() - Trend::kGap, _view.to() + Trend::kGap);
        if (!seen) continue;
        least = std::min(least, seen->least);
        most = std::max(most, seen->most);
    }
    if (least > most) return {0, 1, 1};
    const double lacking = std::max(0.0, shortest - (most - least)) / 2;
    return axisFor(least - lacking, most + lacking, 5);
}

void TrendPainting::paint(const DetailsController& details, const Trend::Point* cursor) {
    const Trend& trend = details.trend();
    const Trend& other = details.comparison();
    const bool hasOther = !other.points.empty();
    const bool sharesAxis = hasOther && other.unit == trend.unit;
    const std::array<const Trend*, 2> both = {&trend, &other};
    _axis = axisOf(std::span(both).first(sharesAxis ? 2 : 1));
    const AxisRange otherAxis = hasOther && !sharesAxis ? axisOf(std::span(both).last(1)) : _axis;

    _painter.fillRect(QRectF({0, 0}, _size), _colors.background);
    paintGrades(gradesOf(details.name(), trend.unit));
    paintValueAxis(_axis, false);
    if (hasOther && !sharesAxis) paintValueAxis(otherAxis, true);
    paintTimeAxis();
    paintServingCells(details.servingCells());
    _painter.setClipRect(_area.adjusted(0, -kLineWidth, kLineWidth, kLineWidth));
    if (hasOther) paintLine(other, otherAxis, _colors.other, true);
    paintLine(trend, _axis, _colors.line, false);
    _painter.setClipping(false);
    if (cursor != nullptr) paintCursor(*cursor);
}

void TrendPainting::paintSmall(const Trend& trend, const std::vector<TrendChange>& servingCells) {
    constexpr double kShortest = 10;  // dB: less is hardly more than noise, and shall look so
    const std::array<const Trend*, 1> one = {&trend};
    _axis = axisOf(one, trend.unit.empty() ? 0 : kShortest);
    _painter.fillRect(QRectF({0, 0}, _size), _colors.background);
    const auto paintText = [this](const QRectF& place, Qt::Alignment alignment, const QString& text) {
        _painter.setPen(_colors.text);
        _painter.drawText(place, static_cast<int>(alignment), text);
    };
    for (const double number : {_axis.low, _axis.high}) {
        const qreal y = std::round(yOf(number, _axis)) + 0.5;
        _painter.setPen(QPen(_colors.grid, 1));
        _painter.drawLine(QPointF(_area.left(), y), QPointF(_area.right(), y));
        if (trend.points.empty()) continue;
        paintText({_area.right() + 4, y - 9, kSmallRight - 4, 18}, Qt::AlignLeft | Qt::AlignVCenter,
                  QString::fromStdString(numberText(number)));
    }
    for (const TrendChange& change : servingCells) {
        const qreal x = std::round(xOf(change.at)) + 0.5;
        _painter.setPen(QPen(faint(_colors.text, 0.6F), 1, Qt::DashLine));
        if (change.at >= _view.from()) _painter.drawLine(QPointF(x, _area.top()), QPointF(x, _area.bottom()));
    }
    const QRectF below(_area.left(), _area.bottom() + 3, _area.width(), kSmallBottom - 3);
    paintText(below, Qt::AlignLeft, beforeNow(_view.span()));
    paintText(below, Qt::AlignRight, beforeNow(0s));
    _painter.setClipRect(_area.adjusted(-1, -kLineWidth, kLineWidth, kLineWidth));
    paintLine(trend, _axis, _colors.line, false);
    _painter.setClipping(false);
}

void TrendPainting::paintGrades(std::span<const LevelGrade> grades) {
    double ceiling = std::numeric_limits<double>::infinity();
    float shade = 0;
    for (const LevelGrade& grade : grades) {
        const double top = std::min(ceiling, _axis.high);
        const double bottom = std::max(grade.floor, _axis.low);
        ceiling = grade.floor;
        shade += 0.045F;  // the better the lighter
        if (top <= bottom) continue;
        const QRectF band(QPointF(_area.left(), yOf(top, _axis)), QPointF(_area.right(), yOf(bottom, _axis)));
        _painter.fillRect(band, faint(_colors.text, shade));
        if (band.height() < kFontPixels + 4) continue;
        _painter.setPen(_colors.text);
        _painter.drawText(band.adjusted(6, 2, 0, -2), Qt::AlignLeft | Qt::AlignTop, shown(grade.name));
    }
}

void TrendPainting::paintValueAxis(const AxisRange& axis, bool right) {
    const auto lines = static_cast<int>(std::lround((axis.high - axis.low) / axis.step));
    for (int i = 0; i <= lines; ++i) {
        const double number = axis.low + i * axis.step;
        const qreal y = std::round(yOf(number, axis)) + 0.5;
        _painter.setPen(QPen(_colors.grid, 1));
        if (!right) _painter.drawLine(QPointF(_area.left(), y), QPointF(_area.right(), y));
        _painter.setPen(_colors.text);
        const QString text = QString::fromStdString(numberText(number));
        const QRectF left(0, y - 10, kLeft - 6, 20);
        // The other value's axis stands inside, above its lines.
        const QRectF inside(_area.left() + 4, y - 16, _area.width(), 14);
        _painter.drawText(right ? inside : left, (right ? Qt::AlignLeft : Qt::AlignRight) | Qt::AlignVCenter,
                          right ? QStringLiteral("(%1)").arg(text) : text);
    }
}

void TrendPainting::paintTimeAxis() {
    const Trend::Time step = timeStep(_view.span());
    const Trend::Time first = _view.now() - _view.to();
    for (Trend::Time before = (first + step - 1ms) / step * step; before <= _view.now() - _view.from();
         before += step) {
        const qreal x = std::round(xOf(_view.now() - before)) + 0.5;
        _painter.setPen(QPen(_colors.grid, 1));
        _painter.drawLine(QPointF(x, _area.top()), QPointF(x, _area.bottom()));
        const QString text = beforeNow(before);
        const qreal width = QFontMetricsF(_painter.font()).horizontalAdvance(text);
        const qreal left = std::clamp(x - width / 2, _area.left() - kLeft + 2, _size.width() - width - 2);
        _painter.setPen(_colors.text);
        _painter.drawText(QRectF(left, _area.bottom() + 4, width + 2, kBottom - 4), Qt::AlignLeft, text);
    }
}

void TrendPainting::paintServingCells(const std::vector<TrendChange>& changes) {
    qreal free = _area.left();  // of what was written before
    const QFontMetricsF metrics(_painter.font());
    for (const TrendChange& change : changes) {
        if (change.at < _view.from() || change.at > _view.to()) continue;
        const qreal x = std::round(xOf(change.at)) + 0.5;
        _painter.setPen(QPen(faint(_colors.text, 0.6F), 1, Qt::DashLine));
        _painter.drawLine(QPointF(x, _area.top() - 4), QPointF(x, _area.bottom()));
        _painter.setPen(_colors.text);
        const QString text = QString::fromStdString(change.text);
        const qreal width = metrics.horizontalAdvance(text);
        const qreal left = std::min(x - width / 2, _size.width() - width - 2);
        if (left < free) continue;  // where many are close together some go without their names
        _painter.drawText(QRectF(left, 0, width + 2, kTop - 4), Qt::AlignLeft | Qt::AlignVCenter, text);
        free = left + width + 8;
    }
}

void TrendPainting::paintLine(const Trend& trend, const AxisRange& axis, const QColor& color, bool dashed) {
    const auto isBefore = [](const Trend::Point& point, Trend::Time time) { return point.at < time; };
    const auto at = [&](Trend::Time time) {
        return std::lower_bound(trend.points.begin(), trend.points.end(), time, isBefore);
    };
    // Lines that leave the view at its sides are drawn up to them.
    const std::span<const Trend::Point> points(at(_view.from() - Trend::kGap), at(_view.to() + Trend::kGap));
    QList<QLineF> lines;
    lines.reserve(static_cast<qsizetype>(points.size()));
    for (std::size_t i = 0; i < points.size(); ++i) {
        const bool follows = i > 0 && points[i].at - points[i - 1].at <= Trend::kGap;
        const bool goesOn = i + 1 < points.size() && points[i + 1].at - points[i].at <= Trend::kGap;
        const QPointF here = placeOf(points[i], axis);
        if (follows) lines.append(QLineF(placeOf(points[i - 1], axis), here));
        if (!follows && !goesOn) paintDot(here, color);
    }
    constexpr int kFewLines = 60;
    if (lines.size() > kFewLines) return paintStrokes(lines, color, dashed);
    QPen pen(color, kLineWidth, Qt::SolidLine, Qt::SquareCap);
    if (dashed) pen = QPen(color, kLineWidth, Qt::CustomDashLine, Qt::FlatCap);
    if (dashed) pen.setDashPattern({3, 2});
    _painter.setPen(pen);
    _painter.drawLines(lines);
}

void TrendPainting::paintStrokes(const QList<QLineF>& lines, const QColor& color, bool dashed) {
    const qreal pixel = 1 / std::max(1.0, _painter.deviceTransform().m11());
    Strokes strokes(_area.left(), pixel, static_cast<std::size_t>(std::ceil(_area.width() / pixel)) + 1);
    for (const QLineF& line : lines) strokes.add(line.p1(), line.p2());
    strokes.paint(_painter, color, dashed);
}

/// A reading alone.
void TrendPainting::paintDot(QPointF at, const QColor& color) {
    _painter.setPen(Qt::NoPen);
    _painter.setBrush(color);
    _painter.drawEllipse(at, kLineWidth, kLineWidth);
    _painter.setBrush(Qt::NoBrush);
}

void TrendPainting::paintCursor(const Trend::Point& point) {
    const QPointF at = placeOf(point, _axis);
    if (at.x() < _area.left() - 1 || at.x() > _area.right() + 1) return;
    _painter.setPen(QPen(_colors.text, 1));
    _painter.drawLine(QPointF(at.x(), _area.top()), QPointF(at.x(), _area.bottom()));
    _painter.setPen(QPen(_colors.background, 2));
    _painter.setBrush(_colors.line);
    _painter.drawEllipse(at, 5, 5);
    _painter.setBrush(Qt::NoBrush);
}

}  // namespace kelvo
