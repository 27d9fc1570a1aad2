#include "ui/KelvoCell.h"

namespace kelvo {

KelvoCell::KelvoCell(const TextMeasure& measure, QQuickItem* parent) : QQuickItem(parent), _measure(measure) {}

void KelvoCell::setKey(const QString& key) {
    if (_key == key) return;
    _key = key;
    Q_EMIT keyChanged();
    show();
}

void KelvoCell::setValue(const QString& value) {
    if (_value == value) return;
    _value = value;
    Q_EMIT valueChanged();
    show();
}

void KelvoCell::setAge(const QString& age) {
    if (_age == age) return;
    _age = age;
    Q_EMIT ageChanged();
    Q_EMIT accessibleNameChanged();
}

void KelvoCell::setOpens(bool opens) {
    if (_opens == opens) return;
    _opens = opens;
    Q_EMIT opensChanged();
    show();
}

void KelvoCell::setContentArea(const QRectF& area) {
    if (_contentArea == area) return;
    _contentArea = area;
    Q_EMIT contentAreaChanged();
    show();
}

void KelvoCell::componentComplete() {
    QQuickItem::componentComplete();
    _kind = _opens ? Kind::Key : Kind::Value;
    show();
}

void KelvoCell::show() {
    if (_kind == Kind::Unsettled) return;
    if (_opens) {
        setLayoutKey();
    } else {
        setLayout();
    }
    Q_EMIT laidOut();
    Q_EMIT accessibleNameChanged();
}

QString KelvoCell::shownValue() const { return _kind == Kind::Value && !_opens ? _value : QString(); }

QString KelvoCell::accessibleName() const {
    const QString value = shownValue();
    const QString name = value.isEmpty() ? _key : _key + QStringLiteral(", ") + value;
    return value.isEmpty() || _age.isEmpty() ? name : name + QStringLiteral(", ") + _age;
}

void KelvoCell::placeKey() {
    const QSizeF size = _measure.boldSize(_key);
    _keyFrame = QRectF({_contentArea.x() + 10, (_contentArea.height() - size.height()) / 2}, size);
}

void KelvoCell::setLayoutKey() { placeKey(); }

void KelvoCell::setLayout() {
    placeKey();
    if (_kind == Kind::Key) return;  // no value and no strip to lay out
    const qreal width = _contentArea.width();
    // Measured bold as well, although it is drawn in regular type: a value keeps its place whatever its weight.
    const QSizeF size = _measure.boldSize(_value);
    const qreal needed = _keyFrame.width() + 10 + 50 + size.width();
    const qreal left = needed < width ? width - size.width() : _contentArea.x() + 10 + _keyFrame.width() + 50;
    _valueFrame = QRectF({left, (_contentArea.height() - size.height()) / 2}, size);
    const qreal scrolled = needed > width ? width + _keyFrame.width() + size.width() : width;
    _viewContentSize = {scrolled, kStripHeight};
    _viewFrame = {_contentArea.x(), _contentArea.y(), width, kStripHeight};
}

}  // namespace kelvo
