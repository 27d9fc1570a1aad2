#pragma once

#include <QtQml/qqmlregistration.h>
#include <QColor>
#include <QObject>
#include <optional>

namespace kelvo {

/// The colours of the screens. Light or dark follows what the desktop asks for, else the system's palette; while the
/// program runs as well.
class Theme : public QObject {
    Q_OBJECT
    QML_ELEMENT
    QML_SINGLETON
    Q_PROPERTY(bool dark READ isDark NOTIFY changed)
    Q_PROPERTY(QColor background READ background NOTIFY changed)
    Q_PROPERTY(QColor bar READ bar NOTIFY changed)
    Q_PROPERTY(QColor row READ row NOTIFY changed)
    Q_PROPERTY(QColor raised READ raised NOTIFY changed)
    Q_PROPERTY(QColor pressed READ pressed NOTIFY changed)
    Q_PROPERTY(QColor hairline READ hairline NOTIFY changed)
    Q_PROPERTY(QColor text READ text NOTIFY changed)
    Q_PROPERTY(QColor secondaryText READ secondaryText NOTIFY changed)
    Q_PROPERTY(QColor oldText READ oldText NOTIFY changed)
    Q_PROPERTY(QColor accent READ accent NOTIFY changed)
    Q_PROPERTY(QColor shade READ shade NOTIFY changed)
public:
    explicit Theme(QObject* parent = nullptr);

    /// The desktop asks for dark or light; without a value the system's palette decides again.
    static void follow(std::optional<bool> dark);

    bool isDark() const { return _dark; }
    QColor background() const;     ///< behind the rows
    QColor bar() const;            ///< title bar and toolbar
    QColor row() const;            ///< rows, fields and sheets
    QColor raised() const;         ///< an alert, above everything
    QColor pressed() const;        ///< a row or button under a finger
    QColor hairline() const;       ///< the lines between things
    QColor text() const;           ///< keys and titles
    QColor secondaryText() const;  ///< values, status and hints
    QColor oldText() const;        ///< values that no record has written for long
    QColor accent() const;         ///< what can be tapped, and where the keyboard is
    QColor shade() const;          ///< over what a modal screen covers

Q_SIGNALS:
    void changed();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    static bool systemIsDark();
    QColor choose(QRgb light, QRgb dark) const { return QColor::fromRgba(_dark ? dark : light); }

    bool _dark;
};

}  // namespace kelvo
