#include "ui/KelvoApp.h"

#include <algorithm>
#include <filesystem>

#include "platform/system/Environment.h"

namespace kelvo {

using namespace std::chrono_literals;

KelvoApp::KelvoApp(Services services) : _services(std::move(services)) {}

KelvoApp::~KelvoApp() = default;

void KelvoApp::applicationDidFinishLaunching() {
    if (_services.saved) return showSaved();
    getSaveButtonPref();
    _window = _services.createWindow();
    makeModel();
    setUpdateMessage(QStringLiteral("Connecting..."));
    _dateFormatter = std::make_unique<DateFormatter>(QStringLiteral("'Updated' yyyy-MM-dd 'at' HH:mm:ss"));
    auto root = std::make_unique<KelvoPaneController>(nullptr, "/", *this);
    root->setStatus(QStringLiteral("Connecting"), true);  // the dots come with the first refresh of the status
    showRoot(std::move(root));
    _agingTimer = _services.queue.repeat(2s, _lifetime.whileAlive([this] { letValuesAge(); }));
    _window->makeKeyAndVisible();
    _services.queue.post(_lifetime.whileAlive([this] {
        if (_model) _model->restartMonitor();
    }));
}

void KelvoApp::makeModel() {
    _model = std::make_unique<KelvoModel>(
        KelvoModel::Services{.queue = _services.queue,
                             .ports = _services.ports,
                             .telephony = _services.telephony,
                             .updateViewControllerFromModel = [this] { updateViewControllerFromModel(); },
                             .connectionChanged = [this] { connectionChanged(); }});
    _overview = std::make_unique<OverviewController>(*_model);
}

void KelvoApp::showRoot(std::unique_ptr<KelvoPaneController> root) {
    _navController = std::make_unique<NavigationStack>(std::move(root));
    _navController->setDelegate(this);
    _window->setRootScreen(*this);
    _navController->viewWillAppear();
}

void KelvoApp::showSaved() {
    _window = _services.createWindow();
    auto root = std::make_unique<KelvoPaneController>(_services.saved->topLevelNodes(), "/", *this);
    updateStatusForViewController(*root);
    showRoot(std::move(root));
    _window->makeKeyAndVisible();
}

const ShownValues* KelvoApp::shownValues() const {
    if (_services.saved) return _services.saved.get();
    return _model.get();
}

void KelvoApp::getSaveButtonPref() {
    std::error_code unreadable;  // no marker to be seen, no button
    setAllowSaveButton(std::filesystem::exists(_services.saveMarkerPath, unreadable));
}

void KelvoApp::updateStatusForViewController(KelvoPaneController& pane) {
    if (const SavedScreens* const saved = _services.saved.get()) {
        pane.setStatus(QString::fromStdString(saved->savedText()), false);
        return pane.setHints(QString::fromStdString(saved->whyEmpty()), QString::fromStdString(saved->note()));
    }
    const bool isConnected = _model && _model->isConnected();
    pane.setStatus(QString::fromStdString(statusText(isConnected, _updateMessage.toStdString())), !isConnected);
    if (_model) pane.setConnection(_model->connection());
}

void KelvoApp::updateViewControllerFromModel() {
    if (!_model) return;  // a refresh that was on its way when the program ended
    reloadPanes();
    if (_details) _details->reload();
    _overview->refreshed();
    if (_model->isConnected()) setUpdateMessage(_dateFormatter->stringFromDate(clock().now()));
    updateStatusForViewController(_navController->topViewController());
}

void KelvoApp::connectionChanged() {
    if (_overview) _overview->connectionChanged();
    KelvoPaneController& top = _navController->topViewController();
    if (!_model->isConnected() && !top.isLoading()) return updateStatusForViewController(top);
    top.setConnection(_model->connection());
}

void KelvoApp::reloadPanes() {
    const NavigationStack::Panes& panes = _navController->viewControllers();
    panes[0]->reloadWithNode(_model->topLevelNodes());
    for (std::size_t i = 1; i < panes.size(); ++i) {
        NodeRef node = _model->nodeAtPath(panes[i]->path());
        if (!node) return _navController->popToViewController(*panes[i - 1], true);
        panes[i]->reloadWithNode(std::move(node));
    }
}

void KelvoApp::willShowViewController(KelvoPaneController& pane, bool) { updateStatusForViewController(pane); }

void KelvoApp::showSaveView() {
    if (_saveViewController || _details || !_model) return;
    _saveViewController = std::make_unique<KelvoSaveViewController>(
        _model->getSaveContents(),
        KelvoSaveViewController::Services{_services.queue, *this, _services.worker, _services.snapshotDirectory});
    Q_EMIT saveViewPresented(_saveViewController.get());
}

void KelvoApp::closeSaveView() {
    if (!_saveViewController) return;
    _leavingSaveViews.push_back(std::move(_saveViewController));
    Q_EMIT saveViewDismissed();
}

void KelvoApp::didRemoveSaveView(KelvoSaveViewController* screen) { release(_leavingSaveViews, screen); }

template <class Screen>
void KelvoApp::release(std::vector<std::unique_ptr<Screen>>& leaving, Screen* screen) {
    const auto at = std::ranges::find_if(leaving, [&](const auto& each) { return each.get() == screen; });
    if (at == leaving.end()) return;
    at->release()->deleteLater();  // its view may still be unwinding
    leaving.erase(at);
}

void KelvoApp::showDetails(const std::string& path, int row) {
    const ShownValues* const values = shownValues();
    if (_details || _saveViewController || values == nullptr) return;
    _details = std::make_unique<DetailsController>(*values, path, row, *this);
    Q_EMIT detailsPresented(_details.get());
}

std::optional<std::chrono::milliseconds> KelvoApp::ageOf(const KelvoModelNode& node) const {
    const auto provenance = _model ? _model->provenance(node) : std::nullopt;
    if (!provenance) return std::nullopt;
    return std::chrono::duration_cast<std::chrono::milliseconds>(provenance->age);
}

// Values grow older whether or not records come, and when the connection is lost.
void KelvoApp::letValuesAge() {
    _navController->topViewController().updateAges();
    if (_details) _details->reload();
    _overview->letPass();
}

void KelvoApp::closeDetails() {
    if (!_details) return;
    _leavingDetails.push_back(std::move(_details));
    Q_EMIT detailsDismissed();
}

void KelvoApp::didRemoveDetails(DetailsController* details) { release(_leavingDetails, details); }

void KelvoApp::showAlert(const QString& title, const QString& message, const QString& button) {
    _alertTitle = title;
    _alertMessage = message;
    _alertButton = button;
    _alertShown = true;
    Q_EMIT alertChanged();
}

void KelvoApp::alertButtonPressed() {
    _alertShown = false;
    Q_EMIT alertChanged();
}

// The home screen stops showing the signal as a number: this program is done with it.
void KelvoApp::_setGSMRSSI(bool shown) {
    constexpr const char* kDomain = "com.zorvik.dockmere";
    constexpr const char* kKey = "DMShowGSMRSSI";
    _services.preferences.set(kDomain, kKey, shown);
    _services.preferences.broadcastChange(kDomain, kKey);
}

void KelvoApp::applicationWillTerminate() {
    if (_terminated) return;
    _terminated = true;
    if (!_services.saved) _setGSMRSSI(false);
    setUpdateMessage({});
    _dateFormatter.reset();
    closeSaveView();
    closeDetails();
    _agingTimer.reset();
    if (_window) _window->orderOut();
    _window.reset();
    _overview.reset();
    _model.reset();
}

}  // namespace kelvo
