#include <fmt/format.h>
#include <malloc.h>
#include <unistd.h>

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
#include "ui/OpenedFile.h"
#include "ui/PlatformStart.h"
#include "ui/QuickWindow.h"
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

/// The file that the application was started with; in place of one that cannot be shown, screens that say why.
struct Start {
    OpenedFile file;
    QString title = QStringLiteral("Kelvo");
    bool failed = false;
};

/// Whoever started it in a terminal reads the line. Behind a file manager nobody does: then a window says the same, of
/// a file that everybody there knows by its name alone.
Start refuse(const std::filesystem::path& path, std::string reason) {
    if (::isatty(STDERR_FILENO) != 0) throw std::runtime_error(reason);
    fmt::print(stderr, "kelvo: {}\n", reason);
    std::fflush(stderr);
    if (reason.starts_with(path.native())) reason.replace(0, path.native().size(), path.filename().native());
    Start start;
    start.file.screens = std::make_shared<const SavedScreens>(SavedScreens::refused(reason));
    start.failed = true;
    return start;
}

Start open(const std::string& argument) {
    const std::filesystem::path path = pathFromArgument(argument);
    const std::filesystem::path programs = QGuiApplication::applicationDirPath().toStdString();
    auto opened = OpenedFile::open(path.native(), programs / "kelvo-telephonyd");
    Start start;
    if (opened)
        start.file = std::move(opened).value();
    else
        start = refuse(path, opened.error().reason);
    if (start.file.screens)
        start.title = QString::fromStdString(path.filename().native() + ": " + start.file.screens->savedText());
    return start;
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
    const Start opened = options.file ? open(*options.file) : Start();
    const OpenedFile& file = opened.file;
    HostMessagePorts ports(file.replay ? file.replay->portDirectory() : HostPaths::portDirectory());
    std::optional<FirstWindow> first;
    if (!opened.failed) first.emplace(ports, file.screens ? file.window : FirstWindow::kLive);
    if (first && first->isElsewhere()) return EXIT_SUCCESS;
    HostTelephonyClient telephony(ports);
    HostPreferences preferences;
    HostWorker worker;
    KelvoApp app({.queue = queue,
                  .ports = ports,
                  .telephony = telephony,
                  .preferences = preferences,
                  .worker = worker,
                  .createWindow = [&opened] { return std::make_unique<QuickWindow>(opened.title); },
                  .saved = file.screens});
    app.applicationDidFinishLaunching();
    start.reset();  // a first frame was drawn

    // Closing the window and the signals above end the program the same way.
    QObject::connect(&application, &QGuiApplication::aboutToQuit, &app,
                     [&app] { HostEventLoop::call([&app] { app.applicationWillTerminate(); }); });
    // Making the first screen may have run events, and there was no loop to quit yet.
    if (isEnding) QMetaObject::invokeMethod(&application, &QGuiApplication::quit, Qt::QueuedConnection);
    const int status = HostEventLoop::run(QGuiApplication::exec);
    return opened.failed ? EXIT_FAILURE : status;
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
