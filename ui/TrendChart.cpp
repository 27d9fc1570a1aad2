#include "ui/TrendChart.h"

#include <algorithm>

#include "model/TrendWords.h"
#include "ui/TrendPainting.h"

namespace kelvo {

TrendChart::TrendChart(QQuickItem* parent) : QQuickPaintedItem(parent) {
    setAntialiasing(true);
    setOpaquePainting(true);
    connect(this, &TrendChart::coloursChanged, this, [this] { update(); });
}

void TrendChart::setDetails(DetailsController* details) {
    if (_details == details) return;
    if (_details) _details->disconnect(this);
    _details = details;
    if (_details) connect(_details, &DetailsController::changed, this, &TrendChart::takeUp);
    takeUp();
    Q_EMIT detailsChanged();
}

void TrendChart::takeUp() {
    if (_details) _view.setNow(_details->now());
    show();
}

void TrendChart::show() {
    update();
    Q_EMIT viewChanged();
}

QRectF TrendChart::plotArea() const {
    return {TrendPainting::kLeft, TrendPainting::kTop,
            std::max(1.0, width() - TrendPainting::kLeft - TrendPainting::kRight),
            std::max(1.0, height() - TrendPainting::kTop - TrendPainting::kBottom)};
}

qreal TrendChart::xOf(Trend::Time time) const {
    const QRectF area = plotArea();
    return area.left() + _view.shareOf(time) * area.width();
}

void TrendChart::moveBy(qreal pixels) {
    _view.moveBy(pixels / plotArea().width());
    show();
}

void TrendChart::zoomBy(qreal factor, qreal x) {
    const QRectF area = plotArea();
    _view.zoomBy(factor, std::clamp((x - area.left()) / area.width(), 0.0, 1.0));
    show();
}

void TrendChart::showLatest() {
    _view.showLatest();
    show();
}

void TrendChart::readAt(qreal x) {
    if (!_details) return;
    const QRectF area = plotArea();
    const Trend::Time wanted = _view.timeAt((x - area.left()) / area.width());
    const auto distance = [&](const Trend::Point& point) { return std::chrono::abs(point.at - wanted); };
    const std::vector<Trend::Point>& points = _details->trend().points;
    const auto nearest = std::ranges::min_element(points, {}, distance);
    const bool isSeen = nearest != points.end() && nearest->at >= _view.from() && nearest->at <= _view.to();
    _cursor = isSeen ? std::optional(nearest->at) : std::nullopt;
    show();
}

void TrendChart::moveCursor(int readings) {
    if (!_details || _details->trend().points.empty()) return;
    const std::vector<Trend::Point>& points = _details->trend().points;
    const auto behind = std::ranges::upper_bound(points, _cursor.value_or(_view.to()), {}, &Trend::Point::at);
    const std::ptrdiff_t at = behind - points.begin() - 1 + (_cursor ? readings : 0);
    const std::ptrdiff_t last = std::ssize(points) - 1;
    _cursor = points[static_cast<std::size_t>(std::clamp<std::ptrdiff_t>(at, 0, last))].at;
    const double share = _view.shareOf(*_cursor);
    if (share < 0) _view.moveBy(-share + 0.1);
    if (share > 1) _view.moveBy(1 - share);
    show();
}

bool TrendChart::clearCursor() {
    if (!_cursor) return false;
    _cursor.reset();
    show();
    return true;
}

const Trend::Point* TrendChart::cursorPoint() const {
    if (!_details || !_cursor) return nullptr;
    const std::vector<Trend::Point>& points = _details->trend().points;
    const auto at = std::ranges::lower_bound(points, *_cursor, {}, &Trend::Point::at);
    return at != points.end() && at->at == *_cursor ? &*at : nullptr;
}

QString TrendChart::cursorText() const {
    const Trend::Point* point = cursorPoint();
    if (point == nullptr) return {};
    return QStringLiteral("%1, %2 ago")
        .arg(QString::fromStdString(point->text()), QString::fromStdString(agoText(_view.now() - point->at)));
}

QString TrendChart::statisticsOfTrend(const Trend& trend) const {
    const auto seen = statisticsOf(trend, _view.from(), _view.to());
    if (!seen) return {};
    const auto text = [](double number) { return QString::fromStdString(numberText(number)); };
    return QStringLiteral("min %1   mean %2   max %3").arg(text(seen->least), text(seen->mean), text(seen->most));
}

QString TrendChart::statistics() const { return _details ? statisticsOfTrend(_details->trend()) : QString(); }

QString TrendChart::otherStatistics() const { return _details ? statisticsOfTrend(_details->comparison()) : QString(); }

QString TrendChart::spanText() const { return QString::fromStdString(kelvo::spanText(_view.span())); }

QString TrendChart::summary() const {
    if (!_details) return {};
    const auto summaryOf = [this](const Trend& trend) {
        return QString::fromStdString(trendSummary(trend, _view.from(), _view.to(), _view.now()));
    };
    QString all = summaryOf(_details->trend());
    if (!_details->comparison().points.empty()) {
        all += QStringLiteral("; %1: %2").arg(_details->comparedWith(), summaryOf(_details->comparison()));
    }
    if (const QString read = cursorText(); !read.isEmpty()) all = read + QStringLiteral("; ") + all;
    return all;
}

void TrendChart::paint(QPainter* painter) {
    if (!_details) return;
    const TrendPainting::Colors colors{_lineColor, _otherColor, _textColor, _gridColor, _backgroundColor};
    TrendPainting painting(*painter, {width(), height()}, plotArea(), _view, colors);
    painting.paint(*_details, cursorPoint());
}

}  // namespace kelvo
