#include "telephony/ServiceOptions.h"

#include <fmt/format.h>

#include <CLI/CLI.hpp>
#include <algorithm>
#include <array>
#include <cmath>
#include <cstdio>

#include "platform/encodings/WholeNumber.h"
#include "platform/version/Version.h"

namespace kelvo {
namespace {

constexpr double kFastest = 1e6;
constexpr std::uint64_t kMostSims = 255;

constexpr const char* kFooter =
    "A capture is a pcap file whose link type names the technology: 147 IFX, 148 GSM/UMTS, 149 CDMA, 150 LTE,\n"
    "151 UTRAN. The replay starts with the first client and keeps the time between packets; pauses of more than\n"
    "five seconds last five. After the last packet, or where the file breaks off, the service stays, and its status\n"
    "says so; SIGINT or SIGTERM ends it.\n"
    "A recording appears with its first record.\n"
    "Without a source it starts as telephonyd.conf says, in the user's configuration directory (~/.config/kelvo) or "
    "else\n"
    "in /etc/kelvo: the names of these options, a line each, such as port = \"auto\" and allow-remote = true. What "
    "stands\n"
    "on the command line goes before it.\n"
    "A simulated modem drives through a town without end; the same seed drives the same way, byte for byte.\n"
    "A modem at a port is asked for what the clients want while there are any; one that goes is waited for.\n"
    "The service logs to standard error in a terminal and to the system log otherwise.";

// "max", or how many times faster.
std::string checkSpeed(const std::string& text) {
    double speed = 0;
    if (text == "max" || (CLI::detail::lexical_cast(text, speed) && speed > 0 && speed <= kFastest)) return {};
    return fmt::format("{} is neither \"max\" nor a number above 0 and up to {:.0f}", text, kFastest);
}

PacedSource::Speed speedOf(const std::string& text) {
    return text == "max" ? std::nullopt : std::optional(std::stod(text));
}

std::string checkTechnology(const std::string& word) {
    if (technologyBy(&TechnologyNames::word, std::string_view(word))) return {};
    return fmt::format("{} is none of ifx, gsm, cdma, lte, utran", word);
}

// "auto" is none: listen to the modem.
std::string checkPortTechnology(const std::string& word) {
    if (word == "auto") return {};
    if (word == "ifx") return "ifx is not to be had at a port";
    if (technologyBy(&TechnologyNames::word, std::string_view(word))) return {};
    return fmt::format("{} is none of gsm, cdma, lte, utran, auto", word);
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

std::int32_t subscriptionOf(const std::string& text) {
    const auto number = wholeNumber(text);
    if (!number || *number == 0 || *number > kMostSims)
        throw CLI::ValidationError("--subscription", fmt::format("{} is no number from 1 to {}", text, kMostSims));
    return static_cast<std::int32_t>(*number);
}

PortAddress portOf(const std::string& text, bool remote) {
    auto address = PortAddress::parse(text, remote);
    if (!address) throw CLI::ValidationError("--port", address.error().reason);
    return std::move(address).value();
}

/// The command line: each kind of option is added by its own operation, and what the words stand for is settled once
/// all have been read.
class CommandLine {
public:
    CommandLine() {
        _app.footer(kFooter);
        addSources();
        addReplayAndSimulation();
        addRecordings();
        addPort();
        addConfiguration();
        addStatus();
    }

    /// Throws what CLI11 throws, and CLI::Success when it has checked the configuration.
    ServiceOptions read(std::vector<std::string> arguments, const ConfigPlaces& places) {
        const bool namesSource =
            std::ranges::any_of(kSources, [&](const char* source) { return isGiven(arguments, source); });
        const bool isAsked =
            std::ranges::any_of(kQuestions, [&](const char* question) { return isGiven(arguments, question); });
        if (!namesSource && !isAsked) return readConfigured(arguments, places);
        if (namesSource && (isGiven(arguments, "--config") || isGiven(arguments, "--check-config")))
            throw CLI::ConfigError("a configuration is read where the command line names no source");
        parse(arguments);
        return _options;
    }
    const CLI::App& app() const { return _app; }

private:
    static constexpr std::array kSources = {"--replay", "--simulate", "--port", "--modemmanager", "--status"};
    static constexpr std::array kQuestions = {"--help", "-h", "--version"};

    void parse(std::vector<std::string> arguments) {
        std::ranges::reverse(arguments);  // as CLI11 takes them
        _app.parse(std::move(arguments));
        settle();
    }
    ServiceOptions readConfigured(const std::vector<std::string>& arguments, const ConfigPlaces& places) {
        const auto file = configurationOf(arguments, places);
        const auto configured = readServiceConfig(file, _app);
        if (!configured) throw CLI::ConfigError(fmt::format("{}: {}", file.native(), configured.error().reason));
        std::vector<std::string> all = arguments;
        for (const std::string& one : *configured) {
            if (!isGiven(arguments, one.substr(0, one.find('=')))) all.push_back(one);
        }
        const bool namesSource =
            std::ranges::any_of(kSources, [&](const char* source) { return isGiven(all, source); });
        if (!namesSource)
            throw CLI::ConfigError(file.native() + ": it names no source: replay, simulate, port or modemmanager");
        try {
            parse(all);
        } catch (const CLI::ParseError& error) {
            throw CLI::ConfigError(fmt::format("{}: {}", file.native(), error.what()));
        }
        if (_checkOnly) throw CLI::Success(file.native() + " is in order", CLI::ExitCodes::Success);
        return _options;
    }
    /// The file that is named, or the one that is there.
    static std::filesystem::path configurationOf(const std::vector<std::string>& arguments,
                                                 const ConfigPlaces& places) {
        for (std::size_t at = 0; at < arguments.size(); ++at) {
            if (arguments[at].starts_with("--config=")) return arguments[at].substr(arguments[at].find('=') + 1);
            if (arguments[at] == "--config" && at + 1 < arguments.size()) return arguments[at + 1];
        }
        if (auto file = places.existing()) return *file;
        throw CLI::ConfigError(fmt::format("it needs a source (--help tells which), or a configuration: {} or {}",
                                           places.user.native(), places.system.native()));
    }
    void addSources() {
        auto* const source =
            _app.add_option_group("source", "Where the records come from: one of them, or --port and --modemmanager");
        _replay = source->add_option("--replay", _options.replay, "The capture to replay")->type_name("FILE");
        _simulate = source->add_option("--simulate", _simulated, "The modem to simulate")
                        ->type_name("ifx|gsm|cdma|lte|utran")
                        ->check(checkTechnology);
        _status = source->add_flag("--status", _options.status,
                                   "Tell what the service that runs is doing, and end: its source, records per\n"
                                   "second by log code, clients and the records they were too slow for");
        _port = source
                    ->add_option("--port", _portName,
                                 "A modem's diagnostic port: the node of one that is plugged in, a serial node or\n"
                                 "device, or the socket that a router on the phone offers")
                    ->type_name("auto|PATH|tcp:HOST:PORT|unix:PATH");
        _manager = source
                       ->add_option("--modemmanager", _managedModem,
                                    "What ModemManager knows of the phone: SIM, cells, data contexts, levels; alone, "
                                    "or beside\n--port, which then measures. MODEM is an index, a path or an equipment "
                                    "identity; the\nfirst without")
                       ->type_name("[MODEM]")
                       ->expected(0, 1);
        for (auto* one : {_replay, _simulate, _status, _port}) {
            for (auto* other : {_replay, _simulate, _status, _port}) {
                if (one != other) one->excludes(other);
            }
            if (one != _port) _manager->excludes(one);
        }
    }
    void addReplayAndSimulation() {
        _app.add_flag("--loop", _options.loop, "Start the capture again after its last packet")->needs(_replay);
        const auto seed = [this](const std::string& text) { _options.seed = seedOf(text); };
        _app.add_option_function<std::string>("--seed", seed, "Which drive to simulate")
            ->type_name("N")
            ->default_str(std::to_string(_options.seed))
            ->needs(_simulate);
        _generation = _app.add_option("--generation", _year,
                                      "The year of the simulated modem: newer ones word an LTE or GSM/UMTS drive in\n"
                                      "newer layouts; otherwise 2010")
                          ->type_name("2010|2014|2018")
                          ->needs(_simulate);
        _app.add_option("--speed", _speed,
                        "So many times faster than it was, or \"max\": as fast as the quickest client reads")
            ->type_name("X|max")
            ->check(checkSpeed)
            ->capture_default_str()
            ->excludes(_port)
            ->excludes(_manager)
            ->excludes(_status);
    }
    void addRecordings() {
        _app.add_option("--record", _options.record, "Write every record that a client takes to this capture as well")
            ->type_name("FILE")
            ->excludes(_status);
        _app.add_option("--record-frames", _options.recordFrames, "Write what the port gives to this file, as it comes")
            ->type_name("FILE")
            ->needs(_port);
        _app.add_flag("--force", _options.force, "Let a recording replace a file that is there already");
    }
    void addPort() {
        _app.add_option("--technology", _portTechnology,
                        "What the clients are shown of the modem; auto listens to what it is camped on")
            ->type_name("gsm|cdma|lte|utran|auto")
            ->check(checkPortTechnology)
            ->capture_default_str()
            ->needs(_port);
        const auto subscription = [this](const std::string& text) {
            _options.session.subscription = subscriptionOf(text);
        };
        _app.add_option_function<std::string>("--subscription", subscription,
                                              "Which SIM is shown, from 1; otherwise the first that sends")
            ->type_name("N")
            ->needs(_port);
        _app.add_flag("--allow-remote", _remote, "Let tcp: lead to other machines: whoever is in between is trusted")
            ->needs(_port);
        _app.add_flag("--no-dtr-rts", _noControlLines, "Leave a serial port's lines DTR and RTS off")->needs(_port);
    }
    void addConfiguration() {
        _app.add_option("--config", _configuration, "Start as this file says, and as no other does")->type_name("FILE");
        _app.add_flag("--check-config", _checkOnly, "Tell whether the configuration is in order, and end");
    }
    void addStatus() {
        _app.add_flag("--json", _options.json, "The status as one JSON object")->needs(_status);
        _app.set_version_flag("--version", versionLine("kelvo-telephonyd"));
    }

    void settle() {
        const std::array sources = {_replay, _simulate, _status, _port, _manager};
        if (std::ranges::all_of(sources, [](const CLI::Option* source) { return source->count() == 0; }))
            throw CLI::RequiredError("One of --replay, --simulate, --status, --port and --modemmanager");
        const bool records = !_options.record.empty() || !_options.recordFrames.empty();
        if (_options.force && !records) throw CLI::RequiresError("--force", "--record or --record-frames");
        if (records && _options.record == _options.recordFrames)
            throw CLI::ValidationError("--record", "its file is that of --record-frames");
        if (_port->count() > 0) _options.port = portOf(_portName, _remote);
        if (_manager->count() > 0) _options.modemManager = _managedModem;
        if (_simulate->count() > 0)
            _options.simulate = *technologyBy(&TechnologyNames::word, std::string_view(_simulated));
        if (_generation->count() > 0) _options.generation = generationOf(_options.simulate, _year);
        _options.session.technology = technologyBy(&TechnologyNames::word, std::string_view(_portTechnology));
        _options.line.controlLines = !_noControlLines;
        _options.speed = speedOf(_speed);
    }

    ServiceOptions _options;
    std::string _simulated;
    std::string _year;
    std::string _speed = "1";
    std::string _portName;
    std::string _managedModem;
    std::string _portTechnology = "auto";
    std::string _configuration;
    bool _remote = false;
    bool _noControlLines = false;
    bool _checkOnly = false;
    CLI::App _app{
        "Telephony service: gives Kelvo the log of a baseband modem: a real one, simulated, or replayed from a "
        "capture.",
        "kelvo-telephonyd"};
    CLI::Option* _replay = nullptr;
    CLI::Option* _simulate = nullptr;
    CLI::Option* _generation = nullptr;
    CLI::Option* _status = nullptr;
    CLI::Option* _port = nullptr;
    CLI::Option* _manager = nullptr;
};

}  // namespace

ParsedOptions parseServiceOptions(int argc, const char* const* argv, const ConfigPlaces& places) {
    CommandLine line;
    try {
        return {line.read({argv + 1, argv + argc}, places), 0};
    } catch (const CLI::CallForHelp&) {
        fmt::print("{}", line.app().help());
        return {std::nullopt, 0};
    } catch (const CLI::CallForVersion& version) {
        fmt::print("{}\n", version.what());
        return {std::nullopt, 0};
    } catch (const CLI::Success& checked) {
        fmt::print("{}\n", checked.what());
        return {std::nullopt, 0};
    } catch (const CLI::ParseError& error) {
        fmt::print(stderr, "kelvo-telephonyd: {}\n", error.what());
        return {std::nullopt, 1};
    }
}

void describeServiceOptions(const std::function<void(const CLI::App&)>& reader) { reader(CommandLine().app()); }

}  // namespace kelvo
