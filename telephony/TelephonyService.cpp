#include "telephony/TelephonyService.h"

#include <fmt/format.h>
#include <unistd.h>

#include <algorithm>

#include "platform/system/Environment.h"
#include "telephony/Answer.h"

namespace kelvo {
namespace {

// The text of a request's only entry, `key`; none when it is another request.
std::optional<std::string> parseRequest(ByteView message, std::string_view key) {
    const auto read = readPropertyList(message);
    if (!read || !read->dictionary() || read->dictionary()->size() != 1) return std::nullopt;
    const std::string* text = (*read->dictionary())[key].string();
    return text != nullptr ? std::optional(*text) : std::nullopt;
}

Value describe(const RecordRates::Rate& rate) {
    const auto entry =
        Dictionary::make({{"Records", static_cast<std::int64_t>(rate.records)}, {"PerSecond", rate.perSecond}});
    if (rate.code) entry->set("Code", std::int64_t{*rate.code});
    return entry;
}

Value describe(const LogChannel& channel) {
    const auto number = [](std::size_t count) { return static_cast<std::int64_t>(count); };
    return Dictionary::make({{"Name", channel.clientName()},
                             {"Streaming", channel.isStreaming()},
                             {"Delivered", number(channel.delivered())},
                             {"Waiting", number(channel.waiting())},
                             {"Dropped", number(channel.dropped())}});
}

Bytes refuse(long error, const char* reason) {
    logLine(Level::Error, "Refused a log channel: %s", reason);
    return errorAnswer(error);
}

}  // namespace

TelephonyService::TelephonyService(MessagePorts& ports, RecordSource& source, Limits limits, SteadyTime now)
    : _ports(ports), _source(source), _limits(limits), _rates(std::move(now)) {}

Result<void> TelephonyService::open() {
    auto made = _ports.createLocal(kPLTelephonyServicePort,
                                   [this](std::int32_t id, ByteView message) { return handle(id, message); });
    if (made.alreadyExisted) {
        return Failure{"another telephony service is running" +
                       (made.owner > 0 ? fmt::format(" (process {})", made.owner) : "")};
    }
    if (!made.port) return Failure{fmt::format("cannot make the port {}", kPLTelephonyServicePort)};
    _controlPort = std::move(made.port);
    _controlPort->schedule();
    return {};
}

Bytes TelephonyService::handle(std::int32_t id, ByteView message) {
    if (id == 0) {
        if (const auto clientName = parseRequest(message, kPLCreateLogChannel)) return createLogChannel(*clientName);
        if (parseRequest(message, kPLGetStatus)) return status();
    }
    return refuse(kPLErrorBadRequest, "the request is not understood");
}

Bytes TelephonyService::status() const {
    const auto codes = Array::make({});
    std::uint64_t records = 0;
    for (const RecordRates::Rate& rate : _rates.rates()) {
        codes->append(describe(rate));
        records += rate.records;
    }
    const auto clients = Array::make({});
    for (const LogChannel& channel : _channels) clients->append(describe(channel));
    const auto technology = _source.technology();
    const auto answer = Dictionary::make({{"Source", _source.description()},
                                          {"Technology", technology ? namesOf(*technology).name : "not known yet"},
                                          {"Records", static_cast<std::int64_t>(records)},
                                          {"Codes", codes},
                                          {"Clients", clients}});
    if (auto state = _source.state(); !state.empty()) answer->set("State", std::move(state));
    if (auto port = _source.portStatus()) answer->set("Port", std::move(port));
    if (auto phone = _source.phoneStatus()) answer->set("Phone", std::move(phone));
    return encodeAnswer(answer);
}

Bytes TelephonyService::createLogChannel(const std::string& clientName) {
    _channels.remove_if([](const LogChannel& channel) { return !channel.hasClient(); });  // it may be back already
    tellWishes();
    if (!hasRoomFor(clientName)) return refuse(kPLErrorTooManyChannels, "there are too many");
    // The service must not deliver to itself.
    auto client = clientName.starts_with(kPLTelephonyServicePort) ? nullptr : _ports.openRemote(clientName);
    if (!client) return refuse(kPLErrorPortUnreachable, "the client's port cannot be opened");
    LogChannel::Owner& owner = *this;
    _channels.emplace_back(_source.technology(), clientName, std::move(client), owner, _limits.queue);
    // With the process in it, no port of a service that ran before is mistaken for this one's.
    const std::string name = fmt::format("{}.LogChannel.{}.{}", kPLTelephonyServicePort, ::getpid(), ++_channelsMade);
    if (!_channels.back().open(_ports, name)) {
        _channels.pop_back();
        return refuse(kPLErrorNoPort, "its port cannot be made");
    }
    return encodeAnswer({{kPLError, 0}, {kPLErrorDomain, 0}, {kPLPortName, name}});
}

bool TelephonyService::hasRoomFor(const std::string& clientName) const {
    const auto ofClient = std::count_if(_channels.begin(), _channels.end(),
                                        [&](const LogChannel& channel) { return channel.clientName() == clientName; });
    return _channels.size() < _limits.channels && static_cast<std::size_t>(ofClient) < _limits.channelsPerClient;
}

bool TelephonyService::take(ByteView record) {
    const auto technology = _source.technology();
    _rates.count(!technology || hasCodes(*technology) ? codeOf(record) : std::nullopt);
    bool taken = false;
    for (LogChannel& channel : _channels) taken |= channel.take(record);
    return taken;
}

bool TelephonyService::isHungry() const {
    return std::any_of(_channels.begin(), _channels.end(),
                       [](const LogChannel& channel) { return channel.isHungry(); });
}

std::optional<Technology> TelephonyService::technologyForChannel() {
    if (!_source.technology()) _source.findTechnology();
    return _source.technology();
}

void TelephonyService::channelStreams(LogChannel&) {
    if (std::exchange(_started, true)) return _source.feed();
    _source.start(*this);
}

void TelephonyService::channelWants(LogChannel&) { tellWishes(); }

void TelephonyService::channelIsHungry(LogChannel&) { _source.feed(); }

void TelephonyService::channelLostClient(LogChannel& channel) {
    _channels.remove_if([&](const LogChannel& other) { return &other == &channel; });
    tellWishes();
}

void TelephonyService::tellWishes() {
    ClientsWishes wishes;
    for (const LogChannel& channel : _channels) {
        if (!channel.isStreaming() || !channel.hasClient()) continue;
        wishes.streaming = true;
        if (const auto& codes = channel.filter().ordinaryCodes()) wishes.ordinary |= *codes;
    }
    if (wishes == _wishes) return;
    _wishes = wishes;
    _source.clientsWant(_wishes);
}

}  // namespace kelvo
