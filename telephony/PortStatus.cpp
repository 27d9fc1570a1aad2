#include "telephony/PortStatus.h"

#include <fmt/format.h>

namespace kelvo {
namespace {

std::string_view wordFor(wire::Session::State state) {
    using State = wire::Session::State;
    switch (state) {
        case State::Closed: return "closed";
        case State::Silencing:
        case State::Identifying:
        case State::Naming:
        case State::Ranging:
        case State::Emptying: return "starting";
        case State::Running: return "running";
        case State::Ending: return "ending";
    }
    return {};
}

}  // namespace

DictionaryRef portStatus(const wire::Session& session, const adaptation::AdaptationMeter& meter,
                         const std::string& line) {
    auto port = Dictionary::make({{"Name", line},
                                  {"State", wordFor(session.state())},
                                  {"Target", session.target()},
                                  {"BuildId", session.buildId()},
                                  {"Losing", session.isLosing()},
                                  {"EncryptsRecords", session.isEncrypted()}});
    if (const auto camped = session.campedOn()) port->set("CampedOn", namesOf(*camped).name);
    if (const auto subscription = session.subscription()) port->set("Subscription", std::int64_t{*subscription});
    for (const PortCounter& counter : kPortCounters)
        port->set(counter.key, static_cast<std::int64_t>(counter.of(session.counts())));
    port->set("Passed", static_cast<std::int64_t>(meter.passed()));
    port->set("Adapted", static_cast<std::int64_t>(meter.turned()));
    const ArrayRef layouts = Array::make();
    for (const std::string& text : meter.lines()) layouts->append(text);
    port->set("Layouts", layouts);
    return port;
}

std::string portStatusText(const Dictionary& port) {
    std::string text = "\nPort\n";
    for (const auto& [key, label] :
         {std::pair("Name", "Open at"), std::pair("State", "State"), std::pair("Target", "Target"),
          std::pair("BuildId", "Build"), std::pair("CampedOn", "Camped on")}) {
        const std::string* value = port[key].string();
        if (value != nullptr && !value->empty()) text += fmt::format("  {:<26}{}\n", label, *value);
    }
    if (const Number* subscription = port["Subscription"].number())
        text += fmt::format("  {:<26}{}\n", "SIM", subscription->integer());
    const auto yes = [&port](const char* key) { return port[key].boolean() != nullptr && *port[key].boolean(); };
    if (yes("EncryptsRecords")) text += "  this modem encrypts its records\n";
    if (yes("Losing")) text += "  loses records now\n";
    for (const PortCounter& counter : kPortCounters) {
        const Number* count = port[counter.key].number();
        if (count != nullptr) text += fmt::format("  {:<26}{}\n", counter.label, count->integer());
    }
    const ArrayRef& layouts = port["Layouts"].array();
    if (!layouts || layouts->empty()) return text;
    text += "\nLayouts\n";
    for (const Value& line : *layouts) {
        if (line.string() != nullptr) text += "  " + *line.string() + "\n";
    }
    return text;
}

}  // namespace kelvo
