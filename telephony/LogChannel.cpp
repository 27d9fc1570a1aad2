#include "telephony/LogChannel.h"

#include <utility>

#include "platform/system/Environment.h"
#include "platform/telephony/LogChannelProtocol.h"
#include "telephony/Answer.h"
#include "telephony/ChannelCommand.h"

namespace kelvo {
namespace {

constexpr int kRecordsPerTurn = 512;

}  // namespace

LogChannel::LogChannel(std::optional<Technology> technology, std::string clientName, std::unique_ptr<RemotePort> client,
                       Owner& owner, ClientQueue::Limits limits)
    : _technology(technology),
      _clientName(std::move(clientName)),
      _client(std::move(client)),
      _owner(owner),
      _queue(limits) {
    settleTechnology();
    _client->setInvalidationCallback([this](RemotePort&) { _owner.channelLostClient(*this); });
}

LogChannel::~LogChannel() { tellLost(); }

bool LogChannel::open(MessagePorts& ports, const std::string& name) {
    _port = ports.createLocal(name, [this](std::int32_t id, ByteView message) { return handle(id, message); }).port;
    if (_port) _port->schedule();
    return _port != nullptr;
}

Bytes LogChannel::handle(std::int32_t id, ByteView message) {
    if (id != kPLLogChannelMessageId) return refuse(fmt::format("its id is {}", id));
    const auto command = ChannelCommand::parse(message);
    if (!command) return refuse(command.error().reason);
    if (command->unknownKeys > 0)
        logLine(Level::Warning, "Client %s asked for %d unknown things", _clientName, command->unknownKeys);
    if (command->ordinaryCodes) _filter.setOrdinaryCodes(command->ordinaryCodes);
    if (command->extendedCodes) _filter.setExtendedCodes(command->extendedCodes);
    if (command->startStreaming) {
        _streaming = true;
        _owner.channelStreams(*this);
    }
    if (_streaming) _owner.channelWants(*this);
    return command->getTechnology ? answerTechnology() : Bytes();
}

// A client that is told an error asks again, on a channel of its own.
Bytes LogChannel::answerTechnology() {
    if (!_technology) {
        _technology = _owner.technologyForChannel();
        settleTechnology();
    }
    if (!_technology) return errorAnswer(kPLErrorTechnologyUnknown);
    return encodeAnswer({{kPLGetTechnology, namesOf(*_technology).identifier}});
}

void LogChannel::settleTechnology() {
    if (_technology && !hasCodes(*_technology)) _filter.passEverything();
}

Bytes LogChannel::refuse(const std::string& reason) {
    logLine(Level::Error, "Dropped a command of client %s: %s", _clientName, reason);
    return errorAnswer(kPLErrorBadRequest);
}

bool LogChannel::take(ByteView record) {
    if (!_streaming || !_filter.passes(record)) return false;
    if (!_queue.empty() || !send(record)) _queue.push(record);
    return true;
}

// False when the client has to read first; then flush() goes on once it has.
bool LogChannel::send(ByteView record) {
    const auto sent = _client->request(kPLLogChannelMessageId, record, {}, std::nullopt);
    if (sent) ++_delivered;
    if (sent || sent.error() == RemotePort::Error::Invalid) return true;  // a client that has gone reports itself
    if (sent.error() == RemotePort::Error::TooLong) {
        logLine(Level::Error, "Dropped a record of %d bytes: it is too long", record.size());
        return true;
    }
    _client->notifyWhenWritable([this] { flush(); });
    return false;
}

void LogChannel::flush() {
    for (int i = 0; i < kRecordsPerTurn && !_queue.empty(); ++i) {
        if (!send(_queue.front())) return;
        _queue.pop();
    }
    if (!_queue.empty()) return _client->notifyWhenWritable([this] { flush(); });
    tellLost();
    _owner.channelIsHungry(*this);
}

void LogChannel::tellLost() {
    if (const std::size_t lost = _queue.takeLost(); lost > 0)
        logLine(Level::Warning, "Client %s was too slow and lost %d records", _clientName, lost);
}

}  // namespace kelvo
