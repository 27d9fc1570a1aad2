#include "ui/Theme.h"

#include <QEvent>
#include <QGuiApplication>
#include <QPalette>

namespace kelvo {

Theme::Theme(QObject* parent) : QObject(parent), _dark(systemIsDark()) { qGuiApp->installEventFilter(this); }

void Theme::follow(std::optional<bool> dark) {
    if (!dark) return QGuiApplication::setPalette(QPalette());
    QGuiApplication::setPalette(*dark ? QPalette(Qt::white, QColor(0x202020), Qt::white, Qt::black, Qt::gray, Qt::white,
                                                 Qt::white, Qt::black, QColor(0x202020))
                                      : QPalette(Qt::black, QColor(0xefefef), Qt::white, Qt::darkGray, Qt::gray,
                                                 Qt::black, Qt::white, Qt::white, QColor(0xefefef)));
}

bool Theme::systemIsDark() {
    const QPalette palette = QGuiApplication::palette();
    return palette.color(QPalette::Window).lightness() < palette.color(QPalette::WindowText).lightness();
}

bool Theme::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::ApplicationPaletteChange && _dark != systemIsDark()) {
        _dark = !_dark;
        Q_EMIT changed();
    }
    return QObject::eventFilter(watched, event);
}

QColor Theme::background() const { return choose(0xfff3f5f6, 0xff0e1113); }
QColor Theme::bar() const { return choose(0xfffafbfb, 0xff161a1d); }
QColor Theme::row() const { return choose(0xffffffff, 0xff161a1d); }
QColor Theme::raised() const { return choose(0xffffffff, 0xff252c31); }
QColor Theme::pressed() const { return choose(0xffe3ebea, 0xff243030); }
QColor Theme::hairline() const { return choose(0xffdde2e4, 0xff2b3236); }
QColor Theme::text() const { return choose(0xff14191c, 0xffedf1f2); }
QColor Theme::secondaryText() const { return choose(0xff56626a, 0xffa4b0b7); }
QColor Theme::oldText() const { return choose(0xff6c757b, 0xff7d888f); }
QColor Theme::accent() const { return choose(0xff00736a, 0xff55cfc0); }
QColor Theme::shade() const { return choose(0x66101416, 0x99000000); }

}  // namespace kelvo
