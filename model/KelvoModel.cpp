#include "model/KelvoModel.h"

#include "LogGenerator/Factory.h"
#include "platform/system/Environment.h"
#include "platform/telephony/LogChannelProtocol.h"
#include "platform/telephony/TelephonyProtocol.h"

namespace kelvo {

using namespace std::chrono_literals;
using State = Connection::State;

namespace {

constexpr auto kSendLimit = 1s;
constexpr auto kReplyLimit = 1s;
constexpr std::size_t kRawLogLimit = std::size_t{4} * 1024 * 1024;  // many times what a modem says in two seconds

Value technologyQuery() { return Dictionary::make({{kPLGetTechnology, kPLGetTechnology}}); }

const void* addressOf(const auto& owner) { return static_cast<const void*>(owner.get()); }

}  // namespace

KelvoModel::KelvoModel(Services services) : _services(std::move(services)) {}

KelvoModel::~KelvoModel() { destroyPorts(); }

/// Writes the line that tells of a failure, and keeps in mind what it was. Always false.
template <class... Args>
bool KelvoModel::failed(State obstacle, const char* format, const Args&... args) {
    _obstacle = obstacle;
    logLine(Level::Error, format, args...);
    return false;
}

bool KelvoModel::createPorts() {
    MessagePorts::Local local = _services.ports.createLocal(_services.portName, [this](std::int32_t id, ByteView data) {
        didReceive(id, data);
        return Bytes();
    });
    _recvPort = std::move(local.port);
    if (local.alreadyExisted) return failed(State::PortTaken, "Local messsage port already exists");
    if (!_recvPort) return failed(State::NoPort, "Could not create local message port");
    _recvPort->schedule();
    _recvPort->setInvalidationCallback(_lifetime.whileAlive([this](LocalPort& port) { didInvalidate(port); }));
    return openLogChannel();
}

bool KelvoModel::openLogChannel() {
    auto server =
        _services.telephony.createServerConnection(_lifetime.whileAlive([this](std::string_view) { refresh(); }));
    if (!server) return failed(State::NoService, "Could not create PLServerConnection");
    const PLLogChannel channel = PLServerConnectionNetworkMonitorCreateLogChannel(*server, _services.portName);
    server.reset();
    if (channel.error.error != 0) {
        const bool answered = channel.error.domain != kPLErrorDomainClient;
        return failed(answered ? State::Refused : State::NoAnswer,
                      "_PLServerConnectionNetworkMonitorCreateLogChannel returns error: %ld!", channel.error.error);
    }
    if (channel.portName.empty()) {
        return failed(State::Refused, "Could not create a log channel (PL returned null port)!");
    }
    _sendPort = _services.ports.openRemote(channel.portName);
    if (!_sendPort) return failed(State::NoAnswer, "Could not create the remote port!");
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
    const auto reply = _sendPort->request(kPLLogChannelMessageId, *query, kSendLimit, kReplyLimit);
    if (!reply) {
        failed(State::NoAnswer, " ***** Could not send the GetTechnology command (got error=%d)",
               static_cast<int>(reply.error()));
        return;
    }
    if (reply->empty()) {
        failed(State::NoAnswer, " ***** No response to GetTechnology; cannot configure");
        return;
    }
    const Result<Value> answer = readPropertyList(*reply);
    if (!answer) {
        failed(State::UnknownTechnology, " ***** Could not parse reply to GetTechnology; cannot configure");
        return;
    }
    chooseGenerator(*answer);
}

void KelvoModel::chooseGenerator(const Value& answer) {
    _obstacle = State::UnknownTechnology;
    const Value* technology = answer.dictionary() ? answer.dictionary()->find(kPLGetTechnology) : nullptr;
    if (technology == nullptr) {
        logLine(Level::Error, " ***** Reply to GetTechnology had no answer; cannot configure");
        return;
    }
    if (_logGenerator) {
        _logGenerator->limitRawLog(0);  // it stays, its records need not
        _replacedGenerators.push_back(std::move(_logGenerator));
    }
    const std::string* identifier = technology->string();
    _logGenerator = identifier != nullptr ? generatorFromTechnology(*identifier) : nullptr;
    if (_logGenerator) _logGenerator->limitRawLog(kRawLogLimit);
    if (_logGenerator) _spokenTechnology = technologyBy(&TechnologyNames::identifier, std::string_view(*identifier));
    if (!_technology) _technology = _spokenTechnology;
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
        _services.queue.postAfter(5s, _lifetime.whileAlive([this] { startMonitor(); }));
        return tellConnection();
    }
    logLine(Level::Error, "Starting the display update timer");
    _displayUpdateTimer = _services.queue.repeat(2s, _lifetime.whileAlive([this] { refresh(); }));
    _receiving = false;
    _silentSince = _services.queue.now();
    ++_connectionCount;
    tellConnection();
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
    const auto sent = _sendPort->request(kPLLogChannelMessageId, *command, kSendLimit, std::nullopt);
    if (sent) return true;
    return failed(State::NoAnswer, " ***** Could not send the START command (got error=%d)",
                  static_cast<int>(sent.error()));
}

void KelvoModel::refresh() {
    if (_sendPort && _recvPort && !_sendPort->isValid()) loseService();
    if (_displayUpdateTimer) tellConnection();
    if (!_updated) return;
    _updated = false;
    _nodes.reset();
    _nodesByPath.clear();
    _services.queue.post(_lifetime.whileAlive([this] { _services.updateViewControllerFromModel(); }));
}

void KelvoModel::refresh(const Value&) { refresh(); }

/// The port that the service delivered to ends with it, as if it had ended by itself.
void KelvoModel::loseService() {
    _recvPort->setInvalidationCallback(nullptr);
    _recvPort->invalidate();
    didInvalidate(*_recvPort);
}

bool KelvoModel::isConnected() const { return _recvPort && _sendPort; }

Connection KelvoModel::connection() const {
    if (!_displayUpdateTimer) return {.state = _obstacle};
    return {.state = _receiving ? State::Receiving : State::NoRecordYet,
            .silence = _services.queue.now() - _silentSince};
}

void KelvoModel::tellConnection() {
    const Connection now = connection();
    Told told{.isConnected = now.isConnected(), .text = connectionText(now)};
    if (told == _told) return;
    _told = std::move(told);
    if (_services.connectionChanged)
        _services.queue.post(_lifetime.whileAlive([this] { _services.connectionChanged(); }));
}

NodeRef KelvoModel::topLevelNodes() {
    if (!_nodes) rebuildNodes();
    return _nodes;
}

void KelvoModel::rebuildNodes() {
    if (!_logGenerator) return;
    const Value display = _logGenerator->generateLogUsingState(*_state);  // which takes a snapshot
    _nodes = KelvoModelNode::makeTreeFromObject(display, _nodesByPath);
    _trends.note(display, trendTime());
}

Trends::Time KelvoModel::trendTime() const { return std::chrono::duration_cast<Trends::Time>(_services.queue.now()); }

NodeRef KelvoModel::nodeAtPath(const std::string& path) {
    if (!_nodes) rebuildNodes();
    return _nodesByPath.find(path);
}

void KelvoModel::updateWithData(ByteView data) {
    const std::chrono::nanoseconds now = _services.queue.now();
    if (_logGenerator) {
        if (_records.isFull()) _records.forgetAllBut((*_state)["Display"]);
        const ByteView packet = _logGenerator->takesPackets() ? RecordLedger::packetOf(data) : ByteView();
        const RecordLedger::Counted counted(_records, packet, now);
        _logGenerator->updateState(*_state, data);
        if (_services.recordShown) _services.recordShown(data);
    }
    _updated = true;
    _receiving = true;
    _silentSince = now;
}

std::optional<Provenance> KelvoModel::provenance(const KelvoModelNode& node) const {
    auto provenance = provenanceOf(node.record(), _records, _services.queue.now());
    if (provenance && node.reading() != nullptr) provenance->place = node.reading()->place;
    return provenance;
}

ArrayRef KelvoModel::getSaveContents() {
    return _logGenerator ? _logGenerator->getSaveContentsFromState(*_state) : nullptr;
}

void KelvoModel::didReceive(std::int32_t id, ByteView data) {
    if (id == kPLLogChannelMessageId) updateWithData(data);
}

void KelvoModel::didInvalidate(const LocalPort& port) {
    logLine(Level::Error, " ***** INVALIDATED %p *****", static_cast<const void*>(&port));
    restartMonitor();
}

}  // namespace kelvo
