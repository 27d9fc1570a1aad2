#include "telephony/wire/modem/ModemOptions.h"

#include <fmt/format.h>

#include <CLI/CLI.hpp>
#include <cstdio>

#include "platform/version/Version.h"

namespace kelvo::modem {
namespace {

std::string checkTechnology(const std::string& word) {
    const auto technology = technologyBy(&TechnologyNames::word, std::string_view(word));
    if (technology && technology != Technology::IFX) return {};
    return fmt::format("{} is none of gsm, cdma, lte, utran", word);
}

std::string checkFaults(const std::string& list) {
    const auto faults = Faults::parse(list);
    return faults ? std::string() : faults.error().reason + " (kelvo-modem --help lists them)";
}

std::string checkPlace(const std::string& place) {
    if (!place.starts_with("tcp:")) return place == "unix:" ? "unix: lacks its path" : "";
    std::uint16_t port = 0;
    const std::string number = place.substr(4);
    if (CLI::detail::lexical_cast(number, port)) return {};
    return fmt::format("tcp:{} is no TCP port: there are 0 (any that is free) to 65535", number);
}

simulation::Generation generationOf(Technology technology, const std::string& year) {
    const auto generation = simulation::generationOf(technology, year);
    if (!generation) throw CLI::ValidationError("--generation", generation.error().reason);
    return *generation;
}

std::string footer() {
    std::string text =
        "The modem prints where it is: the path of its pseudo-terminal (or the link to it), tcp:127.0.0.1:PORT or\n"
        "unix:PATH, which is what kelvo-telephonyd --port takes. It answers like a modem, and sends the records that "
        "it\n"
        "is asked for in their time; a drive begins when they are asked for first. SIGUSR1 pulls its plug, and puts "
        "it\n"
        "back; SIGINT or SIGTERM ends it, and it tells what it has sent.\n\n"
        "Faults, of which a list has several with commas between them; the same seed makes the same ones:\n";
    for (const FaultEntry& fault : allFaults()) text += fmt::format("  {:<18}{}\n", fault.name, fault.what);
    text +=
        "\nExamples:\n"
        "  kelvo-modem --simulate lte --on /tmp/modem\n"
        "  kelvo-modem --simulate lte --generation 2018 --on /tmp/modem\n"
        "  kelvo-modem --replay drive.pcap --on tcp:5555 --faults noise,flipped-bits --seed 7\n";
    return text;
}

/// The command line, and the words that are settled once all have been read.
class CommandLine {
public:
    CommandLine() {
        _app.footer(footer());
        auto* source = _app.add_option_group("source", "What the modem is; one of them");
        _simulate = source->add_option("--simulate", _word, "A modem that drives through a town without end")
                        ->type_name("gsm|cdma|lte|utran")
                        ->check(checkTechnology);
        source
            ->add_option("--replay", _options.replay,
                         "The records of a capture (pcap), or of the frames that a diagnostic port sent\n"
                         "(a file called *.frames)")
            ->type_name("FILE");
        source->require_option(1);
        _generation = _app.add_option("--generation", _year,
                                      "The year of the simulated modem: newer ones word an LTE or GSM/UMTS drive in\n"
                                      "newer layouts; otherwise 2010")
                          ->type_name("2010|2014|2018")
                          ->needs(_simulate);
        _app.add_option("--on", _options.on,
                        "A link to make to the pseudo-terminal, or a socket to listen on instead: tcp:PORT on this\n"
                        "machine, unix:PATH")
            ->type_name("LINK|tcp:PORT|unix:PATH")
            ->check(checkPlace);
        _app.add_option("--faults", _faults, "In what ways it misbehaves; see below")
            ->type_name("LIST")
            ->check(checkFaults);
        _app.add_option("--seed", _options.seed, "Which drive to simulate, and which faults to make")
            ->type_name("N")
            ->check(CLI::NonNegativeNumber)
            ->capture_default_str();
        _app.set_version_flag("--version", versionLine("kelvo-modem"));
    }

    /// Throws what CLI11 throws.
    ModemOptions read(int argc, const char* const* argv) {
        _app.parse(argc, argv);
        if (_simulate->count() > 0) _options.simulate = *technologyBy(&TechnologyNames::word, std::string_view(_word));
        if (_generation->count() > 0) _options.generation = generationOf(_options.simulate, _year);
        _options.faults = *Faults::parse(_faults);
        return _options;
    }
    const CLI::App& app() const { return _app; }

private:
    ModemOptions _options;
    std::string _word;
    std::string _year;
    std::string _faults;
    CLI::App _app{"Plays a modem, simulated or recorded, behind the diagnostic protocol of a real one.", "kelvo-modem"};
    CLI::Option* _simulate = nullptr;
    CLI::Option* _generation = nullptr;
};

}  // namespace

ParsedModemOptions parseModemOptions(int argc, const char* const* argv) {
    CommandLine line;
    try {
        return {line.read(argc, argv), 0};
    } catch (const CLI::CallForHelp&) {
        fmt::print("{}", line.app().help());
        return {std::nullopt, 0};
    } catch (const CLI::CallForVersion& version) {
        fmt::print("{}\n", version.what());
        return {std::nullopt, 0};
    } catch (const CLI::ParseError& error) {
        fmt::print(stderr, "kelvo-modem: {}\n", error.what());
        return {std::nullopt, 1};
    }
}

void describeModemOptions(const std::function<void(const CLI::App&)>& reader) { reader(CommandLine().app()); }

}  // namespace kelvo::modem
