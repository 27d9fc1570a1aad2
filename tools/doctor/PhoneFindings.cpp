#include "tools/doctor/PhoneFindings.h"

#include <fmt/format.h>
#include <fmt/ranges.h>

#include "platform/encodings/Utf8.h"
#include "telephony/phone/PhoneRecords.h"
#include "tools/doctor/FillableScreens.h"

namespace kelvo {
namespace {

using Json = nlohmann::ordered_json;

std::string line(std::string_view label, std::string_view text) {
    return fmt::format("  {:<15}{}\n", label, printable(text));
}

// Which records it can have: with signal values, which nobody has asked for yet, the levels as well.
bool hasRecord(const phone::PhoneState& phone, LogCode code) {
    phone::PhoneState measured = phone;
    measured.lte = {.rsrp = 0, .rsrq = 0, .rssi = 0};
    if (code == 0xB17F) return phone::servingLevels(measured).has_value();
    const auto contents = phone::serviceContents(phone);
    return std::ranges::any_of(contents, [code](const phone::Content& content) { return content.code == code; });
}

std::optional<FillableScreens> screensOf(const phone::PhoneState& phone) {
    const auto all = screensWithServices([&](LogCode code) { return hasRecord(phone, code); });
    const auto found =
        std::ranges::find_if(all, [&](const FillableScreens& screens) { return screens.technology == phone.family; });
    return found != all.end() ? std::optional(*found) : std::nullopt;
}

std::string known(const phone::PhoneState& phone) {
    std::vector<std::string> known;
    if (!phone.sim.iccid.empty()) known.push_back("SIM " + phone::shortened(phone.sim.iccid));
    if (phone.cells) known.push_back(fmt::format("cells: {}", phone.cells->size()));
    if (phone.contexts) known.push_back(fmt::format("data contexts: {}", phone.contexts->size()));
    return known.empty() ? "nothing of the phone" : fmt::format("{}", fmt::join(known, ", "));
}

std::string modemText(const phone::PhoneState& phone) {
    std::string text = fmt::format("ModemManager's modem {}: {}\n", printable(phone.modem), printable(phone.model));
    text += line("it is", phone.condition + (phone.access.empty() ? "" : ", on " + phone.access));
    if (!phone.network.empty())
        text += line("network", phone.network + (phone.registration.empty() ? "" : ", " + phone.registration));
    std::vector<std::string> ports;
    for (const phone::DrivenPort& port : phone.ports) ports.push_back(port.name);
    if (!ports.empty()) text += line("has the ports", fmt::format("{}", fmt::join(ports, ", ")));
    return text;
}

std::string screensText(const FillableScreens& screens) {
    const auto listed = [](const std::vector<std::string>& names) {
        return names.empty() ? std::string("none") : fmt::format("{}", fmt::join(names, ", "));
    };
    return fmt::format("{}; in part {}", listed(screens.filled), listed(screens.partly));
}

}  // namespace

std::string phoneFindingsText(const PhoneFindings& findings) {
    if (findings.modems.empty() && findings.trouble.empty()) return {};
    std::string text;
    for (const auto& [phone, lacks] : findings.modems) {
        text += modemText(phone);
        text += line("knows", known(phone));
        for (const std::string& lack : lacks) text += line("lacks", lack);
        if (const auto screens = screensOf(phone))
            text += line(fmt::format("{} screens", namesOf(screens->technology).name), screensText(*screens));
    }
    if (findings.modems.empty()) text += "ModemManager\n";
    if (!findings.trouble.empty()) text += line("trouble", findings.trouble);
    return text + "\n";
}

Json phoneFindingsJson(const PhoneFindings& findings) {
    Json modems = Json::array();
    for (const auto& [phone, lacks] : findings.modems) {
        Json json{{"modem", phone.modem},   {"model", phone.model},     {"condition", phone.condition},
                  {"access", phone.access}, {"network", phone.network}, {"ports", Json::array()}};
        for (const phone::DrivenPort& port : phone.ports) json["ports"].push_back(port.name);
        if (!phone.sim.iccid.empty()) json["sim"] = phone::shortened(phone.sim.iccid);
        if (phone.cells) json["cells"] = phone.cells->size();
        if (phone.contexts) json["contexts"] = phone.contexts->size();
        const auto screens = screensOf(phone);
        if (screens)
            json["screens"] = {{"technology", namesOf(screens->technology).name},
                               {"filled", screens->filled},
                               {"partly", screens->partly}};
        json["lacks"] = lacks;
        modems.push_back(std::move(json));
    }
    const auto lacks = findings.modems.empty() ? std::vector<std::string>() : findings.modems.front().lacks;
    return {{"trouble", findings.trouble}, {"modems", std::move(modems)}, {"lacks", lacks}};
}

}  // namespace kelvo
