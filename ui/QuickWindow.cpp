#include "ui/QuickWindow.h"

#include <QDir>
#include <QEventLoop>
#include <QQmlEngine>
#include <QScreen>
#include <QTimer>
#include <chrono>

#include "ui/KelvoApp.h"

namespace kelvo {

void QuickWindow::chooseSceneGraph() {
    const QStringList devices = QDir(QStringLiteral("/dev/dri")).entryList({QStringLiteral("renderD*")}, QDir::System);
    if (devices.isEmpty()) QQuickWindow::setGraphicsApi(QSGRendererInterface::Software);
}

QuickWindow::QuickWindow() : _view(std::make_unique<QQuickView>()) {
    _view->setTitle(QStringLiteral("Kelvo"));
    _view->setResizeMode(QQuickView::SizeRootObjectToView);
    // A phone's screen is filled by its window manager; on a desk the window is as large as a phone's.
    const QSize screen = _view->screen() != nullptr ? _view->screen()->availableSize() : QSize(412, 732);
    _view->resize(screen.boundedTo({412, 732}));
    _view->setMinimumSize(QSize(240, 240).boundedTo(screen));
}

QuickWindow::~QuickWindow() = default;

void QuickWindow::setRootScreen(KelvoApp& application) {
    _view->setInitialProperties({{QStringLiteral("application"), QVariant::fromValue(&application)}});
    _view->setSource(QUrl(QStringLiteral("qrc:/qt-project.org/imports/Kelvo/Ui/qml/Screen.qml")));
}

// Whatever is posted by now may hold the main queue up for a while, so the first frame goes before it. A window that
// the system does not show yet is not waited for.
void QuickWindow::makeKeyAndVisible() {
    constexpr auto kPatience = std::chrono::milliseconds(250);
    QEventLoop untilDrawn;
    QObject::connect(_view.get(), &QQuickWindow::frameSwapped, &untilDrawn, &QEventLoop::quit);
    QTimer::singleShot(kPatience, &untilDrawn, &QEventLoop::quit);
    _view->show();
    _view->requestActivate();
    untilDrawn.exec(QEventLoop::ExcludeUserInputEvents);
}

void QuickWindow::orderOut() { _view->hide(); }

}  // namespace kelvo
