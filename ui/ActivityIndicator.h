#pragma once

#include <QtQml/qqmlregistration.h>
#include <QBasicTimer>
#include <QColor>
#include <QPointer>
#include <QQuickPaintedItem>

namespace kelvo {

/// A small wheel of spokes that turns in steps while something is under way. Hidden when stopped, and then, as
/// in a window that nobody sees, it costs nothing: no timer, no drawing. It moves in few steps a second because a modem
/// may stay away for hours.
class ActivityIndicator : public QQuickPaintedItem {
    Q_OBJECT
    QML_ELEMENT
    Q_PROPERTY(QColor color MEMBER _color NOTIFY colorChanged)
    Q_PROPERTY(bool running READ isRunning WRITE setRunning NOTIFY runningChanged)
public:
    explicit ActivityIndicator(QQuickItem* parent = nullptr);

    bool isRunning() const { return _running; }
    void setRunning(bool running);
    bool isTurning() const { return _timer.isActive(); }

    void paint(QPainter* painter) override;

Q_SIGNALS:
    void colorChanged();
    void runningChanged();

protected:
    void itemChange(ItemChange change, const ItemChangeData& data) override;
    bool eventFilter(QObject* watched, QEvent* event) override;
    void timerEvent(QTimerEvent* event) override;

private:
    void turnWhileSeen();

    QColor _color = Qt::gray;
    bool _running = false;
    int _step = 0;
    QBasicTimer _timer;
    QPointer<QQuickWindow> _watched;
};

}  // namespace kelvo
