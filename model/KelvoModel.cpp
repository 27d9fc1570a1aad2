#include "model/KelvoModel.h"

#include "platform/system/Environment.h"

namespace kelvo {

using namespace std::chrono_literals;

namespace {

constexpr std::int32_t kMessageId = 0;  // of every message on the log channel, in both directions
constexpr auto kSendLimit = 1s;
constexpr auto kReplyLimit = 1s;
constexpr std::size_t kRawLogLimit = std::size_t{4} * 1024 * 1024;  // many times what a modem says in two seconds

Value technologyQuery() { return Dictionary::make({{"GetTechnology", "GetTechnology"}}); }

const void* addressOf(const auto& owner) { return static_cast<const void*>(owner.get()); }

}  // namespace

/// `work` as a callback that others may keep for as long as they like: it does nothing once the model has gone.
template <class Work>
auto KelvoModel::whileAlive(Work work) const {
    return [alive = std::weak_ptr(_alive), work](auto&&... arguments) {
        if (!alive.expired()) work(arguments...);
    };
}

KelvoModel::KelvoModel(Services services) : _services(std::move(services)) {}

KelvoModel::~KelvoModel() { destroyPorts(); }

bool KelvoModel::createPorts() {
    MessagePorts::Local local = _services.ports.createLocal(_services.portName, [this](std::int32_t id, ByteView data) {
        didReceive(id, data);
        return Bytes();
    });
    _recvPort = std::move(local.port);
    if (local.alreadyExisted) {
        logLine(Level::Error, "Local messsage port already exists");
        return false;
    }
    if (!_recvPort) {
        logLine(Level::Error, "Could not create local message port");
        return false;
    }
    _recvPort->schedule();
    _recvPort->setInvalidationCallback(whileAlive([this](LocalPort& port) { didInvalidate(port); }));
    return openLogChannel();
}

bool KelvoModel::openLogChannel() {
    auto server = _services.telephony.createServerConnection(whileAlive([this](std::string_view) { refresh(); }));
    if (!server) {
        logLine(Level::Error, "Could not create PLServerConnection");
        return false;
    }
    const PLLogChannel channel = PLServerConnectionNetworkMonitorCreateLogChannel(*server, _services.portName);
    server.reset();
    if (channel.error.error != 0) {
        logLine(Level::Error, "_PLServerConnectionNetworkMonitorCreateLogChannel returns error: %ld!",
                channel.error.error);
        return false;
    }
    if (channel.portName.empty()) {
        logLine(Level::Error, "Could not create a log channel (PL returned null port)!");
        return false;
    }
    _sendPort = _services.ports.openRemote(channel.portName);
    if (!_sendPort) {
        logLine(Level::Error, "Could not create the remote port!");
        return false;
    }
    logLine(Level::Error, " ***** Created ports (send=%p, recv=%p)", addressOf(_sendPort), addressOf(_recvPort));
    return true;
}

void KelvoModel::destroyPorts() {
    _displayUpdateTimer.reset();
    // Without its callback a port goes quietly: a deliberate teardown must not restart the monitor.
    if (_recvPort) {
        _recvPort->setInvalidationCallback(nullptr);
        _recvPort->invalidate();
        _recvPort.reset();
    }
    if (_sendPort) {
        _sendPort->setInvalidationCallback(nullptr);
        _sendPort->invalidate();
        _sendPort.reset();
    }
}

void KelvoModel::configureGenerator() {
    const Result<Bytes> query = _services.encode(technologyQuery());
    if (!query) {
        logLine(Level::Error, " Could not generate GetTechnology command; cannot configure");
        return;
    }
    const auto reply = _sendPort->request(kMessageId, *query, kSendLimit, kReplyLimit);
    if (!reply) {
        logLine(Level::Error, " ***** Could not send the GetTechnology command (got error=%d)",
                static_cast<int>(reply.error()));
        return;
    }
    if (reply->empty()) {
        logLine(Level::Error, " ***** No response to GetTechnology; cannot configure");
        return;
    }
    const Result<Value> answer = readPropertyList(*reply);
    if (!answer) {
        logLine(Level::Error, " ***** Could not parse reply to GetTechnology; cannot configure");
        return;
    }
    chooseGenerator(*answer);
}

void KelvoModel::chooseGenerator(const Value& answer) {
    const Value* technology = answer.dictionary() ? answer.dictionary()->find("GetTechnology") : nullptr;
    if (technology == nullptr) {
        logLine(Level::Error, " ***** Reply to GetTechnology had no answer; cannot configure");
        return;
    }
    if (_logGenerator) {
        _logGenerator->limitRawLog(0);  // it stays, its records need not
        _replacedGenerators.push_back(std::move(_logGenerator));
    }
    const std::string* identifier = technology->string();
    _logGenerator = identifier != nullptr ? LogGenerator::generatorFromTechnology(*identifier) : nullptr;
    if (_logGenerator) _logGenerator->limitRawLog(kRawLogLimit);
    logLine(Level::Error, "Got log generated: %p", addressOf(_logGenerator));
}

void KelvoModel::restartMonitor() {
    destroyPorts();
    startMonitor();
}

void KelvoModel::startMonitor() {
    if (_displayUpdateTimer) return;
    if (!startStreaming()) {
        destroyPorts();
        _services.queue.postAfter(5s, whileAlive([this] { startMonitor(); }));
        return;
    }
    logLine(Level::Error, "Starting the display update timer");
    _displayUpdateTimer = _services.queue.repeat(2s, whileAlive([this] { refresh(); }));
}

bool KelvoModel::startStreaming() {
    if (!createPorts()) {
        logLine(Level::Error, "Could not create the ports necessary");
        return false;
    }
    configureGenerator();
    if (!_logGenerator) {
        logLine(Level::Error, "No log generator technology works");
        return false;
    }
    const Result<Bytes> command = _services.encode(_logGenerator->getStartCommand());
    if (!command) {
        logLine(Level::Error, " Could not generate PLIST");
        return false;
    }
    const auto sent = _sendPort->request(kMessageId, *command, kSendLimit, std::nullopt);
    if (!sent) {
        logLine(Level::Error, " ***** Could not send the START command (got error=%d)", static_cast<int>(sent.error()));
    }
    return static_cast<bool>(sent);
}

void KelvoModel::refresh() {
    bool lost = false;
    if (_sendPort && _recvPort && !_sendPort->isValid()) {
        _recvPort->invalidate();  // whose callback restarts
        lost = !isConnected();
    }
    if (!_updated && !(lost && _nodes)) return;
    if (_updated) {
        _updated = false;
        _nodes.reset();
        _nodesByPath.clear();
    }
    // A lost connection is told even when nothing new has come: screens with values must not pass for current.
    _services.queue.post(whileAlive([this] { _services.updateViewControllerFromModel(); }));
}

void KelvoModel::refresh(const Value&) { refresh(); }

bool KelvoModel::isConnected() const { return _recvPort && _sendPort; }

NodeRef KelvoModel::topLevelNodes() {
    if (!_nodes && _logGenerator) {
        _nodes = KelvoModelNode::makeTreeFromObject(_logGenerator->generateLogUsingState(*_state), _nodesByPath);
    }
    return _nodes;
}

NodeRef KelvoModel::nodeAtPath(const std::string& path) {
    if (!_nodes) topLevelNodes();
    return _nodesByPath.find(path);
}

void KelvoModel::updateWithData(ByteView data) {
    if (_logGenerator) _logGenerator->updateState(*_state, data);
    _updated = true;
}

ArrayRef KelvoModel::getSaveContents() {
    return _logGenerator ? _logGenerator->getSaveContentsFromState(*_state) : nullptr;
}

void KelvoModel::didReceive(std::int32_t id, ByteView data) {
    if (id == kMessageId) updateWithData(data);
}

void KelvoModel::didInvalidate(const LocalPort& port) {
    logLine(Level::Error, " ***** INVALIDATED %p *****", static_cast<const void*>(&port));
    restartMonitor();
}

}  // namespace kelvo
