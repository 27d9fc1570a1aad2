#include "tools/doctor/Doctor.h"

#include <algorithm>
#include <filesystem>

namespace kelvo {
namespace {

bool isNetworkPlace(const std::string& place) { return place.starts_with("tcp:") || place.starts_with("unix:"); }

// The candidate that a path, which may be a link, leads to; a node that is none is taken as it is.
wire::CandidateNode nodeAt(const std::string& place, const std::vector<wire::CandidateNode>& candidates) {
    std::error_code ignored;
    const std::string path = std::filesystem::weakly_canonical(place, ignored).string();
    const auto known = std::ranges::find(candidates, path, &wire::CandidateNode::path);
    wire::CandidateNode node = known != candidates.end() ? *known : wire::CandidateNode{};
    node.path = place;
    return node;
}

PortFindings look(const DoctorInputs& inputs, wire::CandidateNode node, bool probe) {
    PortFindings port;
    port.node = std::move(node);
    port.isNetwork = isNetworkPlace(port.node.path);
    if (!port.isNetwork) {
        port.access = inputs.access(port.node.path);
        port.holders = inputs.holders(port.node.path);
    }
    const bool isFree = port.isNetwork || (port.access.mayOpen && port.holders.known.empty());
    if (probe && isFree) port.probe = inputs.probe(port.node.path);
    return port;
}

}  // namespace

Findings examine(const DoctorInputs& inputs, const std::optional<std::string>& place, bool probe) {
    Findings findings;
    findings.user = inputs.user;
    findings.modemManagerRuns = inputs.modemManagerRuns();
    if (findings.modemManagerRuns) findings.phone = inputs.phone();
    const bool named = place && *place != "auto";
    if (named && isNetworkPlace(*place)) {
        findings.ports.push_back(look(inputs, {.path = *place, .usb = {}, .driver = {}}, probe));
    } else if (named) {
        findings.ports.push_back(look(inputs, nodeAt(*place, inputs.candidates()), probe));
    } else {
        for (const wire::CandidateNode& node : inputs.candidates())
            findings.ports.push_back(look(inputs, node, probe && node.kind != wire::CandidateNode::Kind::Other));
    }
    return findings;
}

}  // namespace kelvo
