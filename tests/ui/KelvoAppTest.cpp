#include "ui/KelvoApp.h"

#include <gtest/gtest.h>

#include <fstream>

#include "tests/ui/AppWorld.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using test::Events;
using test::sampleTree;

class App : public testing::Test {
protected:
    void SetUp() override { app = std::make_unique<KelvoApp>(world.services()); }
    void launch() { app->applicationDidFinishLaunching(); }
    /// Launched, connected and showing a tree with three neighbors.
    void run() {
        launch();
        world.queue.run();
        world.show(sampleTree(3));
    }
    KelvoPaneController& pane(std::size_t depth) { return *app->navigation()->viewControllers()[depth]; }
    KelvoPaneController& top() { return app->navigation()->topViewController(); }
    std::size_t depth() { return app->navigation()->viewControllers().size(); }
    std::string status(KelvoPaneController& of) {
        return of.status().toStdString() + (of.isLoading() ? " (loading)" : "");
    }
    std::string status() { return status(top()); }
    std::string value(KelvoPaneController& of, int row) {
        return of.data(of.index(row), KelvoPaneController::ValueRole).toString().toStdString();
    }
    bool logged(const std::string& text) {
        for (const auto& [level, line] : world.log.lines()) {
            if (line == text) return true;
        }
        return false;
    }

    test::AppWorld world;
    std::unique_ptr<KelvoApp> app;
};

/// Notes how far the launch or the termination has come whenever something is done to the window.
class WatchingWindow final : public Window {
public:
    WatchingWindow(KelvoApp& app, test::AppWorld& world) : _app(app), _world(world) { note("created"); }
    ~WatchingWindow() override { note("destroyed"); }
    void setRootScreen(KelvoApp&) override { note("root"); }
    void makeKeyAndVisible() override { note("shown"); }
    void orderOut() override { note("off"); }

private:
    void note(const char* what) {
        std::string text = std::string(what) + ": save " + (_app.allowSaveButton() ? "yes" : "no");
        text += _app.model() != nullptr ? ", model" : ", no model";
        text += _app.saveViewController() != nullptr ? ", sheet" : ", no sheet";
        text += ", message '" + _app.updateMessage().toStdString() + "'";
        if (_app.navigation() != nullptr) text += ", " + _app.navigation()->topViewController().status().toStdString();
        text += ", asked " + std::to_string(_world.telephony.askedFor.size());
        text += ", ports " + std::to_string(_world.ports.openLocals());
        _world.events.push_back(text);
    }
    KelvoApp& _app;
    test::AppWorld& _world;
};

TEST_F(App, LaunchesInItsOrderAndConnectsOnlyAfterwards) {
    world.permitSaving();
    KelvoApp::Services services = world.services();
    services.createWindow = [this] { return std::make_unique<WatchingWindow>(*app, world); };
    app = std::make_unique<KelvoApp>(std::move(services));
    launch();
    EXPECT_EQ(world.events,
              (Events{"created: save yes, no model, no sheet, message '', asked 0, ports 0",
                      "root: save yes, model, no sheet, message 'Connecting...', Connecting, asked 0, ports 0",
                      "shown: save yes, model, no sheet, message 'Connecting...', Connecting, asked 0, ports 0"}));
    world.queue.run();
    EXPECT_EQ(world.telephony.askedFor.size(), 1U);
    EXPECT_TRUE(app->model()->isConnected());
    app->applicationWillTerminate();
}

TEST_F(App, ShowsAnEmptyPaneThatIsConnectingBeforeAnythingHasRun) {
    launch();
    EXPECT_EQ(depth(), 1U);
    EXPECT_EQ(top().title(), QStringLiteral("Kelvo"));
    EXPECT_EQ(top().path(), "/");
    EXPECT_EQ(top().rowCount(), 0);
    EXPECT_EQ(status(), "Connecting (loading)");
    EXPECT_FALSE(app->navigation()->isToolbarHidden());
    EXPECT_EQ(world.events, (Events{"window created", "root screen set", "window shown"}));
}

TEST_F(App, TerminatesInItsOrder) {
    KelvoApp::Services services = world.services();
    services.createWindow = [this] { return std::make_unique<WatchingWindow>(*app, world); };
    app = std::make_unique<KelvoApp>(std::move(services));
    launch();
    world.queue.run();
    app->showSaveView();
    ASSERT_NE(app->saveViewController(), nullptr);
    QObject::connect(app.get(), &KelvoApp::saveViewDismissed, app.get(), [this] {
        world.events.push_back("sheet away: message '" + app->updateMessage().toStdString() + "'");
    });
    world.events.clear();
    app->applicationWillTerminate();
    EXPECT_EQ(world.events, (Events{"set com.zorvik.dockmere DMShowGSMRSSI false",
                                    "broadcast com.zorvik.dockmere DMShowGSMRSSI", "sheet away: message ''",
                                    "off: save no, model, no sheet, message '', Connecting, asked 1, ports 1",
                                    "destroyed: save no, model, no sheet, message '', Connecting, asked 1, ports 1"}));
    EXPECT_EQ(app->model(), nullptr);
    EXPECT_EQ(app->saveViewController(), nullptr);
    EXPECT_EQ(world.ports.openLocals(), 0U);
}

TEST_F(App, TellsOfThePreferenceAlsoWhenItCouldNotBeWritten) {
    launch();
    world.events.clear();
    world.preferences.writable = false;
    app->applicationWillTerminate();
    ASSERT_GE(world.events.size(), 2U);
    EXPECT_EQ(world.events[0], "set com.zorvik.dockmere DMShowGSMRSSI false");
    EXPECT_EQ(world.events[1], "broadcast com.zorvik.dockmere DMShowGSMRSSI");
}

TEST_F(App, TerminatesOnce) {
    launch();
    app->applicationWillTerminate();
    world.events.clear();
    app->applicationWillTerminate();
    EXPECT_TRUE(world.events.empty());
}

TEST_F(App, StaysQuietWhenTasksComeAfterTheEnd) {
    launch();
    app->applicationWillTerminate();
    world.queue.run();
    app->updateViewControllerFromModel();
    app->showSaveView();
    EXPECT_TRUE(world.telephony.askedFor.empty());
    EXPECT_EQ(app->saveViewController(), nullptr);
}

TEST_F(App, NeverConnectsWhenItHasGoneBeforeTheQueueRan) {
    launch();
    app.reset();
    world.queue.run();
    EXPECT_TRUE(world.telephony.askedFor.empty());
}

TEST_F(App, StampsEachRefreshThatFindsTheModelConnected) {
    run();
    EXPECT_EQ(status(), "Updated 2011-03-04 at 09:15:04");
    world.show(sampleTree(3));
    EXPECT_EQ(status(), "Updated 2011-03-04 at 09:15:06");
    EXPECT_EQ(app->updateMessage(), QStringLiteral("Updated 2011-03-04 at 09:15:06"));
}

TEST_F(App, KeepsTheLastStampWhileItIsDisconnected) {
    run();
    world.deliver(sampleTree(2));
    world.loseService();
    app->model()->restartMonitor();
    app->updateViewControllerFromModel();
    EXPECT_EQ(status(), "Connecting... (loading)");
    EXPECT_EQ(app->updateMessage(), QStringLiteral("Updated 2011-03-04 at 09:15:04"));

    world.reviveService();
    world.pass(5s);
    ASSERT_TRUE(app->model()->isConnected());
    top().didSelectRow(0);
    EXPECT_EQ(status(), "Updated 2011-03-04 at 09:15:04");
}

TEST_F(App, ReloadsEveryPaneFromTheBottom) {
    run();
    top().didSelectRow(0);
    EXPECT_EQ(value(top(), 1), "-95 dBm");
    world.show(sampleTree(4, "-80 dBm"));
    EXPECT_EQ(depth(), 2U);
    EXPECT_EQ(value(top(), 1), "-80 dBm");
    EXPECT_EQ(status(), "Updated 2011-03-04 at 09:15:06");
}

TEST_F(App, OnlyRefreshesTheStatusOfThePaneOnTop) {
    run();
    top().didSelectRow(0);
    world.show(sampleTree(3));
    EXPECT_EQ(status(pane(0)), "Updated 2011-03-04 at 09:15:04");
    EXPECT_EQ(status(pane(1)), "Updated 2011-03-04 at 09:15:06");
    app->navigation()->popViewController();
    EXPECT_EQ(status(), "Updated 2011-03-04 at 09:15:06");
}

TEST_F(App, PopsBackToTheParentOfAPaneWhosePathIsGone) {
    run();
    top().didSelectRow(1);  // Neighbor Cells
    top().didSelectRow(2);  // the third of them
    ASSERT_EQ(top().path(), "/Neighbor Cells/2");
    KelvoPaneController& gone = top();
    world.show(sampleTree(2, "-80 dBm"));
    EXPECT_EQ(depth(), 2U);
    EXPECT_EQ(top().path(), "/Neighbor Cells");
    EXPECT_EQ(top().rowCount(), 2);
    EXPECT_EQ(status(), "Updated 2011-03-04 at 09:15:06");
    EXPECT_EQ(value(gone, 1), "-95 dBm");  // still drawn on its way out, and never reloaded
}

TEST_F(App, NeverReloadsThePanesAboveTheFirstThatIsGone) {
    run();
    top().didSelectRow(1);
    top().didSelectRow(0);
    KelvoPaneController& above = top();
    world.show(Dictionary::make({{"Serving Cell", "none"}, {"Registration", "Searching"}}));
    EXPECT_EQ(depth(), 1U);
    EXPECT_EQ(top().rowCount(), 2);
    EXPECT_EQ(value(above, 1), "-95 dBm");
}

TEST_F(App, NeverReloadsAPaneAboveTheFirstThatIsGoneEvenWhenItsOwnPathIsStillThere) {
    run();
    const auto twoRows = [](const char* x) { return Dictionary::make({{"x", x}, {"y", "2"}}); };
    world.show(Dictionary::make({{"A", Dictionary::make({{"B", twoRows("1")}, {"c", "1"}})}, {"z", "1"}}));
    top().didSelectRow(0);
    top().didSelectRow(0);
    ASSERT_EQ(top().path(), "/A/B");
    KelvoPaneController& above = top();
    world.show(Dictionary::make({{"A/B", twoRows("9")}, {"z", "1"}}));  // a name that reads like the pane's path
    ASSERT_NE(app->model()->nodeAtPath("/A/B"), nullptr);
    ASSERT_EQ(app->model()->nodeAtPath("/A"), nullptr);
    EXPECT_EQ(depth(), 1U);
    EXPECT_EQ(value(above, 0), "1");
}

TEST_F(App, ReloadsTheRootEvenWhenThereIsNoTree) {
    world.telephony.reachable = false;
    launch();
    world.queue.run();
    app->updateViewControllerFromModel();
    EXPECT_EQ(depth(), 1U);
    EXPECT_EQ(top().title(), QStringLiteral("Kelvo"));
    EXPECT_EQ(status(), "Connecting... (loading)");
    EXPECT_EQ(app->updateMessage(), QStringLiteral("Connecting..."));
}

TEST_F(App, ShowsAnEmptyRootWithItsStampWhenItIsConnectedBeforeTheFirstPacket) {
    launch();
    world.queue.run();
    ASSERT_TRUE(app->model()->isConnected());
    app->updateViewControllerFromModel();
    EXPECT_EQ(depth(), 1U);
    EXPECT_EQ(top().title(), QStringLiteral("Kelvo"));
    EXPECT_EQ(top().rowCount(), 0);
    EXPECT_EQ(status(), "Updated 2011-03-04 at 09:15:02");
    world.show(sampleTree(3));
    EXPECT_EQ(top().rowCount(), 3);
}

TEST_F(App, OffersNoSaveButtonWithoutTheMarker) {
    run();
    top().didSelectRow(0);
    EXPECT_FALSE(app->allowSaveButton());
    EXPECT_FALSE(pane(0).offersSave());
    EXPECT_FALSE(pane(1).offersSave());
}

TEST_F(App, OffersTheSaveButtonForAMarkerThatIsAFileAndLooksOnlyAtLaunch) {
    std::ofstream(world.markerPath()) << "marker";
    run();
    EXPECT_TRUE(top().offersSave());
    std::filesystem::remove(world.markerPath());
    world.show(sampleTree(1));
    EXPECT_TRUE(top().offersSave());
}

TEST_F(App, PresentsOneSaveScreenHoweverOftenTheButtonIsPressed) {
    world.permitSaving();
    run();
    top().saveButtonPressed();
    KelvoSaveViewController* screen = app->saveViewController();
    ASSERT_NE(screen, nullptr);
    EXPECT_EQ(screen->rowCount(), 1);  // one refresh so far
    top().saveButtonPressed();
    EXPECT_EQ(app->saveViewController(), screen);
}

TEST_F(App, ClosesTheSaveScreenFromTheQueueAndOpensAnother) {
    world.permitSaving();
    run();
    app->showSaveView();
    app->saveViewController()->cancelPressed();
    EXPECT_NE(app->saveViewController(), nullptr);
    world.queue.run();
    EXPECT_EQ(app->saveViewController(), nullptr);
    app->closeSaveView();  // nothing to close
    app->showSaveView();
    EXPECT_NE(app->saveViewController(), nullptr);
}

TEST_F(App, AlertsOverThePaneOnceTheSaveScreenHasGone) {
    world.permitSaving();
    run();
    app->showSaveView();
    std::filesystem::remove(world.snapshotDirectory());
    app->saveViewController()->savePressed();
    world.queue.run();
    EXPECT_EQ(app->saveViewController(), nullptr);
    EXPECT_TRUE(app->isAlertShown());
    EXPECT_EQ(app->alertTitle(), QStringLiteral("File Error"));
    EXPECT_EQ(app->alertMessage(), QStringLiteral("Unable to write file to disk"));
    EXPECT_EQ(app->alertButton(), QStringLiteral("Close"));
    EXPECT_TRUE(logged("Unable to write snapshot to " +
                       (world.snapshotDirectory() / "KelvoSnapshot-1299230104.kelvo").string()));
    app->alertButtonPressed();
    EXPECT_FALSE(app->isAlertShown());
}

TEST_F(App, OpensTheSaveScreenEvenBeforeThereIsAModem) {
    world.permitSaving();
    world.telephony.reachable = false;
    launch();
    app->showSaveView();
    EXPECT_EQ(app->saveViewController()->rowCount(), 0);
}

TEST_F(App, LooksForTheMarkerAndSavesWhereTheInstallationPutsThem) {
    const KelvoApp::Services services{world.queue, world.ports, world.telephony, world.preferences, world.worker, {}};
    EXPECT_EQ(services.saveMarkerPath, "/ZorvikInternal/Library/PreferenceBundles/Carrier Settings.bundle");
    EXPECT_EQ(services.snapshotDirectory, "/var/mobile/Library/Logs/Quillet");
}

TEST(DateFormatter, KeepsQuotedWordsAndUsesTheLocalTime) {
    const test::ManualClock clock{1299230102, -300};  // 09:15:02 UTC, five hours west
    const Environment::Scope environment{{.clock = &clock}};
    const DateFormatter formatter(QStringLiteral("'Updated' yyyy-MM-dd 'at' HH:mm:ss"));
    EXPECT_EQ(formatter.stringFromDate(clock.now()), QStringLiteral("Updated 2011-03-04 at 04:15:02"));
}

}  // namespace
}  // namespace kelvo
