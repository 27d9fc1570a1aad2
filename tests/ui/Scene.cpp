#include "tests/ui/Scene.h"

#include <gtest/gtest.h>

#include <QGuiApplication>
#include <QPalette>
#include <QPointingDevice>
#include <QQuickItem>
#include <QTest>
#include <functional>

namespace kelvo::test {
namespace {

QPointingDevice* touchScreen() {
    static QPointingDevice* const kDevice = QTest::createTouchDevice();
    return kDevice;
}

QQuickItem* findItem(QQuickItem* item, const std::function<bool(QQuickItem*)>& matches) {
    if (!item->isVisible()) return nullptr;
    const QList<QQuickItem*> children = item->childItems();
    for (auto child = children.rbegin(); child != children.rend(); ++child) {
        if (QQuickItem* found = findItem(*child, matches)) return found;
    }
    return matches(item) ? item : nullptr;
}

}  // namespace

Scene::Scene(bool savingPermitted, QSize size) {
    if (savingPermitted) permitSaving();
    KelvoApp::Services parts = services();
    parts.createWindow = [this, size] {
        auto window = std::make_unique<QuickWindow>();
        _view = &window->view();
        _view->resize(size);
        return window;
    };
    _app = std::make_unique<KelvoApp>(std::move(parts));
    _app->applicationDidFinishLaunching();
    EXPECT_TRUE(QTest::qWaitForWindowActive(_view));
}

Scene::~Scene() { useDarkColours(false); }

void Scene::settle() {
    // Longer than any transition; what follows does not depend on how long it took.
    QTest::qWait(400);
    _view->grabWindow();
}

QQuickItem* Scene::find(const QString& text) {
    return findItem(_view->contentItem(), [&](QQuickItem* item) {
        const bool isText = item->inherits("QQuickText");
        return isText && item->property("text").toString() == text;
    });
}

QQuickItem* Scene::itemWithText(const QString& text) {
    QQuickItem* item = find(text);
    EXPECT_NE(item, nullptr) << "nothing on the screen says " << text.toStdString();
    return item;
}

QQuickItem* Scene::itemOfType(const char* type) {
    return findItem(_view->contentItem(), [&](QQuickItem* item) {
        return QByteArray(item->metaObject()->className()).startsWith(type) || item->inherits(type);
    });
}

void Scene::tap(const QPointF& at) {
    QTest::touchEvent(_view, touchScreen()).press(0, at.toPoint());
    QTest::touchEvent(_view, touchScreen()).release(0, at.toPoint());
}

void Scene::tap(QQuickItem* item) {
    if (item != nullptr) tap(item->mapToScene({item->width() / 2, item->height() / 2}));
}

void Scene::press(Qt::Key key, Qt::KeyboardModifiers modifiers) { QTest::keyClick(_view, key, modifiers); }

void Scene::useDarkColours(bool dark) {
    QPalette palette;
    palette.setColor(QPalette::Window, dark ? QColor(0x20, 0x20, 0x20) : QColor(0xef, 0xef, 0xef));
    palette.setColor(QPalette::WindowText, dark ? Qt::white : Qt::black);
    QGuiApplication::setPalette(palette);
}

}  // namespace kelvo::test
