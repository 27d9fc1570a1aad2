#include "ui/NavigationStack.h"

#include <algorithm>

namespace kelvo {

NavigationStack::NavigationStack(std::unique_ptr<KelvoPaneController> root) {
    root->_navigationController = this;
    _panes.push_back(std::move(root));
}

void NavigationStack::pushViewController(std::unique_ptr<KelvoPaneController> pane, bool animated) {
    KelvoPaneController& below = topViewController();
    KelvoPaneController& shown = *pane;
    shown._navigationController = this;
    shown._backTitle = below.title();
    _panes.push_back(std::move(pane));
    if (_delegate != nullptr) _delegate->willShowViewController(shown, animated);
    below.viewWillDisappear();
    shown.viewWillAppear();
    Q_EMIT topViewControllerChanged();
    Q_EMIT pushed(&shown, animated);
}

void NavigationStack::popToViewController(const KelvoPaneController& pane, bool animated) {
    const auto at = std::find_if(_panes.begin(), _panes.end(), [&](const auto& each) { return each.get() == &pane; });
    if (at == _panes.end() || std::next(at) == _panes.end()) return;
    KelvoPaneController& hidden = topViewController();
    std::move(std::next(at), _panes.end(), std::back_inserter(_leaving));
    _panes.erase(std::next(at), _panes.end());
    KelvoPaneController& shown = topViewController();
    if (_delegate != nullptr) _delegate->willShowViewController(shown, animated);
    hidden.viewWillDisappear();
    shown.viewWillAppear();
    Q_EMIT topViewControllerChanged();
    Q_EMIT popped(static_cast<int>(_panes.size()), animated);
}

bool NavigationStack::popViewController() {
    if (_panes.size() < 2) return false;
    popToViewController(*_panes[_panes.size() - 2], true);
    return true;
}

void NavigationStack::didRemoveView(KelvoPaneController* pane) {
    const auto at =
        std::find_if(_leaving.begin(), _leaving.end(), [&](const auto& each) { return each.get() == pane; });
    if (at == _leaving.end()) return;
    at->release()->deleteLater();  // its last page may still be unwinding
    _leaving.erase(at);
}

void NavigationStack::setToolbarHidden(bool hidden) {
    if (_toolbarHidden == hidden) return;
    _toolbarHidden = hidden;
    Q_EMIT toolbarHiddenChanged();
}

}  // namespace kelvo
