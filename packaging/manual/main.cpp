#include <fmt/format.h>

#include <CLI/App.hpp>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <set>
#include <sstream>

#include "glossary/Glossary.h"
#include "packaging/manual/Completion.h"
#include "packaging/manual/ManPage.h"
#include "telephony/ServiceOptions.h"
#include "telephony/wire/modem/Faults.h"
#include "telephony/wire/modem/ModemOptions.h"
#include "tools/Kelvoctl.h"
#include "ui/ApplicationOptions.h"

namespace {

using namespace kelvo;
using namespace kelvo::manual;
namespace fs = std::filesystem;

void writeFile(const fs::path& path, const std::string& text) {
    fs::create_directories(path.parent_path());
    std::ofstream file(path);
    file << text;
    file.close();
    if (!file) throw std::runtime_error(path.string() + " cannot be written");
}

std::string contentsOf(const fs::path& path) {
    std::ifstream file(path);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

std::vector<Description> programs() {
    std::vector<Description> programs;
    const auto add = [&programs](const CLI::App& app) { programs.push_back(describe(app)); };
    describeApplicationOptions(add);
    describeServiceOptions(add);
    modem::describeModemOptions(add);
    add(*makeKelvoctl());
    return programs;
}

KnownValues knownValues() {
    std::set<std::string> keys;
    for (const TechnologyNames& names : kTechnologies) {
        for (const Meaning& meaning : meaningsOf(names.technology)) keys.emplace(meaning.key);
    }
    KnownValues known{{keys.begin(), keys.end()}, {}};
    for (const modem::FaultEntry& fault : modem::allFaults()) known.faults.emplace_back(fault.name);
    return known;
}

void writeManPages(const Description& description, const fs::path& handWritten, const fs::path& out) {
    const std::string name = pageName(description);
    writeFile(out / "man" / (name + ".1"), manPage(description, contentsOf(handWritten / (name + ".roff"))));
    for (const Description& command : description.commands) writeManPages(command, handWritten, out);
}

}  // namespace

/// Writes manual pages and completions: kelvo-manual HAND-WRITTEN-SECTIONS OUTPUT.
int main(int argc, char** argv) {
    if (argc != 3) return EXIT_FAILURE;
    const fs::path out = argv[2];
    try {
        const KnownValues known = knownValues();
        for (const Description& program : programs()) {
            writeManPages(program, argv[1], out);
            writeFile(out / "bash" / program.name, bashCompletion(program, known));
            writeFile(out / "zsh" / ("_" + program.name), zshCompletion(program, known));
            writeFile(out / "fish" / (program.name + ".fish"), fishCompletion(program, known));
        }
    } catch (const std::exception& failure) {
        fmt::print(stderr, "kelvo-manual: {}\n", failure.what());
        return EXIT_FAILURE;
    }
    return EXIT_SUCCESS;
}
