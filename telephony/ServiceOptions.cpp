#include "telephony/ServiceOptions.h"

#include <fmt/format.h>

#include <CLI/CLI.hpp>
#include <cmath>
#include <cstdio>

namespace kelvo {
namespace {

constexpr double kFastest = 1e6;

// "max", or how many times faster.
std::string checkSpeed(const std::string& text) {
    double speed = 0;
    if (text == "max" || (CLI::detail::lexical_cast(text, speed) && speed > 0 && speed <= kFastest)) return {};
    return fmt::format("{} is neither \"max\" nor a number above 0 and up to {:.0f}", text, kFastest);
}

std::optional<double> speedOf(const std::string& text) {
    return text == "max" ? std::nullopt : std::optional(std::stod(text));
}

}  // namespace

ParsedOptions parseServiceOptions(int argc, const char* const* argv) {
    ServiceOptions options;
    std::string file;
    std::string speed = "1";
    CLI::App app("Telephony service: gives Kelvo the log of a baseband modem, replayed from a capture.",
                 "kelvo-telephonyd");
    app.footer(
        "A capture is a pcap file whose link type names the technology: 147 IFX, 148 GSM/UMTS, 149 CDMA, 150 LTE,\n"
        "151 UTRAN. The replay starts with the first client and keeps the time between packets, long pauses included.\n"
        "After the last packet the service stays; SIGINT or SIGTERM ends it. It logs to standard error in a terminal\n"
        "and to the system log otherwise.");
    app.add_option("--replay", file, "The capture to replay")->required()->type_name("FILE");
    app.add_flag("--loop", options.replayOptions.loop, "Start again after the last packet");
    app.add_option("--speed", speed,
                   "So many times faster than it was, or \"max\": as fast as the quickest client reads")
        ->type_name("X|max")
        ->check(checkSpeed)
        ->capture_default_str();
    try {
        app.parse(argc, argv);
    } catch (const CLI::CallForHelp&) {
        fmt::print("{}", app.help());
        return {std::nullopt, 0};
    } catch (const CLI::ParseError& error) {
        fmt::print(stderr, "kelvo-telephonyd: {}\n", error.what());
        return {std::nullopt, 1};
    }
    options.replay = file;
    options.replayOptions.speed = speedOf(speed);
    return {options, 0};
}

}  // namespace kelvo
