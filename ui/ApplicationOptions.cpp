#include "ui/ApplicationOptions.h"

#include <fmt/format.h>

#include <CLI/CLI.hpp>
#include <cstdio>

#include "platform/version/Version.h"

namespace kelvo {
namespace {

constexpr const char* kFooter =
    "Without a file, what it shows comes from the telephony service, kelvo-telephonyd, and a second start brings the\n"
    "window of the first to the front. A snapshot has a window of its own, which shows the screens as they were\n"
    "saved. What a file is, its content tells. In a terminal, \"kelvoctl watch\" and \"kelvoctl snapshot\" show the\n"
    "same.\n\n"
    "Examples:\n"
    "  kelvo\n"
    "  kelvo drive.pcap\n"
    "  kelvo drive.kelvo\n";

struct CommandLine {
    CommandLine() {
        app.footer(kFooter);
        app.add_option("FILE", options.file,
                       "A capture to replay, in a loop, or a saved snapshot to read, instead of the service's log");
        app.set_version_flag("--version", versionLine("kelvo"));
    }
    ApplicationOptions options;
    CLI::App app{"Shows what a phone's baseband modem reports right now, as screens.", "kelvo"};
};

}  // namespace

ParsedApplicationOptions parseApplicationOptions(int argc, const char* const* argv) {
    CommandLine line;
    try {
        line.app.parse(argc, argv);
        return {line.options, 0};
    } catch (const CLI::CallForHelp&) {
        fmt::print("{}", line.app.help());
        return {std::nullopt, 0};
    } catch (const CLI::CallForVersion& version) {
        fmt::print("{}\n", version.what());
        return {std::nullopt, 0};
    } catch (const CLI::ParseError& error) {
        fmt::print(stderr, "kelvo: {}\n", error.what());
        return {std::nullopt, 1};
    }
}

void describeApplicationOptions(const std::function<void(const CLI::App&)>& reader) { reader(CommandLine().app); }

}  // namespace kelvo
