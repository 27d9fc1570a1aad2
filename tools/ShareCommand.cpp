#include "tools/ShareCommand.h"

#include <fmt/format.h>

#include <memory>

#include "telephony/recordings/RecordingFile.h"
#include "tools/Command.h"
#include "tools/CommandFailure.h"
#include "tools/DisplayText.h"
#include "tools/StandardOutput.h"
#include "tools/TechnologyOption.h"
#include "tools/share/SharedFile.h"

namespace kelvo {

namespace {

struct Options {
    std::string file;
    std::string out;
    std::string key;
    std::optional<Technology> technology;
    ShareChoices choices;
    bool keepCells = false;
    bool hideCells = false;
    bool force = false;
};

/// The secret that a file holds. Short ones could be found out by trying.
Pseudonyms::Secret secretIn(const std::string& path) {
    constexpr std::size_t kShortest = 16;
    constexpr std::size_t kLongest = 4096;
    RecordingFile file = orFail(RecordingFile::open(path));
    std::string words(kLongest, '\0');
    words.resize(orFail(file.read({reinterpret_cast<std::uint8_t*>(words.data()), words.size()})));
    if (words.size() < kShortest) throw CommandFailure(path + " is too short for a key: 16 bytes are the least");
    return Pseudonyms::secretOf(words);
}

std::string summary(const Options& options, const SharedFile& file, const ShareTally& tally) {
    std::string text = fmt::format("{} of {} records written to {}\n", file.records, file.read, printable(options.out));
    text += tally.replaced().empty() ? "Replaced: nothing\n" : "Replaced:\n";
    for (const auto& [field, replaced] : tally.replaced()) {
        text += fmt::format("{:>9}  {} ({})\n", replaced.values, field, nameOf(replaced.identity));
    }
    text += tally.removed().empty() ? "Removed: nothing\n" : "Removed:\n";
    for (const auto& [what, count] : tally.removed()) text += fmt::format("{:>9}  {}\n", count, what);
    text += "Kept: levels, states, channels";
    if (!options.choices.hideCells) text += ", cells, areas and networks";
    if (!options.choices.hideApns) text += ", access points (--hide-apns)";
    if (!options.choices.shiftTimes) text += ", times (--shift-times)";
    return text + "\n";
}

void share(Options options) {
    options.choices.hideCells = !options.keepCells;
    RecordSharer sharer(options.choices, options.key.empty() ? Pseudonyms::randomSecret() : secretIn(options.key));
    const std::string read = options.file == "-" ? "/dev/stdin" : options.file;
    const OutputTerms terms{options.force, {read, options.key}};
    const SharedFile file = shareFile(options.file, options.out, terms, options.technology, sharer);
    writeToStandardOutput(summary(options, file, sharer.tally()));
    if (file.ends) throw CommandFailure(*file.ends);
}

}  // namespace

void addShareCommand(CLI::App& app) {
    CLI::App& command = addCommand(app, "share", "Makes a copy of a file without identities, to hand on");
    const auto options = std::make_shared<Options>();
    command
        .add_option("FILE", options->file,
                    "A capture, a snapshot, a stream of diagnostic frames or a DLF file; - is a capture from standard "
                    "input")
        ->required();
    command.add_option("-o,--output", options->out, "Where the copy goes")->type_name("OUT")->required();
    CLI::Option* keep = command.add_flag("--keep-cells", options->keepCells,
                                         "Leaves cells, areas and networks as they are: who reads the copy can tell "
                                         "where it was made");
    command.add_flag("--hide-cells", options->hideCells, "Replaces them, as is done without either option")
        ->excludes(keep);
    command.add_flag("--hide-apns", options->choices.hideApns, "Replaces access point names");
    command.add_flag("--shift-times", options->choices.shiftTimes,
                     "Moves all times: the first becomes the beginning of 2020, intervals stay");
    command
        .add_option("--key", options->key,
                    "Makes the pseudonyms by the secret in this file, 16 bytes or more, so that those of several files "
                    "agree; without, each copy has its own")
        ->type_name("KEYFILE");
    addTechnologyOption(command, options->technology, "The technology of a capture that does not tell it");
    command.add_flag("--force", options->force, "Replaces a file that is there already");
    command.footer(
        "Numbers and identities of SIM, subscriber and phone, temporary identities, telephone numbers and addresses "
        "are\n"
        "always replaced, everything that Kelvo cannot look into is removed. Levels, states and structure stay.\n"
        "docs/sharing.md tells what a reader can still learn.\n\n"
        "Examples:\n"
        "  kelvoctl share drive.pcap -o shared.pcap\n"
        "  kelvoctl share drive.kelvo -o shared.kelvo --keep-cells --shift-times\n");
    command.callback([options] { share(*options); });
}

}  // namespace kelvo
