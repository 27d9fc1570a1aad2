#include <algorithm>

#include "model/DisplayPath.h"
#include "overview/Families.h"

/// CDMA2000: the cell is the reference pilot of the 1x active set; EV-DO stands beside it.
namespace kelvo::overview {
namespace {

constexpr std::string_view kReference = "(ref pilot) ";
constexpr const char* kInTraffic = "in traffic";

/// "Traffic [8]" without its number.
std::string withoutNumber(std::string label) {
    if (const std::size_t bracket = label.rfind(" ["); bracket != label.npos && bracket > 0) label.resize(bracket);
    return label;
}

/// An idle phone sleeps and wakes for its pages every few seconds: that is no change of its state.
std::string stateOf(const std::string& label) {
    const std::string state = withoutNumber(label);
    if (state == "Paging" || state == "Slotted mode sleep state") return "idle";
    return state == "Traffic" ? kInTraffic : state;
}

/// "800 MHz cellular band [0]".
std::optional<std::int64_t> numberOf(const std::string& label) {
    const std::size_t bracket = label.rfind('[');
    if (bracket == label.npos) return std::nullopt;
    std::int64_t number = 0;
    for (std::size_t i = bracket + 1; i < label.size() && label[i] >= '0' && label[i] <= '9'; ++i) {
        number = 10 * number + (label[i] - '0');
    }
    return label.find("Bad") == label.npos ? std::optional<std::int64_t>(number) : std::nullopt;
}

void observePilots(Observation& seen, const Screens& oneX) {
    const Value& set = oneX.at("Active Set");
    if (!set.dictionary()) return;
    for (const auto& entry : *set.dictionary()) {
        if (entry.key == "_sorted") continue;
        HeardCell heard;
        heard.identity = identity(seen.channel, named("PN", std::string(nameOfSortedKey(entry.key))));
        heard.mark = "active";
        heard.record = entry.value.record();
        auto figure = figureOf(entry.value);
        const bool isReference = figure && figure->text.starts_with(kReference);
        if (isReference) figure->text.erase(0, kReference.size());
        heard.quality = measure("Ec/Io", std::move(figure), Graded::EcIo);
        if (heard.identity.empty()) continue;
        if (isReference) {
            seen.cell = heard.identity;
            seen.cellRecord = heard.record;
            seen.quality = heard.quality;
        } else {
            seen.cells.push_back(std::move(heard));
        }
    }
}

}  // namespace

Observation observeCdma(const Value& display) {
    const Screens screens(display);
    const Screens oneX(screens.at("1x"));
    const Screens evdo(screens.at("EV-DO"));
    const Screens system(screens.at("System"));
    Observation seen;
    seen.access = "CDMA2000 1x";
    seen.state = stateOf(oneX.text("State"));
    seen.isDedicated = seen.state == kInTraffic;
    seen.channel = named("channel", oneX.text("Rx0 Channel"));
    seen.level = measure("Rx AGC", oneX.figure("Rx0 AGC"));
    observePilots(seen, oneX);

    const auto bandClass = numberOf(oneX.text("Rx0 Band Class"));
    const auto channel = oneX.whole("Rx0 Channel");
    addBand(seen, bandClass && channel ? cdmaBands(*bandClass, *channel) : std::vector<BandChannel>());
    const auto sid = system.whole("System ID");  // no number: a system of another kind
    const auto nid = system.whole("Network ID");
    if (sid) seen.area = fmt::format("SID {}", *sid);
    if (sid && nid) seen.area += fmt::format(", NID {}", *nid);
    add(seen.serving, "Base station", system.text("Base Station ID"));
    const std::string session = evdo.text("Session State");
    const std::string device = evdo.text("Device State");
    if (!device.empty()) {
        add(seen.serving, "EV-DO", fmt::format("{}, session {}", withoutNumber(device), withoutNumber(session)));
        add(seen.serving, "EV-DO Rx AGC", evdo.text("Rx0 AGC"));
    }
    seen.registrationState = withoutNumber(system.text("Roaming Indicator"));
    add(seen.registration, "Roaming", seen.registrationState);
    addRate(seen.rates, "Traffic FER", oneX, "Traffic FER");
    addRate(seen.rates, "EV-DO forward", screens, "Rates and Errors/EV-DO Forward Rate");
    addRate(seen.rates, "EV-DO reverse", screens, "Rates and Errors/EV-DO Reverse Rate");
    return seen;
}

}  // namespace kelvo::overview
