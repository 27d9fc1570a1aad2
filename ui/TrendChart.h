#pragma once

#include <QtQml/qqmlregistration.h>
#include <QColor>
#include <QPointer>
#include <QQuickPaintedItem>
#include <QString>
#include <optional>

#include "ui/AxisSteps.h"
#include "ui/DetailsController.h"
#include "ui/TrendView.h"

namespace kelvo {

/// The chart of a value's trend, with another's over it when the details say so: time across, value up. Lines break
/// where no record came, upright lines tell when another cell began to serve, bands the accepted grades of a level. A
/// cursor reads single points.
///
/// It is painted, not made of geometry nodes: the software renderer draws no others than rectangles and pictures, and
/// phones without a graphics device need it most.
class TrendChart : public QQuickPaintedItem {
    Q_OBJECT
    QML_ELEMENT
    Q_PROPERTY(kelvo::DetailsController* details READ details WRITE setDetails NOTIFY detailsChanged REQUIRED)
    Q_PROPERTY(QColor lineColor MEMBER _lineColor NOTIFY coloursChanged)
    Q_PROPERTY(QColor otherColor MEMBER _otherColor NOTIFY coloursChanged)
    Q_PROPERTY(QColor textColor MEMBER _textColor NOTIFY coloursChanged)
    Q_PROPERTY(QColor gridColor MEMBER _gridColor NOTIFY coloursChanged)
    Q_PROPERTY(QColor backgroundColor MEMBER _backgroundColor NOTIFY coloursChanged)
    Q_PROPERTY(QString statistics READ statistics NOTIFY viewChanged)
    Q_PROPERTY(QString otherStatistics READ otherStatistics NOTIFY viewChanged)
    Q_PROPERTY(QString cursorText READ cursorText NOTIFY viewChanged)
    Q_PROPERTY(QString spanText READ spanText NOTIFY viewChanged)
    Q_PROPERTY(QString summary READ summary NOTIFY viewChanged)
    Q_PROPERTY(bool live READ isLive NOTIFY viewChanged)
public:
    explicit TrendChart(QQuickItem* parent = nullptr);

    DetailsController* details() const { return _details; }
    void setDetails(DetailsController* details);

    QString statistics() const;       ///< least, mean and most of what is seen; empty when nothing is
    QString otherStatistics() const;  ///< likewise of the other value
    QString cursorText() const;       ///< the point that is read, and when it was; empty without
    QString spanText() const;         ///< how much is seen: "five minutes"
    QString summary() const;          ///< for a screen reader
    bool isLive() const { return _view.isLive(); }
    const TrendView& view() const { return _view; }

    /// Moves the content by so many pixels, to the right when positive.
    Q_INVOKABLE void moveBy(qreal pixels);
    /// Shows `factor` times as much time around the point at `x`.
    Q_INVOKABLE void zoomBy(qreal factor, qreal x);
    /// Puts the cursor on the reading nearest to `x`; none is there, no cursor.
    Q_INVOKABLE void readAt(qreal x);
    /// Moves the cursor by so many readings; without a cursor it begins at the latest that is seen. The view follows.
    Q_INVOKABLE void moveCursor(int readings);
    /// False when there was no cursor.
    Q_INVOKABLE bool clearCursor();
    Q_INVOKABLE void showLatest();

    /// Where the lines are, in the item's coordinates.
    QRectF plotArea() const;
    qreal xOf(Trend::Time time) const;

    void paint(QPainter* painter) override;

Q_SIGNALS:
    void detailsChanged();
    void coloursChanged();
    void viewChanged();

private:
    void takeUp();
    void show();
    QString statisticsOfTrend(const Trend& trend) const;
    const Trend::Point* cursorPoint() const;

    QPointer<DetailsController> _details;
    TrendView _view;
    std::optional<Trend::Time> _cursor;
    QColor _lineColor = Qt::black;
    QColor _otherColor = Qt::darkGray;
    QColor _textColor = Qt::gray;
    QColor _gridColor = Qt::lightGray;
    QColor _backgroundColor = Qt::white;
};

}  // namespace kelvo
