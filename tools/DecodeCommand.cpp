#include "tools/DecodeCommand.h"

#include <fmt/format.h>

#include <cstdio>
#include <memory>
#include <optional>
#include <utility>

#include "LogGenerator/Factory.h"
#include "LogGenerator/RecordLedger.h"
#include "model/Snapshot.h"
#include "platform/system/Environment.h"
#include "platform/system/OutputFile.h"
#include "tools/CapturePackets.h"
#include "tools/Command.h"
#include "tools/DisplayJson.h"
#include "tools/DisplayText.h"
#include "tools/FamilyCodes.h"
#include "tools/FollowedCapture.h"
#include "tools/NumberOption.h"
#include "tools/OverviewJson.h"
#include "tools/OverviewText.h"
#include "tools/ProvenanceJson.h"
#include "tools/StandardOutput.h"
#include "tools/TechnologyOption.h"
#include "tools/inputs/Input.h"

namespace kelvo {

namespace {

struct Options {
    std::string file;
    std::optional<Technology> technology;
    std::optional<std::uint64_t> refreshEvery;  ///< messages; none: at the end alone
    std::optional<std::string> save;
    bool log = false;
    bool json = false;
    bool overview = false;
    bool provenance = false;
    bool force = false;
};

/// Keeps every line in order.
class CollectedLog final : public SystemLog {
public:
    bool wants(Level) const override { return true; }
    void write(Level level, std::string_view text) override { _lines.push_back({level, std::string(text)}); }

    nlohmann::ordered_json json() const {
        nlohmann::ordered_json json = nlohmann::ordered_json::array();
        for (const Line& line : _lines) json.push_back({static_cast<int>(line.level), line.text});
        return json;
    }
    std::string text() const {
        std::string text;
        for (const Line& line : _lines) {
            const std::string_view shown(line.text.data(), line.text.size() - (line.text.ends_with('\n') ? 1 : 0));
            text += fmt::format("[{}] {}\n", static_cast<int>(line.level), printable(shown));
        }
        return text;
    }

private:
    struct Line {
        Level level;
        std::string text;
    };
    std::vector<Line> _lines;
};

struct Decoded {
    std::size_t messages = 0;
    std::size_t understood = 0;  ///< of them: records of the family
    Value display;
    RecordLedger records;
    std::chrono::nanoseconds end{0};  ///< the last message's time
    std::optional<Failure> breakOff;  ///< where the capture can be read no further, and why
};

Decoded decodeAll(const Options& options, Input& input, LogGenerator& generator, Dictionary& state) {
    const FamilyCodes codes(*generator.getStartCommand());
    Decoded decoded;
    while (const auto packet = input.next()) {
        decoded.messages = input.count();
        decoded.understood += codes.include(packet->bytes) ? 1 : 0;
        decoded.end = packet->time.time_since_epoch();
        orTell(input.name(), decoded.messages, [&] {
            update(generator, state, decoded.records, packet->bytes, decoded.end);
            if (options.refreshEvery && decoded.messages % *options.refreshEvery == 0) {
                generator.generateLogUsingState(state);
            }
        });
    }
    decoded.breakOff = input.breakOff();
    if (decoded.breakOff && decoded.messages == 0) throw CommandFailure(*decoded.breakOff);
    orTell(input.name(), decoded.messages, [&] { decoded.display = generator.generateLogUsingState(state); });
    if (decoded.messages != 0 && !decoded.display) {
        throw CommandFailure("the display's template cannot be loaded; the installation is not complete");
    }
    return decoded;
}

void save(OutputFile& file, LogGenerator& generator, Dictionary& state) {
    const Snapshot snapshot{clock().now(), generator.getSaveContentsFromState(state), std::string()};
    orFail(file.write(orFail(snapshot.propertyList())));
    orFail(file.appear());
}

std::string grouped(std::size_t number) {
    std::string text = std::to_string(number);
    for (std::size_t at = text.size(); at > 3; at -= 3) text.insert(at - 3, 1, ',');
    return text;
}

/// Screens of another family than the capture's are empty or, worse, look right.
void warnOfOtherFamily(const Decoded& decoded, const Input& input) {
    const auto told = input.technologyTold();
    const bool named = told && *told != input.technology();
    if (decoded.messages == 0 || (decoded.understood != 0 && !named)) return;
    std::string line = fmt::format(
        "{} of {} record{} {} of this family", decoded.understood != 0 ? grouped(decoded.understood) : "none",
        grouped(decoded.messages), decoded.messages != 1 ? "s" : "", decoded.understood > 1 ? "are" : "is");
    if (named) {
        line += fmt::format("; the link type says {}, not {}", namesOf(*told).name, namesOf(input.technology()).name);
    }
    fmt::print(stderr, "kelvoctl: {}: {}\n", printable(input.name()), line);
}

/// Followed record by record: the cells around and what happened are more than the last values.
void showOverview(const Options& options, Input& input) {
    const FollowedCapture followed = followCapture(input);
    writeToStandardOutput(options.json ? printedJson(overviewJson(followed.tracker, followed.end))
                                       : overviewText(followed.tracker, followed.end));
    if (followed.breakOff) throw CommandFailure(*followed.breakOff);
}

void decode(const Options& options) {
    Input input = orFail(Input::openCapture(options.file, options.technology));
    if (options.overview) return showOverview(options, input);
    const TechnologyNames& names = namesOf(input.technology());
    std::optional<OutputFile> output;
    if (options.save) output = orFail(OutputFile::create(*options.save, {options.force, filesOf({options.file})}));

    CollectedLog log;
    Environment environment = Environment::current();
    environment.log = options.log ? &log : nullptr;
    const Environment::Scope scope(environment);

    const auto generator = generatorFromTechnology(names.identifier);
    if (!generator) throw CommandFailure(fmt::format("no generator decodes {}", names.name));
    const DictionaryRef state = Dictionary::make();
    const Decoded decoded = decodeAll(options, input, *generator, *state);
    if (output) save(*output, *generator, *state);

    if (options.json) {
        nlohmann::ordered_json json = {
            {"technology", names.name},
            {"messages", decoded.messages},
            {"display", options.provenance ? jsonWithProvenance(decoded.display, decoded.records, decoded.end)
                                           : jsonFrom(decoded.display)}};
        if (options.log) json["log"] = log.json();
        writeToStandardOutput(printedJson(json));
    } else {
        writeToStandardOutput(log.text() + displayText(decoded.display));
    }
    warnOfOtherFamily(decoded, input);
    if (decoded.breakOff) throw CommandFailure(*decoded.breakOff);
}

}  // namespace

void addDecodeCommand(CLI::App& app) {
    CLI::App& command = addCommand(app, "decode", "Shows what the messages of a capture give on the screens");
    const auto options = std::make_shared<Options>();
    command.add_option("FILE", options->file, "A classic pcap file, one log message a packet; - for standard input")
        ->required();
    addTechnologyOption(command, options->technology, "Decodes as this technology, whatever the link type says");
    addNumberOption(command, "--refresh-every", options->refreshEvery, 1,
                    "Rebuilds the display, and so records a snapshot, after every N messages too");
    CLI::Option* save =
        command.add_option("--save", options->save, "Writes the snapshot that the save screen would write")
            ->type_name("OUT.kelvo");
    command.add_flag("--force", options->force, "Replaces a file that is there already")->needs(save);
    command.add_flag("--log", options->log, "Shows the system log's lines as well, before the display");
    command
        .add_flag("--overview", options->overview,
                  "Shows what the values mean together instead: the serving cell, the cells around, what happened")
        ->excludes("--save", "--log", "--refresh-every");
    CLI::Option* json = command.add_flag("--json", options->json,
                                         "Prints one JSON object: technology, messages, display and, with --log, log");
    command
        .add_flag("--provenance", options->provenance,
                  "Tells of every value its number and unit, the record that wrote it last, and its age")
        ->needs(json);
    command.footer(
        "Of a capture that breaks off, the good part is shown; then one line tells where it ends, and the status is "
        "1.\n"
        "A warning on standard error tells when the records are of another family.\n\n"
        "Examples:\n"
        "  kelvoctl decode drive.pcap\n"
        "  kelvoctl decode --json drive.pcap | jq .display\n"
        "  zcat drive.pcap.gz | kelvoctl decode -\n"
        "  kelvoctl decode --overview drive.pcap\n"
        "  kelvoctl decode --json --provenance drive.pcap | jq '.display.\"Serving Cell Measurements\"'\n"
        "  kelvoctl decode --log drive.pcap | grep '^\\[3\\]'\n"
        "  kelvoctl decode --refresh-every 50 --save drive.kelvo drive.pcap\n");
    command.callback([options] { decode(*options); });
}

}  // namespace kelvo
