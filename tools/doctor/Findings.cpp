#include "tools/doctor/Findings.h"

#include <fmt/format.h>
#include <fmt/ranges.h>

#include "platform/encodings/Utf8.h"
#include "tools/doctor/FillableScreens.h"

namespace kelvo {
namespace {

using Json = nlohmann::ordered_json;
using Kind = wire::CandidateNode::Kind;

std::string line(std::string_view label, std::string_view text) { return fmt::format("  {:<15}{}\n", label, text); }

std::string kindText(const PortFindings& port) {
    if (port.isNetwork) return "a network port";
    if (!port.node.usb) return "a node that is not on USB";
    switch (port.node.kind) {
        case Kind::Diagnostic: return "a diagnostic port, by its interface";
        case Kind::Possible: return "possibly a diagnostic port";
        case Kind::Other: break;
    }
    return "another port of a modem";
}

std::string kindWord(const PortFindings& port) {
    if (port.isNetwork) return "network";
    switch (port.node.kind) {
        case Kind::Diagnostic: return "diagnostic";
        case Kind::Possible: return "possible";
        case Kind::Other: break;
    }
    return "other";
}

std::string usbText(const wire::CandidateNode& node) {
    const wire::UsbInterface& usb = *node.usb;
    const std::string name = usb.productName.empty() ? "" : fmt::format(" \"{}\"", printable(usb.productName));
    return fmt::format("{:04x}:{:04x}{}, interface {} ({}/{}/{}, {} bulk end points), driver {}", usb.vendor,
                       usb.product, name, usb.number, usb.interfaceClass, usb.subclass, usb.protocol, usb.bulkEndpoints,
                       node.driver.empty() ? "none" : printable(node.driver));
}

std::string accessText(const PortAccess& access) {
    if (!access.exists) return "it is not there";
    if (access.mayOpen) return "this user may open it";
    return access.group.empty() ? "this user may not open it"
                                : fmt::format("this user may not open it: the group {} may", access.group);
}

std::string holdersText(const PortHolders& holders) {
    std::vector<std::string> names;
    for (const auto& holder : holders.known)
        names.push_back(fmt::format("{} ({})", printable(holder.name), holder.process));
    const std::string known = names.empty() ? "nobody" : fmt::format("{}", fmt::join(names, ", "));
    return holders.someHidden ? known + ", as far as this user can see" : known;
}

std::string managerText(const Findings& findings, const PortFindings& port) {
    if (port.node.ignoredByModemManager) return "leaves it alone, as a udev rule says";
    return findings.modemManagerRuns ? "runs, and may take it" : "does not run";
}

std::string rangesText(const wire::Ranges& ranges) {
    std::vector<std::string> had;
    for (std::size_t id = 0; id < ranges.size(); ++id) {
        if (ranges[id] > 0) had.push_back(fmt::format("{}: 0x{:x}", id, ranges[id]));
    }
    return had.empty() ? "none" : fmt::format("{}", fmt::join(had, ", "));
}

std::string screensText(const FillableScreens& screens) {
    const std::size_t all = screens.filled.size() + screens.partly.size() + screens.empty.size();
    std::string text =
        screens.filled.size() == all ? fmt::format("all {}", all) : fmt::format("{} of {}", screens.filled.size(), all);
    if (!screens.partly.empty()) text += fmt::format("; in part {}", fmt::join(screens.partly, ", "));
    if (!screens.empty.empty()) text += fmt::format("; not {}", fmt::join(screens.empty, ", "));
    return text;
}

std::string probeText(const ModemProbe& probe) {
    if (!probe.failure.empty()) return line("asked", probe.failure);
    std::string text =
        line("asked", fmt::format("it is \"{}\", build \"{}\"{}", printable(probe.target), printable(probe.buildId),
                                  probe.isStreaming ? ", and streams records already" : ""));
    if (!probe.ranges) return text + line("ranges", probe.rangesFailure);
    text += line("ranges", rangesText(*probe.ranges));
    for (const FillableScreens& screens : fillableScreens(*probe.ranges))
        text += line(fmt::format("{} screens", namesOf(screens.technology).name), screensText(screens));
    return text;
}

std::string portText(const Findings& findings, const PortFindings& port) {
    std::string text = fmt::format("{}: {}\n", printable(port.node.path), kindText(port));
    if (port.node.usb) text += line("USB", usbText(port.node));
    if (!port.isNetwork) {
        text += line("permission", accessText(port.access));
        if (port.access.exists) text += line("open in", holdersText(port.holders));
    }
    if (port.node.usb) text += line("modem manager", managerText(findings, port));
    if (port.probe) text += probeText(*port.probe);
    return text + "\n";
}

Json usbJson(const wire::UsbInterface& usb) {
    return {{"vendor", fmt::format("{:04x}", usb.vendor)},
            {"product", fmt::format("{:04x}", usb.product)},
            {"name", usb.productName},
            {"serial", usb.serial},
            {"interface", usb.number},
            {"class", usb.interfaceClass},
            {"subclass", usb.subclass},
            {"protocol", usb.protocol},
            {"bulkEndpoints", usb.bulkEndpoints}};
}

Json screensJson(const wire::Ranges& ranges) {
    Json json = Json::object();
    for (const FillableScreens& screens : fillableScreens(ranges))
        json[std::string(namesOf(screens.technology).name)] = {
            {"filled", screens.filled}, {"partly", screens.partly}, {"empty", screens.empty}, {"phone", screens.phone}};
    return json;
}

Json probeJson(const ModemProbe& probe) {
    if (!probe.failure.empty()) return {{"failure", probe.failure}};
    Json json{{"target", probe.target}, {"buildId", probe.buildId}, {"streams", probe.isStreaming}};
    if (!probe.ranges) {
        json["rangesFailure"] = probe.rangesFailure;
        return json;
    }
    json["ranges"] = *probe.ranges;
    json["screens"] = screensJson(*probe.ranges);
    return json;
}

Json portJson(const PortFindings& port) {
    Json json{{"port", port.node.path}, {"kind", kindWord(port)}};
    if (port.node.usb) {
        json["usb"] = usbJson(*port.node.usb);
        json["driver"] = port.node.driver;
        json["ignoredByModemManager"] = port.node.ignoredByModemManager;
    }
    if (!port.isNetwork) {
        json["exists"] = port.access.exists;
        json["mayOpen"] = port.access.mayOpen;
        json["group"] = port.access.group;
        json["openIn"] = Json::array();
        for (const auto& holder : port.holders.known)
            json["openIn"].push_back({{"process", holder.process}, {"name", holder.name}});
        json["someHidden"] = port.holders.someHidden;
    }
    if (port.probe) json["probe"] = probeJson(*port.probe);
    return json;
}

}  // namespace

std::string findingsText(const Findings& findings) {
    std::string text;
    for (const PortFindings& port : findings.ports) text += portText(findings, port);
    if (findings.ports.empty()) text = "There is no serial port that a modem may be behind.\n\n";
    if (findings.phone) text += phoneFindingsText(*findings.phone);
    return text + "Next: " + printable(nextStep(findings)) + "\n";
}

Json findingsJson(const Findings& findings) {
    Json ports = Json::array();
    for (const PortFindings& port : findings.ports) ports.push_back(portJson(port));
    Json json{{"ports", std::move(ports)}, {"modemManagerRuns", findings.modemManagerRuns}};
    if (findings.phone) json["modemManager"] = phoneFindingsJson(*findings.phone);
    json["next"] = nextStep(findings);
    return json;
}

}  // namespace kelvo
