#pragma once

#include <QPointF>
#include <QPointingDevice>
#include <QString>

#include "tests/ui/AppWorld.h"
#include "ui/KelvoCell.h"
#include "ui/QuickWindow.h"

namespace kelvo::test {

/// The one touch screen of all scenes: Qt keeps a device as long as it runs.
QPointingDevice* touchScreen();

/// The application with its real screen, drawn without a display. Starts launched, with its window `size` large.
class Scene : public AppWorld {
public:
    /// `saved`: shows these in place of a modem's.
    explicit Scene(bool savingPermitted = false, QSize size = {360, 640},
                   std::shared_ptr<const SavedScreens> saved = nullptr);
    ~Scene();

    KelvoApp& app() { return *_app; }
    QQuickView& view() { return *_view; }
    /// Lets the posted start run: the model connects.
    void connect() { queue.run(); }

    /// Runs the event loop until transitions have ended and everything is drawn.
    void settle();
    /// The visible item of a QML type that carries `text` (as its text or key); fails the test when there is none.
    QQuickItem* itemWithText(const QString& text);
    bool shows(const QString& text) { return find(text) != nullptr; }
    /// The first visible item of a type, by the name its class starts with; null when there is none.
    QQuickItem* itemOfType(const char* type);
    /// The same of the panes, which in a wide window are not alone.
    QQuickItem* paneItemOfType(const char* type);
    QQuickItem* paneItemWithText(const QString& text);

    /// The visible row of that key; fails the test when there is none.
    KelvoCell* row(const QString& key);

    void touch(const QPointF& at);
    void move(const QPointF& to);
    void lift(const QPointF& at);
    void tap(const QPointF& at);
    void tap(QQuickItem* item);
    void tapText(const QString& text) { tap(itemWithText(text)); }
    void type(const char* text);
    void press(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
    static void useDarkColours(bool dark);

private:
    QQuickItem* find(const QString& text) { return find(text, _view->contentItem()); }
    static QQuickItem* find(const QString& text, QQuickItem* within);
    static QQuickItem* itemOfType(const char* type, QQuickItem* within);
    void nextFrame();

    std::unique_ptr<KelvoApp> _app;
    QQuickView* _view = nullptr;
};

}  // namespace kelvo::test
