#pragma once

#include <QtQml/qqmlregistration.h>
#include <QObject>
#include <QString>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "model/KelvoModel.h"
#include "platform/system/Lifetime.h"
#include "platform/system/Preferences.h"
#include "ui/DateFormatter.h"
#include "ui/DetailsController.h"
#include "ui/KelvoSaveViewController.h"
#include "ui/NavigationStack.h"
#include "ui/OverviewController.h"
#include "ui/SavedScreens.h"
#include "ui/ScreenHost.h"
#include "ui/Window.h"

namespace kelvo {

/// The application: owns the model, the window, the stack of panes, the status text that every pane shows and the save
/// screen. Of saved screens it shows the panes and values' details alone. Main thread only.
class KelvoApp : public QObject, public ScreenHost, public NavigationStack::Delegate {
    Q_OBJECT
    QML_ELEMENT
    QML_UNCREATABLE("There is one application")
    Q_PROPERTY(kelvo::NavigationStack* navigation READ navigation CONSTANT)
    Q_PROPERTY(kelvo::OverviewController* overview READ overview CONSTANT)
    Q_PROPERTY(QString alertTitle READ alertTitle NOTIFY alertChanged)
    Q_PROPERTY(QString alertMessage READ alertMessage NOTIFY alertChanged)
    Q_PROPERTY(QString alertButton READ alertButton NOTIFY alertChanged)
    Q_PROPERTY(bool alertShown READ isAlertShown NOTIFY alertChanged)
public:
    /// What the application stands on; everything outlives it.
    struct Services {
        MainQueue& queue;
        MessagePorts& ports;
        TelephonyClient& telephony;
        Preferences& preferences;
        Worker& worker;
        std::function<std::unique_ptr<Window>()> createWindow;
        /// A file or directory here permits saving.
        std::string saveMarkerPath = "/ZorvikInternal/Library/PreferenceBundles/Carrier Settings.bundle";
        std::string snapshotDirectory = "/var/mobile/Library/Logs/Quillet";
        /// Screens to show for reading in place of a modem's; then nothing else here but queue and window is used.
        std::shared_ptr<const SavedScreens> saved = nullptr;
    };

    explicit KelvoApp(Services services);
    ~KelvoApp() override;

    /// The launch sequence, once. The connection starts only after it has returned, so that a first frame can be drawn.
    void applicationDidFinishLaunching();
    /// The termination sequence; whatever ends the program, it runs once.
    void applicationWillTerminate();

    NavigationStack* navigation() const { return _navController.get(); }  ///< null before launch
    /// Null before launch, after termination, and where saved screens are shown.
    KelvoModel* model() const { return _model.get(); }
    OverviewController* overview() const { return _overview.get(); }  ///< likewise
    KelvoSaveViewController* saveViewController() const { return _saveViewController.get(); }

    const QString& updateMessage() const { return _updateMessage; }
    void setUpdateMessage(const QString& message) { _updateMessage = message; }
    bool allowSaveButton() const override { return _allowSaveButton; }
    MainQueue& queue() const override { return _services.queue; }
    void setAllowSaveButton(bool allow) { _allowSaveButton = allow; }

    void updateStatusForViewController(KelvoPaneController& pane);
    /// Reloads every pane from the model, bottom first; a pane whose path is gone takes itself and all above with it.
    void updateViewControllerFromModel();
    /// Tells every pane of a lost connection, and of records that stay away, even when nothing new has come: old values
    /// must not pass for current ones.
    void connectionChanged();
    void willShowViewController(KelvoPaneController& pane, bool animated) override;

    void showSaveView() override;
    void closeSaveView() override;
    /// The screen no longer draws a save screen that was closed.
    Q_INVOKABLE void didRemoveSaveView(kelvo::KelvoSaveViewController* screen);

    std::optional<std::chrono::milliseconds> ageOf(const KelvoModelNode& node) const override;
    void showDetails(const std::string& path, int row) override;
    void closeDetails() override;
    /// The screen no longer draws details that were closed.
    Q_INVOKABLE void didRemoveDetails(kelvo::DetailsController* details);
    DetailsController* details() const { return _details.get(); }

    void showAlert(const QString& title, const QString& message, const QString& button) override;
    Q_INVOKABLE void alertButtonPressed();
    bool isAlertShown() const { return _alertShown; }
    const QString& alertTitle() const { return _alertTitle; }
    const QString& alertMessage() const { return _alertMessage; }
    const QString& alertButton() const { return _alertButton; }

Q_SIGNALS:
    void saveViewPresented(kelvo::KelvoSaveViewController* screen);
    void saveViewDismissed();
    void detailsPresented(kelvo::DetailsController* details);
    void detailsDismissed();
    void alertChanged();

private:
    template <class Screen>
    static void release(std::vector<std::unique_ptr<Screen>>& leaving, Screen* screen);
    void getSaveButtonPref();
    void makeModel();
    void showRoot(std::unique_ptr<KelvoPaneController> root);
    void showSaved();
    const ShownValues* shownValues() const;
    void reloadPanes();
    void _setGSMRSSI(bool shown);
    void letValuesAge();

    const Services _services;
    std::unique_ptr<KelvoModel> _model;
    QString _updateMessage;
    bool _allowSaveButton = false;
    std::unique_ptr<DateFormatter> _dateFormatter;
    std::unique_ptr<NavigationStack> _navController;
    std::unique_ptr<KelvoSaveViewController> _saveViewController;
    std::vector<std::unique_ptr<KelvoSaveViewController>> _leavingSaveViews;  // still drawn sliding away
    std::unique_ptr<DetailsController> _details;
    std::vector<std::unique_ptr<DetailsController>> _leavingDetails;
    std::unique_ptr<OverviewController> _overview;
    bool _alertShown = false;
    QString _alertTitle;
    QString _alertMessage;
    QString _alertButton;
    std::unique_ptr<RepeatingTimer> _agingTimer;
    bool _terminated = false;
    std::unique_ptr<Window> _window;  // behind the rest, so that nothing it draws goes before it
    const Lifetime _lifetime;         // tasks on the queue outlive the application
};

}  // namespace kelvo
