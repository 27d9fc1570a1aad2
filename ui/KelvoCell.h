#pragma once

#include <QtQml/qqmlregistration.h>
#include <QQuickItem>
#include <QRectF>
#include <QSizeF>
#include <QString>

#include "ui/TextMeasure.h"

namespace kelvo {

/// One row of a pane: a bold key on the left and, in a value row, the value in regular type, both inside a strip that
/// scrolls sideways. The row decides what it shows and where; the screen draws `keyFrame`, `valueFrame` and the strip.
///
/// Which kind a row is was settled by the first child it showed and never changes: all rows of a pane share one reuse
/// identifier, so a recycled row of either kind may come to show either kind of child. A key row that ends up showing a
/// leaf shows the name only.
class KelvoCell : public QQuickItem {
    Q_OBJECT
    QML_ELEMENT
    Q_PROPERTY(QString key READ key WRITE setKey NOTIFY keyChanged REQUIRED)
    Q_PROPERTY(QString value READ value WRITE setValue NOTIFY valueChanged REQUIRED)
    Q_PROPERTY(QString age READ age WRITE setAge NOTIFY ageChanged)
    Q_PROPERTY(bool opens READ opens WRITE setOpens NOTIFY opensChanged REQUIRED)
    Q_PROPERTY(QString shownValue READ shownValue NOTIFY laidOut)
    Q_PROPERTY(QString accessibleName READ accessibleName NOTIFY accessibleNameChanged)
    Q_PROPERTY(QRectF keyFrame READ keyFrame NOTIFY laidOut)
    Q_PROPERTY(QRectF valueFrame READ valueFrame NOTIFY laidOut)
    Q_PROPERTY(QRectF viewFrame READ viewFrame NOTIFY laidOut)
    Q_PROPERTY(QSizeF viewContentSize READ viewContentSize NOTIFY laidOut)
    Q_PROPERTY(QRectF contentArea READ contentArea WRITE setContentArea NOTIFY contentAreaChanged)
public:
    static constexpr qreal kStripHeight = 50;

    enum class Kind { Unsettled, Key, Value };

    explicit KelvoCell(QQuickItem* parent = nullptr) : KelvoCell(TextMeasure::system(), parent) {}
    explicit KelvoCell(const TextMeasure& measure, QQuickItem* parent = nullptr);

    // The child to show.
    const QString& key() const { return _key; }
    const QString& value() const { return _value; }
    bool opens() const { return _opens; }        ///< the child has children: a disclosure indicator, no value
    const QString& age() const { return _age; }  ///< "40 seconds old"; empty while the value is not old
    void setAge(const QString& age);
    void setKey(const QString& key);
    void setValue(const QString& value);
    void setOpens(bool opens);
    /// Where the toolkit lets the row put its labels, in the row's coordinates.
    const QRectF& contentArea() const { return _contentArea; }
    void setContentArea(const QRectF& area);

    // What is drawn, and where.
    Kind kind() const { return _kind; }
    QString shownValue() const;
    QString accessibleName() const;  ///< key, shown value and its age, for a screen reader
    const QRectF& keyFrame() const { return _keyFrame; }
    const QRectF& valueFrame() const { return _valueFrame; }
    const QRectF& viewFrame() const { return _viewFrame; }              ///< empty in a key row
    const QSizeF& viewContentSize() const { return _viewContentSize; }  ///< empty in a key row

    void componentComplete() override;

Q_SIGNALS:
    void keyChanged();
    void valueChanged();
    void opensChanged();
    void ageChanged();
    void accessibleNameChanged();
    void contentAreaChanged();
    void laidOut();

private:
    void show();
    void setLayoutKey();
    void setLayout();
    void placeKey();

    const TextMeasure& _measure;
    Kind _kind = Kind::Unsettled;
    QString _key;
    QString _value;
    QString _age;
    bool _opens = false;
    QRectF _contentArea;
    QRectF _keyFrame;
    QRectF _valueFrame;
    QRectF _viewFrame;
    QSizeF _viewContentSize;
};

}  // namespace kelvo
