#include "tools/EventsCommand.h"

#include <csv.h>
#include <fmt/format.h>

#include <memory>
#include <string>
#include <vector>

#include "platform/encodings/Utf8.h"
#include "tools/Command.h"
#include "tools/CommandFailure.h"
#include "tools/FollowedCapture.h"
#include "tools/OverviewJson.h"
#include "tools/OverviewText.h"
#include "tools/StandardOutput.h"
#include "tools/TechnologyOption.h"

namespace kelvo {
namespace {

using overview::Event;

struct Options {
    std::vector<std::string> files;
    std::optional<Technology> technology;
    bool csv = false;
    bool json = false;
};

/// One line after RFC 4180: every field in quotes.
std::string csvLine(const std::vector<std::string>& fields) {
    std::string line;
    for (const std::string& field : fields) {
        std::string quoted(2 * field.size() + 2, '\0');
        quoted.resize(csv_write(quoted.data(), quoted.size(), field.data(), field.size()));
        line += (line.empty() ? "" : ",") + quoted;
    }
    return line + "\r\n";
}

std::string lineOf(const Options& options, const std::string& file, const Event& event) {
    if (options.csv) {
        return csvLine({isoText(event.time), std::string(nameOf(event.kind)), event.from, event.to, event.levelBefore,
                        event.levelAfter, event.record != 0 ? std::to_string(event.record) : "", file});
    }
    if (!options.json) return eventText(event) + "\n";
    auto json = eventJson(event);
    if (options.files.size() > 1) json["file"] = file;
    return json.dump(-1, ' ', false, nlohmann::json::error_handler_t::replace) + "\n";
}

void listEvents(const Options& options) {
    if (options.csv) {
        writeToStandardOutput(
            csvLine({"time", "event", "from", "to", "level before", "level after", "record", "file"}));
    }
    std::optional<Failure> breakOff;
    for (const std::string& file : options.files) {
        Input input = orFail(Input::openCapture(file, options.technology));
        const FollowedCapture followed = followCapture(input);
        std::string text;
        if (options.files.size() > 1 && !options.csv && !options.json) text = printable(file) + ":\n";
        for (const Event& event : followed.tracker.events()) text += lineOf(options, file, event);
        writeToStandardOutput(text);
        if (followed.breakOff) breakOff = followed.breakOff;
    }
    if (breakOff) throw CommandFailure(*breakOff);
}

}  // namespace

void addEventsCommand(CLI::App& app) {
    CLI::App& command =
        addCommand(app, "events",
                   "Lists what happened in captures: changes of cell, state, area and registration, contexts, service");
    const auto options = std::make_shared<Options>();
    command.add_option("FILE", options->files, "Classic pcap files, one log message a packet; - for standard input")
        ->required();
    addTechnologyOption(command, options->technology, "Decodes as this technology, whatever the link type says");
    CLI::Option* csv = command.add_flag("--csv", options->csv, "Prints comma-separated values after RFC 4180");
    command.add_flag("--json", options->json, "Prints one JSON object a line")->excludes(csv);
    command.footer(
        "Times are the records' own, in UTC. Of a capture that breaks off, the good part is followed; then one line\n"
        "tells where it ends, and the status is 1.\n\n"
        "Examples:\n"
        "  kelvoctl events drive.pcap\n"
        "  zcat drive.pcap.gz | kelvoctl events -\n"
        "  kelvoctl events --csv monday.pcap tuesday.pcap > events.csv\n"
        "  kelvoctl events --json drive.pcap | jq 'select(.event == \"handover\")'\n");
    command.callback([options] { listEvents(*options); });
}

}  // namespace kelvo
