#include <fmt/format.h>

#include <CLI/CLI.hpp>
#include <cstdio>
#include <filesystem>

#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "tools/CommandFailure.h"
#include "tools/DecodeCommand.h"
#include "tools/DisplayText.h"
#include "tools/DoctorCommand.h"
#include "tools/EventsCommand.h"
#include "tools/ExplainCommand.h"
#include "tools/ImportCommand.h"
#include "tools/ShareCommand.h"
#include "tools/SnapshotCommand.h"
#include "tools/StartCommandCommand.h"
#include "tools/WatchCommand.h"

namespace {

/// "../share/kelvo" beside the program: the same in a build tree and installed.
std::filesystem::path resourcesDirectory() {
    std::error_code error;
    const auto program = std::filesystem::read_symlink("/proc/self/exe", error);
    return (program.parent_path() / "../share/kelvo").lexically_normal();
}

int fail(const std::string& reason) {
    fmt::print(stderr, "kelvoctl: {}\n", kelvo::printable(reason));
    return 1;
}

}  // namespace

int main(int argc, char** argv) {
    const kelvo::DirectoryResources resources(resourcesDirectory());
    kelvo::Environment environment;
    environment.resources = &resources;
    environment.version = KELVO_VERSION;
    const kelvo::Environment::Scope scope(environment);

    CLI::App app("Kelvo in the terminal: the screens of a phone's radio, of captures and of snapshots.", "kelvoctl");
    app.require_subcommand(1);
    app.set_version_flag("--version", "kelvoctl " KELVO_VERSION);
    app.footer("\"kelvoctl COMMAND --help\" tells more about a command.");
    kelvo::addDecodeCommand(app);
    kelvo::addWatchCommand(app);
    kelvo::addEventsCommand(app);
    kelvo::addSnapshotCommand(app);
    kelvo::addImportCommand(app);
    kelvo::addShareCommand(app);
    kelvo::addStartCommandCommand(app);
    kelvo::addDoctorCommand(app);
    kelvo::addExplainCommand(app);
    try {
        app.parse(argc, argv);
        return 0;
    } catch (const CLI::Success& help) {
        return app.exit(help);
    } catch (const CLI::ParseError& error) {
        return fail(std::string(error.what()) + " (kelvoctl --help tells what there is)");
    } catch (...) {
        return fail(kelvo::currentExceptionText());
    }
}
