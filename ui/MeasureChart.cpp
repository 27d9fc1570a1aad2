#include "ui/MeasureChart.h"

#include <algorithm>

#include "ui/TrendPainting.h"

namespace kelvo {

MeasureChart::MeasureChart(QQuickItem* parent) : QQuickPaintedItem(parent) {
    setAntialiasing(true);
    setOpaquePainting(true);
    connect(this, &MeasureChart::coloursChanged, this, [this] { update(); });
}

void MeasureChart::setMeasure(OverviewMeasure* measure) {
    if (_measure == measure) return;
    if (_measure) _measure->disconnect(this);
    _measure = measure;
    if (_measure) connect(_measure, &OverviewMeasure::lineChanged, this, [this] { update(); });
    update();
    Q_EMIT measureChanged();
}

void MeasureChart::paint(QPainter* painter) {
    if (!_measure) return;
    TrendView view;
    view.setSpan(overview::LiveOverview::kSpan);
    view.setNow(_measure->lineEnd());
    const QRectF area(1, TrendPainting::kSmallTop, std::max(1.0, width() - TrendPainting::kSmallRight - 1),
                      std::max(1.0, height() - TrendPainting::kSmallTop - TrendPainting::kSmallBottom));
    const TrendPainting::Colors colors{_lineColor, _textColor, _textColor, _gridColor, _backgroundColor};
    TrendPainting(*painter, {width(), height()}, area, view, colors)
        .paintSmall(_measure->line(), _measure->servingCells());
}

}  // namespace kelvo
