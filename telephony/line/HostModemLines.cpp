#include "telephony/line/HostModemLines.h"

#include <fmt/format.h>
#include <sys/stat.h>
#include <sys/sysmacros.h>

#include <algorithm>
#include <cerrno>
#include <filesystem>
#include <system_error>

#include "telephony/line/DeviceLine.h"
#include "telephony/line/SocketLine.h"
#include "telephony/wire/CandidateFinder.h"

namespace kelvo {
namespace {

constexpr unsigned kFirstPseudoTerminal = 136;
constexpr unsigned kLastPseudoTerminal = 143;

// A character device that speaks as a terminal does, by what the system says of its number.
bool isTerminal(dev_t device) {
    if (major(device) >= kFirstPseudoTerminal && major(device) <= kLastPseudoTerminal) return true;
    std::error_code error;
    const auto subsystem = std::filesystem::read_symlink(
        fmt::format("/sys/dev/char/{}:{}/subsystem", major(device), minor(device)), error);
    return subsystem.filename() == "tty";
}

}  // namespace

Result<std::unique_ptr<ModemLine>> HostModemLines::next(ModemLine::Listener& listener, bool again) {
    if (const auto* node = std::get_if<PortAddress::Node>(&_address.place)) return toNode(node->path, listener);
    if (const auto* tcp = std::get_if<PortAddress::Tcp>(&_address.place))
        return SocketLine::toTcp(tcp->host, tcp->port, listener);
    if (const auto* socket = std::get_if<PortAddress::Unix>(&_address.place))
        return SocketLine::toUnix(socket->path, listener);
    return nextCandidate(listener, again);
}

Result<std::unique_ptr<ModemLine>> HostModemLines::nextCandidate(ModemLine::Listener& listener, bool again) {
    std::vector<wire::CandidateNode> nodes = wire::findCandidates();
    std::erase_if(nodes, [](const wire::CandidateNode& node) { return node.kind == wire::CandidateNode::Kind::Other; });
    if (nodes.empty()) return Failure{"no modem with a diagnostic port is plugged in"};
    auto chosen = std::ranges::find(nodes, _tried, &wire::CandidateNode::path);
    if (chosen != nodes.end() && !again) ++chosen;
    if (chosen == nodes.end()) chosen = nodes.begin();
    _tried = chosen->path;
    return toNode(_tried, listener);
}

Result<std::unique_ptr<ModemLine>> HostModemLines::toNode(const std::string& path,
                                                          ModemLine::Listener& listener) const {
    struct stat status {};
    if (::stat(path.c_str(), &status) != 0) return Failure{std::generic_category().message(errno)};
    if (S_ISSOCK(status.st_mode)) return SocketLine::toUnix(path, listener);
    if (!S_ISCHR(status.st_mode)) return Failure{"it is no device"};
    if (isTerminal(status.st_rdev))
        return std::unique_ptr<ModemLine>(std::make_unique<SerialLine>(path, _options, listener));
    return std::unique_ptr<ModemLine>(std::make_unique<DeviceLine>(path, listener));
}

void HostModemLines::watch(std::function<void()> changed) {
    _watch.reset();
    if (!changed) return;
    if (const auto* node = std::get_if<PortAddress::Node>(&_address.place)) _watch.emplace(node->path, changed);
    if (const auto* socket = std::get_if<PortAddress::Unix>(&_address.place)) _watch.emplace(socket->path, changed);
    if (std::holds_alternative<PortAddress::Automatic>(_address.place)) _watch.emplace("/dev/any", changed);
}

}  // namespace kelvo
