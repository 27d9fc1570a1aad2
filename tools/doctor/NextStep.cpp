#include <fmt/format.h>

#include <algorithm>

#include "tools/doctor/Findings.h"

namespace kelvo {
namespace {

using Kind = wire::CandidateNode::Kind;

constexpr const char* kService = "kelvo-telephonyd";
constexpr const char* kManager = "ModemManager";

const PortHolders::Holder* holderOtherThanManager(const PortFindings& port) {
    const auto other =
        std::ranges::find_if(port.holders.known, [](const auto& holder) { return holder.name != kManager; });
    return other != port.holders.known.end() ? &*other : nullptr;
}

bool managerIsInTheWay(const Findings& findings, const PortFindings& port) {
    const bool has =
        std::ranges::any_of(port.holders.known, [](const auto& holder) { return holder.name == kManager; });
    return has || (port.node.usb && findings.modemManagerRuns && !port.node.ignoredByModemManager);
}

std::string installRule(const wire::CandidateNode& node) {
    if (!node.usb) return fmt::format("run \"sudo chgrp dialout {0} && sudo chmod g+rw {0}\"", node.path);
    return fmt::format(
        "run \"kelvoctl doctor --port {} --udev-rule | sudo tee /etc/udev/rules.d/78-kelvo-modem.rules\", and plug the "
        "modem in again",
        node.path);
}

std::string letIn(const Findings& findings, const PortFindings& port) {
    if (port.access.group.empty()) return installRule(port.node);
    return fmt::format("add yourself to the group {0}: run \"sudo usermod -aG {0} {1}\", and log in again",
                       port.access.group, findings.user);
}

// The next port that nobody has asked yet; none when there is none.
const PortFindings* anotherCandidate(const Findings& findings) {
    const auto next = std::ranges::find_if(findings.ports, [](const PortFindings& port) {
        return !port.probe && port.node.kind != Kind::Other && !port.isNetwork;
    });
    return next != findings.ports.end() ? &*next : nullptr;
}

std::string afterSilence(const Findings& findings, const PortFindings& port) {
    if (const auto* next = anotherCandidate(findings))
        return fmt::format("try another port: run \"kelvoctl doctor --port {} --probe\"", next->node.path);
    if (port.isNetwork) return fmt::format("see what listens on {}: it is no diagnostic port", port.node.path);
    return fmt::format("try another port of the modem than {}, or plug it in again", port.node.path);
}

// Of several the one that answers, and else the first.
const PortFindings& chosen(const Findings& findings) {
    const auto answers = std::ranges::find_if(
        findings.ports, [](const PortFindings& port) { return port.probe && port.probe->failure.empty(); });
    return answers != findings.ports.end() ? *answers : findings.ports.front();
}

}  // namespace

std::string nextStep(const Findings& findings) {
    if (findings.ports.empty() && findings.phone && !findings.phone->modems.empty())
        return fmt::format("run \"{} --modemmanager\", and then kelvo", kService);
    if (findings.ports.empty())
        return "plug a modem in and run this again, or name its port: run \"kelvoctl doctor --port "
               "PATH|tcp:HOST:PORT|unix:PATH\"";
    const PortFindings& port = chosen(findings);
    const std::string& path = port.node.path;
    if (port.probe && port.probe->failure.empty())
        return fmt::format("run \"{} --port {}\", and then kelvo", kService, path);
    if (!port.isNetwork && !port.access.exists) return fmt::format("plug the modem in: {} is not there", path);
    if (!port.isNetwork && !port.access.mayOpen) return letIn(findings, port);
    if (const auto* holder = holderOtherThanManager(port)) {
        if (holder->name == kService) return fmt::format("run kelvo: its telephony service has {} already", path);
        return fmt::format("end {} (process {}), which has {} open", holder->name, holder->process, path);
    }
    if (managerIsInTheWay(findings, port)) return installRule(port.node);
    if (port.probe) return afterSilence(findings, port);
    return fmt::format("run \"kelvoctl doctor --port {} --probe\", which asks it what it can show", path);
}

std::string udevRule(const wire::CandidateNode& node) {
    const wire::UsbInterface& usb = *node.usb;
    return fmt::format(
        "# The diagnostic port of the modem {0:04x}:{1:04x}, interface {2}, for Kelvo: gives it to the group dialout, "
        "and\n"
        "# tells the modem manager to leave it alone.\n"
        "ACTION!=\"remove\", SUBSYSTEM==\"tty\", ENV{{ID_VENDOR_ID}}==\"{0:04x}\", ENV{{ID_MODEL_ID}}==\"{1:04x}\", "
        "ENV{{ID_USB_INTERFACE_NUM}}==\"{2:02x}\", GROUP=\"dialout\", MODE=\"0660\", ENV{{ID_MM_PORT_IGNORE}}=\"1\"\n",
        usb.vendor, usb.product, usb.number);
}

}  // namespace kelvo
