#include "ui/ActivityIndicator.h"

#include <QPainter>
#include <QQuickWindow>
#include <QTimerEvent>

namespace kelvo {
namespace {

constexpr int kSpokes = 8;
constexpr int kStepMs = 125;

}  // namespace

ActivityIndicator::ActivityIndicator(QQuickItem* parent) : QQuickPaintedItem(parent) {
    setAntialiasing(true);
    setImplicitSize(18, 18);
    setVisible(false);
    connect(this, &ActivityIndicator::colorChanged, this, [this] { update(); });
}

void ActivityIndicator::setRunning(bool running) {
    if (_running == running) return;
    _running = running;
    setVisible(running);
    turnWhileSeen();
    Q_EMIT runningChanged();
}

void ActivityIndicator::itemChange(ItemChange change, const ItemChangeData& data) {
    QQuickPaintedItem::itemChange(change, data);
    if (change == ItemSceneChange) {
        if (_watched) _watched->removeEventFilter(this);
        _watched = data.window;
        if (_watched) _watched->installEventFilter(this);
    }
    if (change == ItemVisibleHasChanged || change == ItemSceneChange) turnWhileSeen();
}

bool ActivityIndicator::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::Expose) turnWhileSeen();  // a window that was put away, or is seen again
    return QQuickPaintedItem::eventFilter(watched, event);
}

void ActivityIndicator::turnWhileSeen() {
    if (_running && isVisible() && _watched && _watched->isExposed()) {
        if (!_timer.isActive()) _timer.start(kStepMs, this);
    } else {
        _timer.stop();
    }
}

void ActivityIndicator::timerEvent(QTimerEvent* event) {
    if (event->timerId() != _timer.timerId()) return QQuickPaintedItem::timerEvent(event);
    _step = (_step + 1) % kSpokes;
    update();
}

void ActivityIndicator::paint(QPainter* painter) {
    painter->translate(width() / 2, height() / 2);
    painter->scale(width() / 18, height() / 18);
    painter->rotate(_step * 360.0 / kSpokes);
    for (int spoke = 0; spoke < kSpokes; ++spoke) {
        QColor shade = _color;
        shade.setAlphaF(static_cast<float>(1 + spoke) / kSpokes);
        painter->setPen(QPen(shade, 2, Qt::SolidLine, Qt::RoundCap));
        painter->rotate(360.0 / kSpokes);
        painter->drawLine(QPointF(0, -4), QPointF(0, -7.5));
    }
}

}  // namespace kelvo
