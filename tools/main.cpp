#include <fmt/format.h>

#include <CLI/CLI.hpp>
#include <cstdio>
#include <filesystem>

#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "platform/version/Version.h"
#include "tools/CommandFailure.h"
#include "tools/DisplayText.h"
#include "tools/Kelvoctl.h"

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
    environment.version = kelvo::version();
    const kelvo::Environment::Scope scope(environment);

    const auto app = kelvo::makeKelvoctl();
    try {
        app->parse(argc, argv);
        return 0;
    } catch (const CLI::Success& help) {
        return app->exit(help);
    } catch (const CLI::ParseError& error) {
        return fail(std::string(error.what()) + " (kelvoctl --help tells what there is)");
    } catch (...) {
        return fail(kelvo::currentExceptionText());
    }
}
