#pragma once

#include <QtQml/qqmlregistration.h>
#include <QFont>
#include <QList>
#include <QObject>
#include <QString>
#include <QStringList>

#include "ui/Figures.h"

namespace kelvo {

/// The pieces in which the screen draws one line of text, so that its digits do not move when they change.
class FigureLayout : public QObject {
    Q_OBJECT
    QML_ELEMENT
    Q_PROPERTY(QString text READ text WRITE setText NOTIFY changed)
    Q_PROPERTY(QFont font READ font WRITE setFont NOTIFY changed)
    Q_PROPERTY(qreal maximumWidth READ maximumWidth WRITE setMaximumWidth NOTIFY changed)
    Q_PROPERTY(int count READ count NOTIFY changed)
    Q_PROPERTY(QStringList texts READ texts NOTIFY changed)
    Q_PROPERTY(QList<qreal> positions READ positions NOTIFY changed)
    Q_PROPERTY(qreal width READ width NOTIFY changed)
    Q_PROPERTY(qreal height READ height NOTIFY changed)
public:
    explicit FigureLayout(QObject* parent = nullptr) : QObject(parent), _figures(_font) {}

    const QString& text() const { return _text; }
    const QFont& font() const { return _font; }
    qreal maximumWidth() const { return _maximumWidth; }  ///< a longer text ends in an ellipsis; 0 for no limit
    void setText(const QString& text);
    void setFont(const QFont& font);
    void setMaximumWidth(qreal width);

    int count() const { return static_cast<int>(_texts.size()); }
    const QStringList& texts() const { return _texts; }
    const QList<qreal>& positions() const { return _positions; }  ///< of each text's left edge
    qreal width() const { return _width; }
    qreal height() const { return _height; }

Q_SIGNALS:
    void changed();

private:
    void layOut();

    QString _text;
    QFont _font;
    qreal _maximumWidth = 0;
    Figures _figures;
    QStringList _texts;
    QList<qreal> _positions;
    qreal _width = 0;
    qreal _height = 0;
};

}  // namespace kelvo
