#include "tests/soak/FaultyService.h"

#include <fcntl.h>
#include <fmt/format.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <thread>
#include <tuple>

#include "platform/encodings/PropertyList.h"
#include "platform/host/HostPaths.h"
#include "platform/host/PortSocket.h"
#include "platform/telephony/TelephonyProtocol.h"
#include "telephony/Answer.h"

namespace kelvo::soak {

namespace {

using namespace std::chrono_literals;

constexpr std::pair<std::string_view, Fault> kFaults[] = {
    {"none", Fault::None},       {"late", Fault::Late},   {"garbage", Fault::Garbage},
    {"records", Fault::Records}, {"flood", Fault::Flood},
};
constexpr auto kLate = 1500ms;  // the client waits one second
constexpr int kFloodPerTurn = 512;

/// A tree as deep as readers take it, and one level more.
Bytes deepTree() {
    std::string text = "<plist>";
    for (int i = 0; i <= kMaxPropertyListDepth; ++i) text += "<array>";
    return Bytes(text.begin(), text.end());
}

}  // namespace

std::optional<Fault> faultNamed(std::string_view name) {
    for (const auto& [text, fault] : kFaults) {
        if (text == name) return fault;
    }
    return std::nullopt;
}

FaultyService::FaultyService(MainQueue& queue, MessagePorts& ports, Fault fault, Technology technology,
                             std::vector<Bytes> messages)
    : _queue(queue), _ports(ports), _fault(fault), _technology(technology), _messages(std::move(messages)) {}

bool FaultyService::open() {
    _control = _ports
                   .createLocal(kPLTelephonyServicePort,
                                [this](std::int32_t, ByteView request) { return createChannel(request); })
                   .port;
    if (!_control) return false;
    _control->schedule();
    _timer = _queue.repeat(_fault == Fault::Flood ? 5ms : 500ms, [this] { deliver(); });
    return true;
}

Bytes FaultyService::createChannel(ByteView request) {
    _clients.remove_if([](const Client& client) { return !client.records->isValid(); });
    const auto read = readPropertyList(request);
    const std::string* name =
        read && read->dictionary() ? (*read->dictionary())[kPLCreateLogChannel].string() : nullptr;
    if (name == nullptr) return errorAnswer(kPLErrorBadRequest);
    auto records = _ports.openRemote(*name);
    if (!records) return errorAnswer(kPLErrorPortUnreachable);
    Client& client = _clients.emplace_back(Client{*name, std::move(records), nullptr});
    const std::string port = fmt::format("{}.faulty.{}.{}", kPLTelephonyServicePort, ::getpid(), ++_answers);
    client.channel =
        _ports.createLocal(port, [this, &client](std::int32_t, ByteView message) { return command(client, message); })
            .port;
    if (!client.channel) return errorAnswer(kPLErrorNoPort);
    client.channel->schedule();
    return spoilt(encodeAnswer({{kPLError, 0}, {kPLErrorDomain, 0}, {kPLPortName, port}}));
}

Bytes FaultyService::command(Client& client, ByteView message) {
    const auto read = readPropertyList(message);
    if (!read || !read->dictionary()) return {};
    if ((*read->dictionary())["SetState"]) {
        client.streams = true;
        fmt::print("streaming {}\n", client.name);
        std::fflush(stdout);
        return {};
    }
    return spoilt(encodeAnswer({{"GetTechnology", namesOf(_technology).identifier}}));
}

// Every kind of wrong answer has its turn, and now and then a right one, so that all steps of a start are reached.
Bytes FaultyService::spoilt(Bytes answer) {
    if (_fault == Fault::Late) std::this_thread::sleep_for(kLate);
    if (_fault != Fault::Garbage) return answer;
    switch (_answers++ % 8) {
        case 0: return anything(64);
        case 1: return {};
        case 2: return anything(kMaxMessageSize);
        case 3: return deepTree();
        case 4: return encodeAnswer({{"GetTechnology", 7}, {kPLError, "none"}, {kPLPortName, Array::make()}});
        case 5:
            return encodeAnswer(
                {{"GetTechnology", "\x1b[2J%n%s"}, {kPLError, 0}, {kPLErrorDomain, 0}, {kPLPortName, "../../x"}});
        default: return answer;
    }
}

void FaultyService::deliver() {
    for (Client& client : _clients) {
        if (!client.streams || !client.records->isValid()) continue;
        if (_fault == Fault::Flood) {
            flood(client);
        } else {
            deliverAll(client);
        }
        if (_fault == Fault::Records) annoy(client);
    }
}

void FaultyService::deliverAll(Client& client) {
    for (const Bytes& message : _messages) std::ignore = client.records->request(0, message, {}, std::nullopt);
}

void FaultyService::flood(Client& client) {
    const Bytes longest(kMaxMessageSize, 1);
    for (int i = 0; i < kFloodPerTurn; ++i) {
        const bool longOne = i % 64 == 63;
        const Bytes& message = longOne ? longest : _messages[client.next++ % _messages.size()];
        if (!client.records->request(0, message, {}, std::nullopt)) return;
    }
}

void FaultyService::annoy(Client& client) {
    for (int i = 0; i < 40; ++i) std::ignore = client.records->request(0, mutilated(), {}, std::nullopt);
    for (int i = 0; i < 5; ++i)
        std::ignore = client.records->request(static_cast<std::int32_t>(_random()), mutilated(), {}, std::nullopt);
    const UniqueFd directory(::open(HostPaths::portDirectory().c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    const UniqueFd raw = connectToPort(directory.get(), client.name);
    for (int i = 0; raw && i < 10; ++i) {
        const Bytes datagram = anything(below(200));
        ::send(raw.get(), datagram.data(), datagram.size(), MSG_DONTWAIT | MSG_NOSIGNAL);
    }
    std::ignore = client.records->request(0, _messages.front(), {}, 0ns);  // a reply that nobody waits for
}

/// A message of the capture with bytes changed, cut off or added behind its header.
Bytes FaultyService::mutilated() {
    Bytes message = _messages[below(_messages.size())];
    for (std::size_t i = below(8); i > 0 && message.size() > 13; --i)
        message[13 + below(message.size() - 13)] = static_cast<std::uint8_t>(_random());
    if (below(2) == 0) message.resize(below(2 * message.size()));
    return message;
}

Bytes FaultyService::anything(std::size_t size) {
    Bytes bytes(size);
    std::generate(bytes.begin(), bytes.end(), [this] { return static_cast<std::uint8_t>(_random()); });
    return bytes;
}

}  // namespace kelvo::soak
