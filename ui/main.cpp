#include <fmt/format.h>
#include <malloc.h>

#include <QGuiApplication>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <filesystem>
#include <memory>
#include <optional>
#include <stdexcept>
#include <string>
#include <utility>

#include "platform/host/HostColorScheme.h"
#include "platform/host/HostEventLoop.h"
#include "platform/host/HostMainQueue.h"
#include "platform/host/HostMessagePorts.h"
#include "platform/host/HostPaths.h"
#include "platform/host/HostPreferences.h"
#include "platform/host/HostSystemLog.h"
#include "platform/host/HostTelephonyClient.h"
#include "platform/host/HostWorker.h"
#include "platform/host/UnixSignals.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "platform/version/Version.h"
#include "ui/ApplicationOptions.h"
#include "ui/FirstWindow.h"
#include "ui/KelvoApp.h"
#include "ui/PlatformStart.h"
#include "ui/QuickWindow.h"
#include "ui/ReplayService.h"
#include "ui/Theme.h"

namespace {

using namespace kelvo;

// A flood of records fills buffers of megabytes. As mappings of their own they go back to the system when it ends; the
// allocator, whose threshold slides up by itself, would keep them in the heap from the second flood on.
constexpr int kOwnMappingFrom = 256 * 1024;  // bytes

void followDesktop(HostColorScheme::Scheme scheme) {
    const bool decided = scheme != HostColorScheme::Scheme::NoPreference;
    Theme::follow(decided ? std::optional(scheme == HostColorScheme::Scheme::Dark) : std::nullopt);
}

std::unique_ptr<ReplayService> startReplay(const std::string& capture) {
    const std::filesystem::path programs = QGuiApplication::applicationDirPath().toStdString();
    auto started = ReplayService::start(programs / "kelvo-telephonyd", capture);
    if (!started) throw std::runtime_error(started.error().reason);
    return std::move(started).value();
}

int runApplication(int argc, char** argv, const ApplicationOptions& options) {
    ::mallopt(M_MMAP_THRESHOLD, kOwnMappingFrom);
    std::optional<PlatformStart> start(std::in_place);
    QuickWindow::chooseSceneGraph();
    QGuiApplication application(argc, argv);
    if (QGuiApplication::screens().isEmpty()) PlatformStart::fail(QStringLiteral("there is no screen"));
    QGuiApplication::setApplicationName(QStringLiteral("kelvo"));
    QGuiApplication::setApplicationDisplayName(QStringLiteral("Kelvo"));
    QGuiApplication::setDesktopFileName(QStringLiteral("org.kelvo.Kelvo"));

    bool isEnding = false;  // by Ctrl-C or a polite kill
    const UnixSignals endings({SIGINT, SIGTERM, SIGHUP}, [&](int) {
        isEnding = true;
        QGuiApplication::quit();
    });
    const HostColorScheme colors(followDesktop);  // early: the answer comes before the first frame
    HostSystemLog log("kelvo");
    const DirectoryResources resources(HostPaths::resourcesDirectory());
    const Environment::Scope environment(
        {.log = &log, .resources = &resources, .standardOutput = stdout, .version = version()});

    HostMainQueue queue;
    const std::unique_ptr<ReplayService> replay = options.capture ? startReplay(*options.capture) : nullptr;
    HostMessagePorts ports(replay ? replay->portDirectory() : HostPaths::portDirectory());
    const FirstWindow first(ports);
    if (first.isElsewhere()) return EXIT_SUCCESS;
    HostTelephonyClient telephony(ports);
    HostPreferences preferences;
    HostWorker worker;
    KelvoApp app({queue, ports, telephony, preferences, worker, [] { return std::make_unique<QuickWindow>(); }});
    app.applicationDidFinishLaunching();
    start.reset();  // a first frame was drawn

    // Closing the window and the signals above end the program the same way.
    QObject::connect(&application, &QGuiApplication::aboutToQuit, &app,
                     [&app] { HostEventLoop::call([&app] { app.applicationWillTerminate(); }); });
    // Making the first screen may have run events, and there was no loop to quit yet.
    if (isEnding) QMetaObject::invokeMethod(&application, &QGuiApplication::quit, Qt::QueuedConnection);
    return HostEventLoop::run(QGuiApplication::exec);
}

}  // namespace

int main(int argc, char** argv) {
    // A failure that ends the program still leaves through every destructor: the log is written out, the ports are
    // given up, and what happened is the last line on standard error.
    try {
        const auto parsed = parseApplicationOptions(argc, argv);
        return parsed.options ? runApplication(argc, argv, *parsed.options) : parsed.exitStatus;
    } catch (const std::exception& failure) {
        fmt::print(stderr, "kelvo: {}\n", failure.what());
        return EXIT_FAILURE;
    }
}
