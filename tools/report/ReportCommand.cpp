#include "tools/report/ReportCommand.h"

#include <fmt/format.h>

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/encodings/Utf8.h"
#include "platform/system/OutputFile.h"
#include "tools/Command.h"
#include "tools/CommandFailure.h"
#include "tools/StandardOutput.h"
#include "tools/TechnologyOption.h"
#include "tools/inputs/Input.h"
#include "tools/report/FollowDrive.h"
#include "tools/report/ReportPage.h"

namespace kelvo {
namespace {

struct Options {
    std::vector<std::string> files;
    std::string out;
    std::string title;
    std::optional<Technology> technology;
    bool force = false;
    bool isShared = false;
    bool keepCells = false;
    ShareChoices choices;
};

/// Which pseudonyms there are, and what is as it was.
std::string sharedText(const ShareChoices& choices) {
    std::string hidden = "Identities";
    std::string kept;
    const auto tell = [&](bool isHidden, const std::string& what) {
        std::string& list = isHidden ? hidden : kept;
        list += (list.empty() ? "" : ", ") + what;
    };
    tell(choices.hideApns, "access points");
    tell(choices.hideCells, "cells, areas and networks");
    if (!choices.shiftTimes) kept += (kept.empty() ? "" : ", ") + std::string("times");
    return hidden + " have pseudonyms." + (choices.shiftTimes ? " Times are moved, intervals stay." : "") +
           (kept.empty() ? "" : " As they were: " + kept + ".");
}

void writeReport(const Options& options) {
    if (options.files.size() > report::kMostDrives) {
        throw CommandFailure(fmt::format("a report compares at most {} files", report::kMostDrives));
    }
    OutputFile file = orFail(OutputFile::create(options.out, {options.force, filesOf(options.files)}));
    ShareChoices choices = options.choices;
    choices.hideCells = !options.keepCells;
    // One for all files, so that a cell is the same in each of them.
    const Pseudonyms::Secret secret = Pseudonyms::randomSecret();
    std::vector<report::Drive> drives;
    std::optional<Failure> breakOff;
    std::uint64_t records = 0;
    for (const std::string& path : options.files) {
        Input input = orFail(Input::open(path, options.technology));
        RecordSharer sharer(choices, secret);
        drives.push_back(report::followDrive(input, options.isShared ? &sharer : nullptr));
        records += drives.back().records;
        if (input.breakOff()) breakOff = input.breakOff();
    }
    const std::string page =
        report::reportPage(drives, {options.title, options.isShared ? sharedText(choices) : std::string()});
    orFail(file.write({reinterpret_cast<const std::uint8_t*>(page.data()), page.size()}));
    orFail(file.appear());
    writeToStandardOutput(
        fmt::format("{} record{} reported in {}\n", records, records == 1 ? "" : "s", printable(options.out)));
    if (breakOff) throw CommandFailure(*breakOff);
}

}  // namespace

void addReportCommand(CLI::App& app) {
    CLI::App& command = addCommand(
        app, "report", "Makes a page of recordings, for a browser or paper: figures, charts, cells, states, events");
    const auto options = std::make_shared<Options>();
    command
        .add_option("FILE", options->files,
                    "Captures, snapshots, whatever \"kelvoctl import\" reads; - for a capture from standard input")
        ->required();
    command.add_option("-o,--output", options->out, "Writes the page to REPORT.html")
        ->type_name("REPORT.html")
        ->required();
    command.add_option("--title", options->title, "Calls the report that, not by the names of the files")
        ->type_name("TEXT");
    addTechnologyOption(command, options->technology, "Takes this technology, whatever the file says");
    CLI::Option* share =
        command.add_flag("--share", options->isShared,
                         "Puts pseudonyms in place of identities, as \"kelvoctl share\" does, and names no file");
    command.add_flag("--keep-cells", options->keepCells, "Leaves cells, areas and networks as they are")->needs(share);
    command.add_flag("--hide-apns", options->choices.hideApns, "Replaces access point names")->needs(share);
    command.add_flag("--shift-times", options->choices.shiftTimes, "Moves all times to the beginning of 2020")
        ->needs(share);
    command.add_flag("--force", options->force, "Replaces a file that is there already");
    command.footer(
        "One file is told of by itself; two to six are compared, their charts aligned by the time since the start.\n"
        "The page needs neither network nor other files, and no script to be read or printed.\n"
        "Of a file that breaks off, the good part is told of; then one line tells where it ends, and the status is "
        "1.\n\n"
        "Examples:\n"
        "  kelvoctl report drive.pcap -o drive.html\n"
        "  kelvoctl report before.pcap after.pcap --title \"New antenna\" -o antenna.html\n"
        "  kelvoctl report drive.pcap --share -o for-others.html\n"
        "  zcat drive.pcap.gz | kelvoctl report - -o drive.html\n");
    command.callback([options] { writeReport(*options); });
}

}  // namespace kelvo
