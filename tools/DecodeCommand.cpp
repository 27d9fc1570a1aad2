#include "tools/DecodeCommand.h"

#include <fmt/format.h>

#include <memory>
#include <optional>

#include "LogGenerator/Factory.h"
#include "model/Snapshot.h"
#include "platform/host/Capture.h"
#include "platform/system/Environment.h"
#include "tools/CommandFailure.h"
#include "tools/DisplayJson.h"
#include "tools/DisplayText.h"
#include "tools/StandardOutput.h"
#include "tools/TechnologyOption.h"

namespace kelvo {

namespace {

struct Options {
    std::string file;
    std::optional<Technology> technology;
    std::size_t refreshEvery = 0;  ///< messages; 0: at the end alone
    std::optional<std::string> save;
    bool log = false;
    bool json = false;
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
    Value display;
};

Technology technologyOf(const Options& options, const CaptureReader& reader) {
    const auto technology = options.technology ? options.technology : reader.technology();
    if (technology) return *technology;
    throw CommandFailure(options.file + " has a link type that names no technology; --technology names one");
}

/// What ends the program elsewhere ends the command here, with the packet that did it.
template <class Work>
void orTell(const Options& options, std::size_t packet, Work work) {
    try {
        work();
    } catch (...) {
        throw CommandFailure(
            fmt::format("packet {} of {} ends the program: {}", packet, options.file, currentExceptionText()));
    }
}

Decoded decodeAll(const Options& options, CaptureReader& reader, LogGenerator& generator, Dictionary& state) {
    Decoded decoded;
    while (const auto packet = orFail(reader.next())) {
        ++decoded.messages;
        orTell(options, decoded.messages, [&] {
            generator.updateState(state, packet->bytes);
            if (options.refreshEvery != 0 && decoded.messages % options.refreshEvery == 0) {
                generator.generateLogUsingState(state);
            }
        });
    }
    orTell(options, decoded.messages, [&] { decoded.display = generator.generateLogUsingState(state); });
    if (decoded.messages != 0 && !decoded.display) {
        throw CommandFailure("the display's template cannot be loaded; the installation is not complete");
    }
    return decoded;
}

void save(const std::string& path, LogGenerator& generator, Dictionary& state) {
    const Snapshot snapshot{clock().now(), generator.getSaveContentsFromState(state), std::string()};
    const Bytes bytes = orFail(snapshot.propertyList());
    const auto failure = writeFileInPlace(path, bytes);
    if (failure) throw CommandFailure(path + " cannot be written: " + failure->reason);
}

void decode(const Options& options) {
    CaptureReader reader = orFail(CaptureReader::open(options.file));
    const TechnologyNames& names = namesOf(technologyOf(options, reader));

    CollectedLog log;
    Environment environment = Environment::current();
    environment.log = options.log ? &log : nullptr;
    const Environment::Scope scope(environment);

    const auto generator = generatorFromTechnology(names.identifier);
    if (!generator) throw CommandFailure(fmt::format("no generator decodes {}", names.name));
    const DictionaryRef state = Dictionary::make();
    const Decoded decoded = decodeAll(options, reader, *generator, *state);
    if (options.save) save(*options.save, *generator, *state);

    if (options.json) {
        nlohmann::ordered_json json = {
            {"technology", names.name}, {"messages", decoded.messages}, {"display", jsonFrom(decoded.display)}};
        if (options.log) json["log"] = log.json();
        writeToStandardOutput(printedJson(json));
    } else {
        writeToStandardOutput(log.text() + displayText(decoded.display));
    }
}

/// What is wrong with a count; nothing when it is one.
std::string countFromOne(const std::string& text) {
    const bool digits = text.find_first_not_of("0123456789") == text.npos;
    const bool positive = text.find_first_not_of('0') != text.npos;
    return digits && positive ? "" : text + " is not a whole number from 1";
}

}  // namespace

void addDecodeCommand(CLI::App& app) {
    CLI::App& command = *app.add_subcommand("decode", "Shows what the messages of a capture give on the screens");
    const auto options = std::make_shared<Options>();
    command.add_option("FILE", options->file, "A classic pcap file, one log message a packet")->required();
    addTechnologyOption(command, options->technology, "Decodes as this technology, whatever the link type says");
    command
        .add_option("--refresh-every", options->refreshEvery,
                    "Rebuilds the display, and so records a snapshot, after every N messages too")
        ->type_name("N")
        ->check(countFromOne);
    command.add_option("--save", options->save, "Writes the snapshot that the save screen would write")
        ->type_name("OUT.kelvo");
    command.add_flag("--log", options->log, "Shows the system log's lines as well, before the display");
    command.add_flag("--json", options->json,
                     "Prints one JSON object: technology, messages, display and, with --log, log");
    command.footer(
        "Examples:\n"
        "  kelvoctl decode drive.pcap\n"
        "  kelvoctl decode --json drive.pcap | jq .display\n"
        "  kelvoctl decode --log drive.pcap | grep '^\\[3\\]'\n"
        "  kelvoctl decode --refresh-every 50 --save drive.kelvo drive.pcap\n");
    command.callback([options] { decode(*options); });
}

}  // namespace kelvo
