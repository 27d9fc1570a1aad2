#pragma once

#include <QtQml/qqmlregistration.h>
#include <QObject>
#include <memory>
#include <vector>

#include "ui/KelvoPaneController.h"

namespace kelvo {

/// The stack of panes. It decides what is on it; the screen follows its signals.
/// Main thread only. Owns its panes; a popped pane lives on until the screen has finished drawing its leaving.
class NavigationStack : public QObject {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("The application makes its navigation stack")
    Q_PROPERTY(kelvo::KelvoPaneController* rootViewController READ rootViewController CONSTANT)
    Q_PROPERTY(kelvo::KelvoPaneController* topViewController READ topView NOTIFY topViewControllerChanged)
    Q_PROPERTY(bool toolbarHidden READ isToolbarHidden NOTIFY toolbarHiddenChanged)
public:
    using Panes = std::vector<std::unique_ptr<KelvoPaneController>>;

    class Delegate {
    public:
        virtual ~Delegate() = default;
        /// Called before a push or a pop shows `pane`.
        virtual void willShowViewController(KelvoPaneController& pane, bool animated) = 0;
    };

    explicit NavigationStack(std::unique_ptr<KelvoPaneController> root);
    void setDelegate(Delegate* delegate) { _delegate = delegate; }

    const Panes& viewControllers() const { return _panes; }  ///< bottom first, never empty
    KelvoPaneController& topViewController() const { return *_panes.back(); }

    /// The stack is about to be seen for the first time.
    void viewWillAppear() { topViewController().viewWillAppear(); }
    void pushViewController(std::unique_ptr<KelvoPaneController> pane, bool animated);
    /// Pops everything above `pane`, which is on the stack.
    void popToViewController(const KelvoPaneController& pane, bool animated);
    /// One pane back; the root stays. False when there was nothing to pop.
    Q_INVOKABLE bool popViewController();
    /// The screen no longer draws a pane that was popped.
    Q_INVOKABLE void didRemoveView(kelvo::KelvoPaneController* pane);
    KelvoPaneController* rootViewController() const { return _panes.front().get(); }
    KelvoPaneController* topView() const { return _panes.back().get(); }

    bool isToolbarHidden() const { return _toolbarHidden; }
    void setToolbarHidden(bool hidden);

Q_SIGNALS:
    void pushed(kelvo::KelvoPaneController* pane, bool animated);
    void popped(int depth, bool animated);  ///< `depth` panes are left
    void topViewControllerChanged();
    void toolbarHiddenChanged();

private:
    Panes _panes;
    Panes _leaving;
    Delegate* _delegate = nullptr;
    bool _toolbarHidden = true;
};

}  // namespace kelvo
