#include "tools/ExportCommand.h"

#include <fmt/format.h>
#include <unistd.h>

#include <cerrno>
#include <charconv>
#include <memory>
#include <system_error>

#include "platform/system/OutputFile.h"
#include "tools/Command.h"
#include "tools/CommandFailure.h"
#include "tools/DisplayText.h"
#include "tools/TechnologyOption.h"
#include "tools/export/InputReadings.h"
#include "tools/export/Interruption.h"
#include "tools/export/LiveReadings.h"
#include "tools/export/Progress.h"
#include "tools/export/SqliteRows.h"
#include "tools/export/TextRows.h"
#include "tools/export/WideRows.h"
#include "tools/import/TimeOption.h"
#include "tools/inputs/Input.h"

namespace kelvo {

namespace {

enum class Format { Csv, Jsonl, Sqlite, Influx };

struct Options {
    std::vector<std::string> files;
    Format format = Format::Csv;
    std::vector<std::string> values;
    Choice choice;
    std::string out;
    std::optional<Technology> technology;
    bool wide = false;
    bool live = false;
    bool force = false;
};

void tell(const std::string& text) { fmt::print(stderr, "kelvoctl: {}\n", printable(text)); }

Result<void> writeAllToStandardOutput(std::string_view text) {
    while (!text.empty()) {
        const ssize_t written = ::write(STDOUT_FILENO, text.data(), text.size());
        if (written < 0 && errno != EINTR) {
            return Failure{"standard output cannot be written: " + std::generic_category().message(errno)};
        }
        text.remove_prefix(written > 0 ? static_cast<std::size_t>(written) : 0);
    }
    return {};
}

/// Where rows of text go: standard output, or a file that appears when it is whole. What is read live can be read along
/// from its first rows on.
class TextOutput {
public:
    explicit TextOutput(const Options& options) {
        if (!options.out.empty()) {
            _file = orFail(OutputFile::create(options.out, {options.force, filesOf(options.files)}));
        }
        _thread = std::make_unique<OutputThread>([this, early = options.live](std::string_view text) -> Result<void> {
            if (!_file) return writeAllToStandardOutput(text);
            if (auto written = _file->write(bytesOf(text)); !written || !early) return written;
            return _file->appear();
        });
    }

    OutputThread& thread() { return *_thread; }
    /// Once everything is written.
    void appear() {
        if (_file) orFail(_file->appear());
    }

private:
    std::optional<OutputFile> _file;
    std::unique_ptr<OutputThread> _thread;
};

/// What the user named, read input by input.
class Inputs {
public:
    Inputs(const Options& options, ValueGlobs& globs)
        : _options(options), _globs(globs), _progress(progressOnTerminal(options.out.empty()), steadyNow) {}

    /// Reads all of them, for the first of two times or for the only or last one.
    void read(ReadingRows& rows, const Choice& choice, bool isFirstOfTwo) {
        _passes += isFirstOfTwo ? 2 : _passes == 0 ? 1 : 0;
        for (std::size_t i = 0; i < _options.files.size() && !_interruption.hasCome(); ++i) {
            if (i == 0) startAnew();
            readOne(i, rows, choice);
        }
        ++_pass;
    }
    std::uint64_t records() const { return _records; }
    /// Why something was not read, a line each.
    const std::vector<std::string>& stops() const { return _stops; }
    const std::vector<std::string>& leftOut() const { return _leftOut; }
    void clearProgress() { _progress.clear(); }

private:
    void startAnew() {
        _records = 0;
        _stops.clear();
        _leftOut.clear();
    }

    void readOne(std::size_t number, ReadingRows& rows, const Choice& choice) {
        auto input = Input::open(_options.files[number], _options.technology);
        if (!input) return _stops.push_back(input.error().reason);
        const ReadInput read = readReadings(*input, number, choice, _globs, rows, [&] {
            _progress.at(_records + input->count(), [&] { return portion(number, *input); });
            return !_interruption.hasCome();
        });
        _records += read.records;
        for (std::string& line : input->leftOut()) _leftOut.push_back(std::move(line));
        if (_interruption.hasCome()) {
            _stops.push_back(fmt::format("stopped behind record {} of {}; what comes before is written", input->count(),
                                         input->name()));
        } else if (!read.breakOff.empty()) {
            _stops.push_back(read.breakOff);
        }
    }

    std::optional<double> portion(std::size_t number, const Input& input) const {
        const auto portion = input.portion();
        if (!portion) return std::nullopt;
        const double ofPass = (static_cast<double>(number) + *portion) / static_cast<double>(_options.files.size());
        return (_pass + ofPass) / _passes;
    }

    const Options& _options;
    ValueGlobs& _globs;
    Interruption _interruption;
    Progress _progress;
    int _pass = 0;
    int _passes = 0;
    std::uint64_t _records = 0;  // of this pass, as the rest
    std::vector<std::string> _stops;
    std::vector<std::string> _leftOut;
};

/// What lines of text there are; the columns of a wide table are known by now.
std::unique_ptr<ReadingRows> textRows(const Options& options, const std::vector<std::string>& columns,
                                      OutputThread& thread) {
    const auto& files = options.files;
    if (options.wide && options.format == Format::Csv) return std::make_unique<WideCsvRows>(columns, files, thread);
    if (options.wide) return std::make_unique<WideJsonRows>(files, thread);
    auto notation = options.format == Format::Csv     ? csvNotation(files)
                    : options.format == Format::Jsonl ? jsonNotation(files)
                                                      : influxNotation(files);
    return std::make_unique<TextRows>(std::move(notation), thread);
}

/// Whether the columns of a wide table have to be found out before its first line is written.
bool needsColumns(const Options& options, const ValueGlobs& globs) {
    if (!options.wide || options.format != Format::Csv || !globs.wholePaths().empty()) return false;
    if (options.live) {
        throw CommandFailure("--wide of --live needs the columns' names beforehand: --values with whole paths");
    }
    for (const std::string& file : options.files) {
        if (!isReadOnce(file)) continue;
        throw CommandFailure(fmt::format(
            "--wide reads its input twice, and {} can be read once; --values with whole paths names the columns "
            "beforehand",
            file == "-" ? "standard input" : file));
    }
    return true;
}

std::vector<std::string> foundColumns(const Options& options, Inputs& inputs) {
    constexpr std::size_t kMostInSpreadsheets = 16'384;
    Choice choice = options.choice;
    choice.every.reset();  // every path is told at once, in the order of the screens
    WideColumns columns;
    inputs.read(columns, choice, true);
    if (columns.paths().size() + 3 > kMostInSpreadsheets) {
        inputs.clearProgress();
        tell(fmt::format("{} columns are more than spreadsheets take; --values chooses some", columns.paths().size()));
    }
    return columns.paths();
}

void exportFiles(const Options& options, ValueGlobs& globs) {
    const bool hasColumnsToFind = needsColumns(options, globs);
    std::optional<TextOutput> text;
    std::unique_ptr<ReadingRows> rows;
    Inputs inputs(options, globs);
    if (options.format == Format::Sqlite) {
        rows = std::make_unique<SqliteRows>(
            orFail(OutputFile::create(options.out, {options.force, filesOf(options.files)})));
    } else {
        text.emplace(options);
        rows = textRows(options, hasColumnsToFind ? foundColumns(options, inputs) : globs.wholePaths(), text->thread());
    }
    inputs.read(*rows, options.choice, false);
    const auto& stops = inputs.stops();
    if (inputs.records() != 0 || stops.empty()) {
        rows->finish();
        if (text) text->appear();
    }
    inputs.clearProgress();
    for (const std::string& line : inputs.leftOut()) tell(line);
    const auto unmatched = inputs.records() != 0 ? globs.unmatched() : std::vector<std::string>();
    for (const std::string& word : unmatched) tell("no reading is called " + word);
    for (std::size_t i = 0; i + 1 < stops.size(); ++i) tell(stops[i]);
    if (!stops.empty()) throw CommandFailure(stops.back());
}

void exportLive(const Options& options, ValueGlobs& globs) {
    std::optional<TextOutput> text;
    std::unique_ptr<ReadingRows> rows;
    if (options.format == Format::Sqlite) {
        rows = std::make_unique<SqliteRows>(orFail(OutputFile::create(options.out, {.replace = options.force})));
    } else {
        needsColumns(options, globs);
        text.emplace(options);
        rows = textRows(options, globs.wholePaths(), text->thread());
    }
    readLive(options.choice, globs, *rows);
    rows->finish();
    if (text) text->appear();
}

void exportReadings(Options& options) {
    if (options.live == !options.files.empty()) throw CommandFailure("export takes files, or --live");
    if (options.format == Format::Sqlite && options.out.empty()) {
        throw CommandFailure("a database needs a place: --format sqlite -o OUT.db");
    }
    if (options.wide && (options.format == Format::Sqlite || options.format == Format::Influx)) {
        throw CommandFailure("--wide is for csv and jsonl");
    }
    options.choice.isOneMoment = options.wide;
    ValueGlobs globs = orFail(ValueGlobs::of(options.values));
    options.live ? exportLive(options, globs) : exportFiles(options, globs);
}

/// "2", "0.5": an interval's length, a millisecond at least.
void addEveryOption(CLI::App& command, std::optional<std::chrono::nanoseconds>& every) {
    const auto read = [&every](const std::string& text) {
        double seconds = 0;
        const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), seconds);
        if (error != std::errc() || end != text.data() + text.size() || !(seconds >= 0.001) || seconds > 1e9) {
            throw CLI::ValidationError("--every", text + " is not a number of seconds, 0.001 at least");
        }
        every = std::chrono::nanoseconds(static_cast<std::int64_t>(seconds * 1e9));
    };
    command
        .add_option_function<std::string>("--every", read,
                                          "Takes of each value the last reading in every so many seconds")
        ->type_name("SECONDS");
}

void addFormatOption(CLI::App& command, Format& format) {
    const auto read = [&format](const std::string& word) {
        constexpr std::pair<std::string_view, Format> kWords[] = {
            {"csv", Format::Csv}, {"jsonl", Format::Jsonl}, {"sqlite", Format::Sqlite}, {"influx", Format::Influx}};
        for (const auto& [name, known] : kWords) {
            if (name == word) return static_cast<void>(format = known);
        }
        throw CommandFailure("unknown format " + word + ": there are csv, jsonl, sqlite and influx");
    };
    command.add_option_function<std::string>("--format", read, "How readings are written; csv when nothing is said")
        ->type_name("csv|jsonl|sqlite|influx");
}

}  // namespace

void addExportCommand(CLI::App& app) {
    CLI::App& command =
        addCommand(app, "export", "Writes every reading as a row: CSV, JSON lines, an SQLite database, line protocol");
    const auto options = std::make_shared<Options>();
    CLI::Option* files = command.add_option(
        "FILE", options->files, "Captures, snapshots and what import reads; - for a capture from standard input");
    CLI::Option* live = command.add_flag("--live", options->live, "Takes the running service's readings, until Ctrl-C")
                            ->excludes(files);
    addFormatOption(command, options->format);
    command.add_flag("--wide", options->wide, "One line a moment, one column a path, for spreadsheets (csv, jsonl)");
    command
        .add_option("--values", options->values,
                    "Takes these values alone: globs over paths, or signal, cell, neighbours, registration, throughput")
        ->type_name("GLOB")
        ->allow_extra_args(false);
    addEveryOption(command, options->choice.every);
    command.add_flag("--changes", options->choice.changes, "Takes a reading only when it differs from the one before")
        ->excludes("--every");
    addTimeOption(command, "--from", options->choice.from, "Leaves out what is earlier, 2014-08-29T20:51:00Z");
    addTimeOption(command, "--to", options->choice.to, "Leaves out what is as late or later");
    addTechnologyOption(command, options->technology, "Decodes as this technology, whatever the input says")
        ->excludes(live);
    command.add_option("-o,--output", options->out, "Writes to OUT, not to standard output")->type_name("OUT");
    command.add_flag("--force", options->force, "Replaces a file that is there already");
    command.footer(
        "A row is a reading: a record has written the value, whether or not it changed. Its columns: time (UTC, the\n"
        "record's own), technology, path (the rows of a list by their cell), text as on the screens, number, unit,\n"
        "the record's code and its number. In a glob * is any text, ? one letter; capitals do not matter.\n"
        "Of an input that breaks off the good part is written; then one line tells where it ends, and the status\n"
        "is 1.\n"
        "Ctrl-C leaves whole rows, and a whole database of what was read.\n\n"
        "Examples:\n"
        "  kelvoctl export drive.pcap > drive.csv\n"
        "  kelvoctl export --wide --values signal --every 1 drive.pcap -o drive.csv\n"
        "  kelvoctl export --format jsonl --values '*RSRP' drive.pcap | jq -r '[.time, .number] | @tsv'\n"
        "  kelvoctl export --format sqlite monday.pcap tuesday.pcap -o week.db\n"
        "  kelvoctl export --live --changes --values registration\n"
        "  zcat drive.pcap.gz | kelvoctl export --format influx - > drive.line\n");
    command.callback([options] { exportReadings(*options); });
}

}  // namespace kelvo
