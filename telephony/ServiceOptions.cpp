#include "telephony/ServiceOptions.h"

#include <fmt/format.h>

#include <CLI/CLI.hpp>
#include <cmath>
#include <cstdio>

#include "platform/encodings/WholeNumber.h"

namespace kelvo {
namespace {

constexpr double kFastest = 1e6;

// "max", or how many times faster.
std::string checkSpeed(const std::string& text) {
    double speed = 0;
    if (text == "max" || (CLI::detail::lexical_cast(text, speed) && speed > 0 && speed <= kFastest)) return {};
    return fmt::format("{} is neither \"max\" nor a number above 0 and up to {:.0f}", text, kFastest);
}

std::string checkTechnology(const std::string& word) {
    if (technologyBy(&TechnologyNames::word, std::string_view(word))) return {};
    return fmt::format("{} is none of ifx, gsm, cdma, lte, utran", word);
}

PacedSource::Speed speedOf(const std::string& text) {
    return text == "max" ? std::nullopt : std::optional(std::stod(text));
}

std::uint64_t seedOf(const std::string& text) {
    const auto seed = wholeNumber(text);
    if (!seed) throw CLI::ValidationError("--seed", seed.error().reason);
    return *seed;
}

}  // namespace

ParsedOptions parseServiceOptions(int argc, const char* const* argv) {
    ServiceOptions options;
    std::string word;
    std::string speed = "1";
    CLI::App app("Telephony service: gives Kelvo the log of a baseband modem, replayed from a capture or simulated.",
                 "kelvo-telephonyd");
    app.footer(
        "A capture is a pcap file whose link type names the technology: 147 IFX, 148 GSM/UMTS, 149 CDMA, 150 LTE,\n"
        "151 UTRAN. The replay starts with the first client and keeps the time between packets; pauses of more than\n"
        "five seconds last five. After the last packet, or where the file breaks off, the service stays, and its "
        "status\n"
        "says so; SIGINT or SIGTERM ends it.\n"
        "A recording appears with its first record.\n"
        "A simulated modem drives through a town without end; the same seed drives the same way, byte for byte.\n"
        "The service logs to standard error in a terminal and to the system log otherwise.");
    auto* source = app.add_option_group("source", "Where the records come from; one of them");
    auto* replay = source->add_option("--replay", options.replay, "The capture to replay")->type_name("FILE");
    auto* simulate = source->add_option("--simulate", word, "The modem to simulate")
                         ->type_name("ifx|gsm|cdma|lte|utran")
                         ->check(checkTechnology);
    auto* status = source->add_flag("--status", options.status,
                                    "Tell what the service that runs is doing, and end: its source, records per\n"
                                    "second by log code, clients and the records they were too slow for");
    source->require_option(1);
    auto* loop = app.add_flag("--loop", options.loop, "Start the capture again after its last packet");
    auto* seed = app.add_option_function<std::string>(
                        "--seed", [&options](const std::string& text) { options.seed = seedOf(text); },
                        "Which drive to simulate")
                     ->type_name("N")
                     ->default_str(std::to_string(options.seed));
    auto* pace = app.add_option("--speed", speed,
                                "So many times faster than it was, or \"max\": as fast as the quickest client reads")
                     ->type_name("X|max")
                     ->check(checkSpeed)
                     ->capture_default_str();
    auto* record =
        app.add_option("--record", options.record, "Write every record that a client takes to this capture as well")
            ->type_name("FILE");
    auto* force = app.add_flag("--force", options.force, "Let the recording replace a file that is there already");
    app.set_version_flag("--version", "kelvo-telephonyd " KELVO_VERSION);
    loop->needs(replay);
    seed->needs(simulate);
    force->needs(record);
    for (auto* option : {pace, record}) option->excludes(status);
    try {
        app.parse(argc, argv);
    } catch (const CLI::CallForHelp&) {
        fmt::print("{}", app.help());
        return {std::nullopt, 0};
    } catch (const CLI::CallForVersion& version) {
        fmt::print("{}\n", version.what());
        return {std::nullopt, 0};
    } catch (const CLI::ParseError& error) {
        fmt::print(stderr, "kelvo-telephonyd: {}\n", error.what());
        return {std::nullopt, 1};
    }
    if (simulate->count() > 0) options.simulate = *technologyBy(&TechnologyNames::word, std::string_view(word));
    options.speed = speedOf(speed);
    return {options, 0};
}

}  // namespace kelvo
