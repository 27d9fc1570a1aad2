#include "tools/SnapshotCommand.h"

#include <fmt/format.h>

#include <cstdio>
#include <memory>
#include <utility>

#include "platform/system/OutputFile.h"
#include "tools/Command.h"
#include "tools/CommandFailure.h"
#include "tools/DisplayJson.h"
#include "tools/DisplayText.h"
#include "tools/NumberOption.h"
#include "tools/ReadSnapshot.h"
#include "tools/SnapshotCapture.h"
#include "tools/StandardOutput.h"
#include "tools/TechnologyOption.h"

namespace kelvo {

namespace {

struct Options {
    std::string file;
    std::optional<std::uint64_t> entry;  ///< from 1
    std::optional<std::string> dlf;
    std::optional<std::string> capture;
    std::optional<Technology> technology;
    bool json = false;
    bool force = false;
};

OutputTerms outputTerms(const Options& options) { return {options.force, {options.file}}; }

std::string sizeText(const SnapshotFile::Entry& entry) {
    const Bytes* data = entry.dlf ? entry.dlf.data() : entry.displayState.data();
    if (data != nullptr) return fmt::format("{} bytes", data->size());
    return entry.displayState ? fmt::format("a {}", kindName(entry.displayState.kind())) : "nothing";
}

std::string entryLine(const SnapshotFile::Entry& entry, std::size_t number) {
    return fmt::format("{:>3}  {:<25}  {:>12}  {}\n", number, printable(entry.date.value_or("-")), sizeText(entry),
                       printable(entry.description.value_or("-")));
}

std::string listing(const SnapshotFile& snapshot) {
    std::string text =
        fmt::format("Timestamp    {}\nDescription  {}\nEntries      {}\n", printable(snapshot.timestamp.value_or("-")),
                    printable(snapshot.description.value_or("-")), snapshot.entries.size());
    for (std::size_t i = 0; i < snapshot.entries.size(); ++i) text += entryLine(snapshot.entries[i], i + 1);
    return text;
}

std::string entryDisplay(const SnapshotFile& snapshot, const Options& options) {
    const std::uint64_t number = *options.entry;
    if (number > snapshot.entries.size()) {
        throw CommandFailure(
            fmt::format("{} has {} entries, and no entry {}", options.file, snapshot.entries.size(), number));
    }
    const Value& display = snapshot.entries[number - 1].display;
    if (!display) throw CommandFailure(fmt::format("entry {} of {} holds no display", number, options.file));
    return options.json ? printedJson(jsonFrom(display)) : displayText(display);
}

std::string extractDlf(const SnapshotFile& snapshot, const Options& options) {
    for (const SnapshotFile::Entry& entry : snapshot.entries) {
        const Bytes* dlf = entry.dlf.data();
        if (dlf == nullptr) continue;
        orFail(writeFile(*options.dlf, *dlf, outputTerms(options)));
        return fmt::format("{} bytes written to {}\n", dlf->size(), *options.dlf);
    }
    throw CommandFailure(options.file + " holds no DLF");
}

void tellOdd(const std::string& file, const std::vector<std::string>& odd) {
    if (odd.empty()) return;
    const std::string more = odd.size() > 1 ? fmt::format(", and {} more things are odd", odd.size() - 1) : "";
    fmt::print(stderr, "kelvoctl: {}: {}{}\n", printable(file), printable(odd.front()), more);
}

void showSnapshot(const Options& options) {
    SnapshotFile snapshot = orFail(readSnapshot(options.file));
    std::string text;
    if (options.entry) text += entryDisplay(snapshot, options);
    if (options.dlf) text += extractDlf(snapshot, options);
    if (options.capture) {
        OutputFile file = orFail(OutputFile::create(*options.capture, outputTerms(options)));
        const std::size_t messages = writeSnapshotCapture(snapshot, *options.technology, std::move(file), snapshot.odd);
        text += fmt::format("{} messages written to {}\n", messages, *options.capture);
    }
    if (text.empty()) text = listing(snapshot);
    writeToStandardOutput(text);
    tellOdd(options.file, snapshot.odd);
}

}  // namespace

void addSnapshotCommand(CLI::App& app) {
    CLI::App& command =
        addCommand(app, "snapshot", "Lists what a saved snapshot holds, shows its entries and extracts its records");
    const auto options = std::make_shared<Options>();
    command.add_option("FILE", options->file, "A snapshot file, KelvoSnapshot-….kelvo")->required();
    CLI::Option* entry =
        addNumberOption(command, "--entry", options->entry, 1, "Shows the display of entry N as the screens were");
    command.add_flag("--json", options->json, "Shows that display as JSON")->needs(entry);
    command.add_option("--dlf", options->dlf, "Writes the DLF log to OUT")->type_name("OUT");
    CLI::Option* capture =
        command.add_option("--capture", options->capture, "Writes the history's raw records as a capture to OUT.pcap")
            ->type_name("OUT.pcap");
    CLI::Option* technology = addTechnologyOption(command, options->technology,
                                                  "The technology of the raw records, which the file does not say");
    capture->needs(technology);
    technology->needs(capture);
    command.add_flag("--force", options->force, "Replaces a file that is there already");
    command.footer(
        "A snapshot keeps the last five refreshes; a capture made of it replays what arrived in that time.\n\n"
        "Examples:\n"
        "  kelvoctl snapshot drive.kelvo\n"
        "  kelvoctl snapshot drive.kelvo --entry 5\n"
        "  kelvoctl snapshot drive.kelvo --dlf drive.dlf\n"
        "  kelvoctl snapshot drive.kelvo --capture again.pcap --technology lte\n");
    command.callback([options] { showSnapshot(*options); });
}

}  // namespace kelvo
