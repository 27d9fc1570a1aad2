#pragma once

#include <gtest/gtest.h>

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "platform/encodings/PropertyList.h"
#include "platform/host/HostMessagePorts.h"
#include "platform/system/Environment.h"
#include "telephony/TelephonyService.h"
#include "tests/platform/host/RawPort.h"
#include "tests/support/EventLoop.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"

namespace kelvo::test {

using Lines = std::vector<RecordingLog::Line>;

/// A modem whose records the test makes up.
class TestSource final : public RecordSource {
public:
    std::optional<Technology> technology() const override { return spoken; }
    std::string description() const override { return "a test"; }
    std::string state() const override { return condition; }
    void start(RecordSink& sink) override {
        ++starts;
        _sink = &sink;
    }
    void feed() override { ++feeds; }
    void findTechnology() override { ++searches; }
    void clientsWant(const ClientsWishes& wanted) override { wishes.push_back(wanted); }
    DictionaryRef portStatus() const override { return port; }

    bool give(ByteView record) { return _sink->take(record); }
    bool someoneIsHungry() const { return _sink->isHungry(); }

    std::optional<Technology> spoken = Technology::LTE;
    std::string condition;
    int starts = 0;
    int feeds = 0;
    int searches = 0;
    std::vector<ClientsWishes> wishes;
    DictionaryRef port;

private:
    RecordSink* _sink = nullptr;
};

/// An ordinary LTE record of code 0xB0C2 that carries a number.
inline Bytes record(std::uint32_t number, std::size_t size = 17) {
    Bytes bytes(size);
    bytes[0] = 1;
    bytes[3] = 0xC2;
    bytes[4] = 0xB0;
    for (std::size_t i = 0; i < 4; ++i) bytes[13 + i] = static_cast<std::uint8_t>(number >> (8 * i));
    return bytes;
}

inline std::uint32_t numberOf(ByteView record) {
    return record[13] | std::uint32_t{record[14]} << 8 | std::uint32_t{record[15]} << 16 |
           std::uint32_t{record[16]} << 24;
}

inline Bytes xml(DictionaryRef entries) { return *writeXmlPropertyList(std::move(entries)); }

inline const Bytes kStart = xml(Dictionary::make(
    {{"SetState", "Streaming"}, {"SetOskraLogCodes", Array::make({0xB0C2})}, {"SetPlExtraCodes", Array::make({1})}}));

/// A client on the same event loop as the service: it sends its requests on a plain socket, so as not to wait for
/// itself.
class Client {
public:
    Client(MessagePorts& ports, std::filesystem::path directory, std::string name)
        : _directory(std::move(directory)), _name(std::move(name)) {
        _port = ports
                    .createLocal(_name,
                                 [this](std::int32_t id, ByteView data) {
                                     EXPECT_EQ(id, 0);
                                     records.emplace_back(data.begin(), data.end());
                                     return Bytes{};
                                 })
                    .port;
        EXPECT_TRUE(_port);
    }
    void read() { _port->schedule(); }

    DictionaryRef requestChannel() {
        return ask("com.zorvik.TelephonyService", xml(Dictionary::make({{"CreateLogChannel", _name}})));
    }
    void openChannel() {
        const DictionaryRef answer = requestChannel();
        ASSERT_TRUE(answer);
        ASSERT_EQ((*answer)["Error"], Value(0));
        channelName = *(*answer)["PortName"].string();
        channel = connectTo(channelName);
        ASSERT_TRUE(channel);
    }
    void stream(const Bytes& start = kStart) {
        openChannel();
        tell(start);
        settle();
    }
    void tell(const Bytes& message, std::int32_t id = 0) { tellOn(channel, 0, message, id); }
    DictionaryRef askChannel(const Bytes& message, std::int32_t id = 0) { return askOn(channel, message, id); }
    DictionaryRef ask(const std::string& port, const Bytes& message, std::int32_t id = 0) {
        const UniqueFd connection = connectTo(port);
        return askOn(connection, message, id);
    }

    std::vector<Bytes> records;
    std::string channelName;
    UniqueFd channel;

private:
    UniqueFd connectTo(const std::string& port) { return rawConnect(_directory / (port + ".port")); }
    static void tellOn(const UniqueFd& connection, std::uint8_t flags, const Bytes& message, std::int32_t id) {
        ASSERT_TRUE(rawSend(connection, datagram(1, flags, id, 1, textOf(message))));
    }
    static DictionaryRef askOn(const UniqueFd& connection, const Bytes& message, std::int32_t id) {
        tellOn(connection, 1, message, id);
        if (!runUntil([&] { return rawHasData(connection); })) return nullptr;
        const auto reply = rawReceive(connection);
        const auto read = reply ? readPropertyList(ByteView(*reply).subspan(20)) : Result<Value>(Failure{"closed"});
        return read ? read->dictionary() : nullptr;
    }

    const std::filesystem::path _directory;
    const std::string _name;
    std::unique_ptr<LocalPort> _port;
};

/// The service beside a modem of the test's own, on ports of its own.
class TelephonyServiceTest : public ::testing::Test {
protected:
    void start(TelephonyService::Limits limits = {}) {
        _service = std::make_unique<TelephonyService>(_ports, _source, limits, [this] { return now; });
        ASSERT_TRUE(_service->open());
    }
    std::unique_ptr<Client> makeClient(const std::string& name) {
        return std::make_unique<Client>(_ports, _directory, name);
    }
    // What the service tells anybody who asks.
    DictionaryRef status() {
        const DictionaryRef answer = makeClient("curious")->ask("com.zorvik.TelephonyService",
                                                                xml(Dictionary::make({{"GetStatus", "GetStatus"}})));
        EXPECT_TRUE(answer);
        return answer ? answer : Dictionary::make({});
    }
    static Value errorOf(const DictionaryRef& answer) { return answer ? (*answer)["Error"] : Value("no answer"); }

    TemporaryDirectory _temporary;
    std::filesystem::path _directory = _temporary.path() / "ports";
    HostMessagePorts _ports{_directory};
    RecordingLog _log;
    Environment::Scope _scope{Environment{.log = &_log}};
    TestSource _source;
    std::unique_ptr<TelephonyService> _service;
    std::chrono::nanoseconds now{0};
};

}  // namespace kelvo::test
