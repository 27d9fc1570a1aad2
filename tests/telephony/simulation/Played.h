#pragma once

#include <cstdlib>
#include <limits>
#include <memory>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "LogGenerator/Factory.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "platform/telephony/Technology.h"
#include "telephony/simulation/Simulation.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/ShownAt.h"

namespace kelvo::test {

/// The log codes that the application asks a modem of this family for, 0xff0000 and more for extended records.
inline std::set<std::uint32_t> codesAskedFor(Technology technology) {
    const DirectoryResources resources{KELVO_RESOURCE_DIR};
    const Environment::Scope environment{{.resources = &resources}};
    const auto generator = generatorFromTechnology(namesOf(technology).identifier);
    const DictionaryRef command = generator->getStartCommand();
    std::set<std::uint32_t> codes;
    const auto add = [&](std::string_view key, std::uint32_t first) {
        const Value list = (*command)[key];
        if (!list.array()) return;
        for (const Value& code : *list.array())
            codes.insert(first | static_cast<std::uint32_t>(code.number()->integer()));
    };
    add("SetOskraLogCodes", 0);
    add("SetPlExtraCodes", 0xff0000);
    return codes;
}

/// How many bytes the messages of a new drive until then take up in a capture, each with 16 bytes before it.
template <class Simulation>
std::size_t captureBytes(std::uint64_t seed, simulation::Time until) {
    Simulation modem(seed);
    std::size_t bytes = 0;
    for (auto message = modem.next(); message.time < until; message = modem.next()) bytes += message.bytes.size() + 16;
    return bytes;
}

inline bool between(double value, double low, double high) { return value >= low && value <= high; }

/// A simulated modem's log, played message by message into the generator of its family; what the application would
/// show of it can be read at each moment.
class Played {
public:
    explicit Played(simulation::Simulation& modem)
        : _modem(modem), _generator(generatorFromTechnology(namesOf(modem.technology()).identifier)) {}

    /// Feeds the next message. Its log code, 0xff0000 and more for an extended record.
    std::uint32_t next() {
        const auto message = _modem.next();
        _time = message.time;
        _generator->updateState(_state, message.bytes);
        const auto& bytes = message.bytes;
        if (bytes.size() < 2 + 13 || bytes[0] != 0x81) return 0;
        return (bytes[5] | bytes[6] << 8U) | (bytes[2] == 255 ? 0xff0000U : 0U);
    }
    simulation::Time time() const { return _time; }

    /// What stands at a path of the display (`shownAt`). None when there is nothing.
    const Value* at(std::string_view path) {
        _display = display();
        return shownAt(_display, path);
    }
    /// The text shown there; "(absent)" when there is none.
    std::string text(std::string_view path) {
        const Value* value = at(path);
        return value != nullptr && value->string() != nullptr ? *value->string() : "(absent)";
    }
    /// The number that the text there begins with; not a number when there is no text.
    double number(std::string_view path) {
        const Value* value = at(path);
        return value != nullptr && value->string() != nullptr ? std::strtod(value->string()->c_str(), nullptr)
                                                              : std::numeric_limits<double>::quiet_NaN();
    }
    /// How many rows the list there has.
    std::size_t rows(std::string_view path) {
        const Value* value = at(path);
        return value != nullptr && value->array() ? value->array()->size() : 0;
    }

    /// The lines of the log that tell of something wrong, as an application's log would have them.
    const std::vector<RecordingLog::Line>& log() const { return _log.lines(); }
    void clearLog() { _log.clear(); }
    /// A rebuild of the display, as the refresh has it.
    Value refresh() { return _generator->generateLogUsingState(_state); }

private:
    Value display() {
        const Value* value = _state.find("Display");
        return value != nullptr ? *value : Value();
    }
    RecordingLog _log;
    DirectoryResources _resources{KELVO_RESOURCE_DIR};
    Environment::Scope _environment{{.log = &_log, .resources = &_resources}};
    simulation::Simulation& _modem;
    std::unique_ptr<LogGenerator> _generator;
    Dictionary _state;
    Value _display;
    simulation::Time _time{0};
};

}  // namespace kelvo::test
