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

// "auto" is none: listen to the modem.
std::string checkPortTechnology(const std::string& word) {
    if (word == "auto") return {};
    if (word == "ifx") return "ifx is not to be had at a port";
    if (technologyBy(&TechnologyNames::word, std::string_view(word))) return {};
    return fmt::format("{} is none of gsm, cdma, lte, utran, auto", word);
}

PortAddress portOf(const std::string& text, bool remote) {
    auto address = PortAddress::parse(text, remote);
    if (!address) throw CLI::ValidationError("--port", address.error().reason);
    return std::move(address).value();
}

simulation::Generation generationOf(Technology technology, const std::string& year) {
    const auto generation = simulation::generationOf(technology, year);
    if (!generation) throw CLI::ValidationError("--generation", generation.error().reason);
    return *generation;
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
    std::string year;
    std::string speed = "1";
    std::string port;
    std::string portTechnology = "auto";
    bool remote = false;
    CLI::App app(
        "Telephony service: gives Kelvo the log of a baseband modem: a real one, simulated, or replayed from a "
        "capture.",
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
    auto* modem = source
                      ->add_option("--port", port,
                                   "A modem's diagnostic port: the node of one that is plugged in, a serial node or\n"
                                   "device, or the socket that a router on the phone offers")
                      ->type_name("auto|PATH|tcp:HOST:PORT|unix:PATH");
    source->require_option(1);
    auto* loop = app.add_flag("--loop", options.loop, "Start the capture again after its last packet");
    auto* seed = app.add_option_function<std::string>(
                        "--seed", [&options](const std::string& text) { options.seed = seedOf(text); },
                        "Which drive to simulate")
                     ->type_name("N")
                     ->default_str(std::to_string(options.seed));
    auto* generation = app.add_option("--generation", year,
                                      "The year of the simulated modem: newer ones word an LTE or GSM/UMTS drive in\n"
                                      "newer layouts; otherwise 2010")
                           ->type_name("2010|2014|2018");
    auto* pace = app.add_option("--speed", speed,
                                "So many times faster than it was, or \"max\": as fast as the quickest client reads")
                     ->type_name("X|max")
                     ->check(checkSpeed)
                     ->capture_default_str();
    auto* record =
        app.add_option("--record", options.record, "Write every record that a client takes to this capture as well")
            ->type_name("FILE");
    auto* recordFrames =
        app.add_option("--record-frames", options.recordFrames, "Write what the port gives to this file, as it comes")
            ->type_name("FILE");
    auto* technology = app.add_option("--technology", portTechnology,
                                      "What the clients are shown of the modem; auto listens to what it is camped on")
                           ->type_name("gsm|cdma|lte|utran|auto")
                           ->check(checkPortTechnology)
                           ->capture_default_str();
    auto* subscription = app.add_option("--subscription", options.session.subscription,
                                        "Which SIM is shown, from 1; otherwise the first that sends")
                             ->type_name("N")
                             ->check(CLI::Range(1, 255));
    auto* allowRemote =
        app.add_flag("--allow-remote", remote, "Let tcp: lead to other machines: whoever is in between is trusted");
    auto* noLines = app.add_flag(
        "--no-dtr-rts", [&options](std::int64_t) { options.line.controlLines = false; },
        "Leave a serial port's lines DTR and RTS off");
    auto* json = app.add_flag("--json", options.json, "The status as one JSON object");
    app.add_flag("--force", options.force, "Let a recording replace a file that is there already");
    app.set_version_flag("--version", "kelvo-telephonyd " KELVO_VERSION);
    loop->needs(replay);
    seed->needs(simulate);
    generation->needs(simulate);
    json->needs(status);
    for (auto* option : {technology, subscription, allowRemote, noLines, recordFrames}) option->needs(modem);
    pace->excludes(modem);
    for (auto* option : {pace, record}) option->excludes(status);
    try {
        app.parse(argc, argv);
        if (options.force && options.record.empty() && options.recordFrames.empty())
            throw CLI::RequiresError("--force", "--record or --record-frames");
        if (modem->count() > 0) options.port = portOf(port, remote);
        if (simulate->count() > 0) options.simulate = *technologyBy(&TechnologyNames::word, std::string_view(word));
        if (generation->count() > 0) options.generation = generationOf(options.simulate, year);
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
    options.session.technology = technologyBy(&TechnologyNames::word, std::string_view(portTechnology));
    options.speed = speedOf(speed);
    return {options, 0};
}

}  // namespace kelvo
