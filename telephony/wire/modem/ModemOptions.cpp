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

}  // namespace

ParsedModemOptions parseModemOptions(int argc, const char* const* argv) {
    ModemOptions options;
    std::string word;
    std::string year;
    std::string faults;
    CLI::App app("Plays a modem, simulated or recorded, behind the diagnostic protocol of a real one.", "kelvo-modem");
    app.footer(footer());
    auto* source = app.add_option_group("source", "What the modem is; one of them");
    auto* simulate = source->add_option("--simulate", word, "A modem that drives through a town without end")
                         ->type_name("gsm|cdma|lte|utran")
                         ->check(checkTechnology);
    source
        ->add_option("--replay", options.replay,
                     "The records of a capture (pcap), or of the frames that a diagnostic port sent\n"
                     "(a file called *.frames)")
        ->type_name("FILE");
    source->require_option(1);
    auto* generation = app.add_option("--generation", year,
                                      "The year of the simulated modem: newer ones word an LTE or GSM/UMTS drive in\n"
                                      "newer layouts; otherwise 2010")
                           ->type_name("2010|2014|2018")
                           ->needs(simulate);
    app.add_option("--on", options.on,
                   "A link to make to the pseudo-terminal, or a socket to listen on instead: tcp:PORT on this\n"
                   "machine, unix:PATH")
        ->type_name("LINK|tcp:PORT|unix:PATH")
        ->check(checkPlace);
    app.add_option("--faults", faults, "In what ways it misbehaves; see below")->type_name("LIST")->check(checkFaults);
    app.add_option("--seed", options.seed, "Which drive to simulate, and which faults to make")
        ->type_name("N")
        ->check(CLI::NonNegativeNumber)
        ->capture_default_str();
    app.set_version_flag("--version", versionLine("kelvo-modem"));
    try {
        app.parse(argc, argv);
        if (simulate->count() > 0) options.simulate = *technologyBy(&TechnologyNames::word, std::string_view(word));
        if (generation->count() > 0) options.generation = generationOf(options.simulate, year);
    } catch (const CLI::CallForHelp&) {
        fmt::print("{}", app.help());
        return {std::nullopt, 0};
    } catch (const CLI::CallForVersion& version) {
        fmt::print("{}\n", version.what());
        return {std::nullopt, 0};
    } catch (const CLI::ParseError& error) {
        fmt::print(stderr, "kelvo-modem: {}\n", error.what());
        return {std::nullopt, 1};
    }
    options.faults = *Faults::parse(faults);
    return {options, 0};
}

}  // namespace kelvo::modem
