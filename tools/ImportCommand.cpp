#include "tools/ImportCommand.h"

#include <fmt/format.h>

#include <algorithm>
#include <memory>

#include "LogGenerator/Framing.h"
#include "platform/host/Capture.h"
#include "tools/Command.h"
#include "tools/CommandFailure.h"
#include "tools/DisplayJson.h"
#include "tools/DisplayText.h"
#include "tools/StandardOutput.h"
#include "tools/TechnologyOption.h"
#include "tools/import/ImportListing.h"
#include "tools/import/ImportedFile.h"
#include "tools/import/RecordingClock.h"
#include "tools/import/TimeOption.h"

namespace kelvo {

namespace {

using adaptation::Adapted;

struct Options {
    std::vector<std::string> files;
    std::string out;
    std::optional<Technology> technology;
    std::optional<std::int32_t> subscription;
    std::optional<CaptureTime> from;
    std::optional<CaptureTime> to;
    bool list = false;
    bool json = false;
    bool force = false;
};

void tell(const std::string& text) { fmt::print(stderr, "kelvoctl: {}\n", printable(text)); }

void tellDamage(const std::string& path, const ImportedFile& file) {
    for (const std::string& line : damageOf(path, file)) tell(line);
    if (file.reader->damage().isCut) tell(path + " breaks off; what comes before is read");
}

/// What all files hold. Every file is told of once, here.
RecordSurvey surveyOf(const Options& options) {
    RecordSurvey survey;
    for (const std::string& path : options.files) {
        ImportedFile file = orFail(ImportedFile::open(path));
        while (const auto message = orFail(file.reader->next())) survey.add(*message, file.holdsTrees);
        tellDamage(path, file);
    }
    return survey;
}

/// The messages of several files by their times; of two at the same time that of the file named first.
class Merge {
public:
    Merge(const Options& options, const RecordSurvey& survey) {
        for (const std::string& path : options.files) {
            _inputs.push_back({orFail(ImportedFile::open(path)), RecordingClock(survey.first())});
        }
        for (Input& input : _inputs) advance(input);
    }

    struct Message {
        RecordedMessage message;
        CaptureTime time;
        bool isTree;
    };
    /// The next one, good until the one after it.
    std::optional<Message> next() {
        if (_given != nullptr) advance(*_given);
        _given = nullptr;
        for (Input& input : _inputs) {
            if (input.next && (_given == nullptr || input.time < _given->time)) _given = &input;
        }
        if (_given == nullptr) return std::nullopt;
        return Message{*_given->next, _given->time, _given->file.holdsTrees};
    }

private:
    struct Input {
        ImportedFile file;
        RecordingClock clock;
        std::optional<RecordedMessage> next{};
        CaptureTime time{};
    };
    static void advance(Input& input) {
        input.next = orFail(input.file.reader->next());
        if (input.next) input.time = input.clock.timeOf(*input.next);
    }

    std::vector<Input> _inputs;
    Input* _given = nullptr;
};

struct Written {
    std::uint64_t records = 0;
    std::uint64_t turned = 0;
    std::uint64_t refused = 0;
    std::uint64_t ofOthers = 0;  ///< no code of Kelvo's, another family's, another SIM's, outside the times
};

Written writeCapture(const Options& options, const RecordSurvey& survey, Technology technology, CaptureWriter& writer) {
    const FamilyCodes codes = FamilyCodes::of(technology);
    const auto subscription = options.subscription ? options.subscription : survey.subscription();
    adaptation::RecordAdapter adapter;
    Written written;
    Merge merge(options, survey);
    while (const auto next = merge.next()) {
        const bool ofSim = !next->message.subscription || !subscription || *next->message.subscription == *subscription;
        const bool inTime = (!options.from || next->time >= *options.from) && (!options.to || next->time < *options.to);
        const bool asked = ofSim && inTime && next->isTree == !hasCodes(technology);
        const ByteView message = next->message.message;
        // What is left out for its time still says what a later record of the cell lacks.
        Adapted adapted;
        adapted.outcome = Adapted::Outcome::Passed;
        adapted.packet = message;
        if (!next->isTree) adapted = adapter.adapt(stripPrefix(message));
        const bool refused = adapted.outcome == Adapted::Outcome::Refused;
        const bool ours = refused ? adapted.refusal != adaptation::Refusal::NotOurs : codes.include(adapted.packet);
        if (!asked || !ours) {
            ++written.ofOthers;
            continue;
        }
        if (refused) {
            ++written.refused;
            continue;
        }
        const bool turned = adapted.outcome == Adapted::Outcome::Turned;
        orFail(writer.append(next->time, turned ? adapted.packet : message));
        ++written.records;
        written.turned += turned ? 1 : 0;
    }
    return written;
}

void import(const Options& options) {
    if (!options.list && options.out.empty()) throw CommandFailure("-o OUT.pcap or --list says what to do");
    const RecordSurvey survey = surveyOf(options);
    if (options.list) {
        writeToStandardOutput(options.json ? printedJson(listingJson(survey)) : listingText(survey));
        return;
    }
    const auto technology = options.technology ? options.technology : survey.technology();
    if (!technology) throw CommandFailure("there is no record that Kelvo can show; --list tells what there is");
    OutputFile file = orFail(OutputFile::create(options.out, {options.force, options.files}));
    CaptureWriter writer = orFail(CaptureWriter::create(std::move(file), *technology, CaptureWriter::Flush::WhenWhole));
    const Written written = writeCapture(options, survey, *technology, writer);
    if (written.records == 0) {
        throw CommandFailure(fmt::format("there is no {} record that was asked for; --list tells what there is",
                                         namesOf(*technology).name));
    }
    orFail(writer.appear());
    writeToStandardOutput(fmt::format("{} {} records written to {}: {} passed, {} adapted; {} refused, {} of others\n",
                                      written.records, namesOf(*technology).name, printable(options.out),
                                      written.records - written.turned, written.turned, written.refused,
                                      written.ofOthers));
}

}  // namespace

void addImportCommand(CLI::App& app) {
    CLI::App& command = addCommand(
        app, "import", "Makes a capture of recordings: streams of diagnostic frames, DLF files, captures, snapshots");
    const auto options = std::make_shared<Options>();
    command.add_option("FILE", options->files, "What to read, told by its content; packed with gzip or not")
        ->required();
    CLI::Option* out =
        command.add_option("-o,--output", options->out, "Writes a capture of one technology to OUT.pcap")
            ->type_name("OUT.pcap");
    CLI::Option* list =
        command.add_flag("--list", options->list, "Lists what is in the files, code by code, instead")->excludes(out);
    command.add_flag("--json", options->json, "Lists as JSON")->needs(list);
    addTechnologyOption(command, options->technology, "Takes this technology, not the one with most records");
    command
        .add_option("--subscription", options->subscription,
                    "Of a phone with several SIMs, takes this one, not the first that sends a record")
        ->type_name("N");
    addTimeOption(command, "--from", options->from, "Leaves out what is earlier, 2014-08-29T20:51:00Z");
    addTimeOption(command, "--to", options->to, "Leaves out what is as late or later");
    command.add_flag("--force", options->force, "Replaces a file that is there already");
    command.footer(
        "Several files are merged by time. Damaged stretches are skipped and counted. Records of newer modems are "
        "turned\n"
        "into the layouts that Kelvo shows; what cannot be turned is refused, and --list says why.\n\n"
        "Examples:\n"
        "  kelvoctl import --list drive.frames\n"
        "  kelvoctl import drive.frames.gz -o drive.pcap\n"
        "  kelvoctl import monday.dlf tuesday.dlf --technology gsm -o week.pcap\n");
    command.callback([options] { import(*options); });
}

}  // namespace kelvo
