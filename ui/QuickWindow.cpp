#include "ui/QuickWindow.h"

#include <QDir>
#include <QEventLoop>
#include <QQmlEngine>
#include <QScreen>
#include <QTimer>
#include <algorithm>
#include <chrono>

#include "ui/KelvoApp.h"

namespace kelvo {
namespace {

constexpr QSize kOnADesk(412, 732);  // as large as a phone's

}  // namespace

void QuickWindow::chooseSceneGraph() {
    const QStringList devices = QDir(QStringLiteral("/dev/dri")).entryList({QStringLiteral("renderD*")}, QDir::System);
    if (devices.isEmpty()) QQuickWindow::setGraphicsApi(QSGRendererInterface::Software);
}

QuickWindow::QuickWindow(const QString& title) : _view(std::make_unique<QQuickView>()) {
    _view->setTitle(title);
    _view->setResizeMode(QQuickView::SizeRootObjectToView);
    const QSize screen = _view->screen() != nullptr ? _view->screen()->availableSize() : kOnADesk;
    _view->resize(openingSize(screen));
    _view->setMinimumSize(QSize(240, 240).boundedTo(screen));
}

QuickWindow::~QuickWindow() = default;

QSize QuickWindow::openingSize(QSize screen) {
    constexpr int kWidestPhone = 600;
    const bool phone = std::min(screen.width(), screen.height()) <= kWidestPhone;
    return phone ? screen : screen.boundedTo(kOnADesk);
}

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
