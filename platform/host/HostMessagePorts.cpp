#include "platform/host/HostMessagePorts.h"

#include <utility>

#include "platform/host/HostLocalPort.h"
#include "platform/host/HostPaths.h"
#include "platform/host/HostRemotePort.h"
#include "platform/host/PortServer.h"
#include "platform/host/PrivateDirectory.h"
#include "platform/system/Environment.h"

namespace kelvo {
namespace {

bool checkName(std::string_view name) {
    if (isPortName(name)) return true;
    logLine(Level::Error, "Not a port name (%d characters)", name.size());  // hostile texts stay out of the log
    return false;
}

UniqueFd openDirectory(const std::filesystem::path& path) {
    Result<UniqueFd> opened = openPrivateDirectory(path);
    if (opened) return std::move(opened).value();
    logLine(Level::Error, "No message ports: %s", opened.error().reason);
    return {};
}

std::int64_t ownerOf(const std::filesystem::path& directory, std::string_view name) {
    const UniqueFd opened = openDirectory(directory);
    const UniqueFd connection = opened ? connectToPort(opened.get(), std::string(name)) : UniqueFd();
    return connection ? processOfPeer(connection.get()) : 0;
}

}  // namespace

HostMessagePorts::HostMessagePorts(std::filesystem::path directory) : _directory(std::move(directory)) {}
HostMessagePorts::HostMessagePorts() : HostMessagePorts(HostPaths::portDirectory()) {}

void HostMessagePorts::usePassedSocket(std::string name, UniqueFd listener) {
    _passedName = std::move(name);
    _passed = std::move(listener);
}

MessagePorts::Local HostMessagePorts::createLocal(std::string_view name, MessageCallback callback) {
    if (!checkName(name)) return {};
    UniqueFd directory = openDirectory(_directory);
    if (!directory) return {};
    UniqueFd passed = name == _passedName ? std::exchange(_passed, UniqueFd()) : UniqueFd();
    auto claim = PortClaim::take(std::move(directory), std::string(name), std::move(passed));
    if (!claim) {
        const PortRefusal& refusal = claim.error();
        if (!refusal.isTaken) logLine(Level::Error, "Cannot make port %s: %s", name, refusal.reason);
        return {nullptr, refusal.isTaken, refusal.isTaken ? ownerOf(_directory, name) : 0};
    }
    auto server = std::make_shared<PortServer>(std::move(claim).value(), std::string(name), std::move(callback));
    return {std::make_unique<HostLocalPort>(std::move(server)), false};
}

std::unique_ptr<RemotePort> HostMessagePorts::openRemote(std::string_view name) {
    if (!checkName(name)) return nullptr;
    const UniqueFd directory = openDirectory(_directory);
    if (!directory) return nullptr;
    UniqueFd connection = connectToPort(directory.get(), std::string(name));
    if (!connection) return nullptr;
    if (!isPeerOfThisUser(connection.get())) {
        logLine(Level::Error, "Port %s belongs to another user's process", name);
        return nullptr;
    }
    return std::make_unique<HostRemotePort>(std::move(connection), std::string(name));
}

}  // namespace kelvo
