#include "ui/ApplicationOptions.h"

#include <fmt/format.h>

#include <CLI/CLI.hpp>
#include <cstdio>

#include "platform/version/Version.h"

namespace kelvo {
namespace {

constexpr const char* kFooter =
    "What it shows comes from the telephony service, kelvo-telephonyd. In a terminal, \"kelvoctl watch\" shows the\n"
    "same screens.";

struct CommandLine {
    CommandLine() {
        app.footer(kFooter);
        app.set_version_flag("--version", versionLine("kelvo"));
    }
    CLI::App app{"Shows what a phone's baseband modem reports right now, as screens.", "kelvo"};
};

}  // namespace

std::optional<int> applicationExitStatus(int argc, const char* const* argv) {
    CommandLine line;
    try {
        line.app.parse(argc, argv);
        return std::nullopt;
    } catch (const CLI::CallForHelp&) {
        fmt::print("{}", line.app.help());
        return 0;
    } catch (const CLI::CallForVersion& version) {
        fmt::print("{}\n", version.what());
        return 0;
    } catch (const CLI::ParseError& error) {
        fmt::print(stderr, "kelvo: {}\n", error.what());
        return 1;
    }
}

void describeApplicationOptions(const std::function<void(const CLI::App&)>& reader) { reader(CommandLine().app); }

}  // namespace kelvo
