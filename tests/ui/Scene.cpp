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

QQuickItem* findItem(QQuickItem* item, const std::function<bool(QQuickItem*)>& matches) {
    if (!item->isVisible()) return nullptr;
    const QList<QQuickItem*> children = item->childItems();
    for (auto child = children.rbegin(); child != children.rend(); ++child) {
        if (QQuickItem* found = findItem(*child, matches)) return found;
    }
    return matches(item) ? item : nullptr;
}

}  // namespace

QPointingDevice* touchScreen() {
    static QPointingDevice* const kDevice = QTest::createTouchDevice();
    return kDevice;
}

Scene::Scene(bool savingPermitted, QSize size, std::shared_ptr<const SavedScreens> saved) {
    if (savingPermitted) permitSaving();
    KelvoApp::Services parts = services();
    parts.createWindow = [this, size] {
        auto window = std::make_unique<QuickWindow>();
        _view = &window->view();
        _view->resize(size);
        return window;
    };
    parts.saved = std::move(saved);
    _app = std::make_unique<KelvoApp>(std::move(parts));
    _app->applicationDidFinishLaunching();
    EXPECT_TRUE(QTest::qWaitForWindowActive(_view));
}

Scene::~Scene() { useDarkColours(false); }

void Scene::settle() {
    QCoreApplication::processEvents();  // a resize, or a start that is posted
    const bool settled = QTest::qWaitFor([this] {
        const QQuickItem* stack = itemOfType("QQuickStackView");
        const QQuickItem* sheet = itemOfType("SaveSheet");
        const QQuickItem* details = itemOfType("DetailsSheet");
        const double arrival = _view->rootObject()->property("arrival").toDouble();  // of the overview
        const bool overview = _app->overview() != nullptr && _app->overview()->isOpen();
        const bool sliding = stack->property("busy").toBool() || arrival != (overview ? 1 : 0) ||
                             (sheet != nullptr && sheet->property("moving").toBool()) ||
                             (details != nullptr && details->property("moving").toBool());
        return !sliding && (sheet != nullptr) == (_app->saveViewController() != nullptr) &&
               (details != nullptr) == (_app->details() != nullptr);
    });
    EXPECT_TRUE(settled) << "something never stops moving";
    _view->grabWindow();
}

QQuickItem* Scene::find(const QString& text, QQuickItem* within) {
    return findItem(within, [&](QQuickItem* item) {
        const bool isText = item->inherits("QQuickText");
        return isText && item->property("text").toString() == text;
    });
}

QQuickItem* Scene::itemWithText(const QString& text) {
    QQuickItem* item = find(text);
    EXPECT_NE(item, nullptr) << "nothing on the screen says " << text.toStdString();
    return item;
}

QQuickItem* Scene::paneItemWithText(const QString& text) {
    QQuickItem* item = find(text, itemOfType("QQuickStackView"));
    EXPECT_NE(item, nullptr) << "nothing on the panes says " << text.toStdString();
    return item;
}

KelvoCell* Scene::row(const QString& key) {
    QQuickItem* item = findItem(_view->contentItem(), [&](QQuickItem* candidate) {
        const auto* cell = qobject_cast<KelvoCell*>(candidate);
        return cell != nullptr && cell->key() == key;
    });
    EXPECT_NE(item, nullptr) << "no row is called " << key.toStdString();
    return qobject_cast<KelvoCell*>(item);
}

QQuickItem* Scene::itemOfType(const char* type, QQuickItem* within) {
    return findItem(within, [&](QQuickItem* item) {
        return QByteArray(item->metaObject()->className()).startsWith(type) || item->inherits(type);
    });
}

QQuickItem* Scene::itemOfType(const char* type) { return itemOfType(type, _view->contentItem()); }

QQuickItem* Scene::paneItemOfType(const char* type) { return itemOfType(type, itemOfType("QQuickStackView")); }

void Scene::touch(const QPointF& at) { QTest::touchEvent(_view, touchScreen()).press(0, at.toPoint()); }
void Scene::move(const QPointF& to) {
    QTest::touchEvent(_view, touchScreen()).move(0, to.toPoint());
    nextFrame();  // with which moves are handed on
}

void Scene::nextFrame() {
    bool drawn = false;
    const QMetaObject::Connection watching =
        QObject::connect(_view, &QQuickWindow::frameSwapped, _view, [&drawn] { drawn = true; });
    _view->update();
    EXPECT_TRUE(QTest::qWaitFor([&drawn] { return drawn; }));
    QObject::disconnect(watching);
}

void Scene::lift(const QPointF& at) { QTest::touchEvent(_view, touchScreen()).release(0, at.toPoint()); }

void Scene::tap(const QPointF& at) {
    touch(at);
    lift(at);
}

void Scene::tap(QQuickItem* item) {
    if (item != nullptr) tap(item->mapToScene({item->width() / 2, item->height() / 2}));
}

void Scene::type(const char* text) {
    for (const char* letter = text; *letter != 0; ++letter) QTest::keyClick(_view, *letter);
}

void Scene::press(Qt::Key key, Qt::KeyboardModifiers modifiers) { QTest::keyClick(_view, key, modifiers); }

void Scene::useDarkColours(bool dark) {
    QPalette palette;
    palette.setColor(QPalette::Window, dark ? QColor(0x20, 0x20, 0x20) : QColor(0xef, 0xef, 0xef));
    palette.setColor(QPalette::WindowText, dark ? Qt::white : Qt::black);
    QGuiApplication::setPalette(palette);
}

}  // namespace kelvo::test
