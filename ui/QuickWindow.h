#pragma once

#include <QQuickView>
#include <memory>

#include "ui/Window.h"

namespace kelvo {

/// The window on the desktop or the phone's screen, drawn by the Qt Quick scene graph.
class QuickWindow final : public Window {
public:
    /// Chooses how windows are drawn: by the CPU where the machine has no graphics device, else by the GPU. Before the
    /// first window.
    static void chooseSceneGraph();
    /// The size of the new window, in device-independent pixels: a phone's whole screen, or a part of a desk's.
    static QSize openingSize(QSize screen);

    explicit QuickWindow(const QString& title = QStringLiteral("Kelvo"));
    ~QuickWindow() override;

    void setRootScreen(KelvoApp& application) override;
    void makeKeyAndVisible() override;
    void orderOut() override;

    QQuickView& view() { return *_view; }

private:
    std::unique_ptr<QQuickView> _view;
};

}  // namespace kelvo
