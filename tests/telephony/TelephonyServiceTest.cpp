#include "telephony/TelephonyService.h"

#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

#include "platform/Environment.h"
#include "platform/PropertyList.h"
#include "platform/host/HostMessagePorts.h"
#include "tests/platform/host/RawPort.h"
#include "tests/support/EventLoop.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"

using namespace kelvo;
using test::datagram;
using test::runUntil;
using test::settle;

namespace {

using Lines = std::vector<test::RecordingLog::Line>;

// A modem whose records the test makes up.
class TestSource final : public RecordSource {
public:
    Technology technology() const override { return spoken; }
    std::string description() const override { return "a test"; }
    void start(RecordSink& sink) override {
        ++starts;
        _sink = &sink;
    }
    void feed() override { ++feeds; }

    bool give(ByteView record) { return _sink->take(record); }
    bool someoneIsHungry() const { return _sink->isHungry(); }

    Technology spoken = Technology::LTE;
    int starts = 0;
    int feeds = 0;

private:
    RecordSink* _sink = nullptr;
};

// An ordinary LTE record of code 0xB0C2 that carries a number.
Bytes record(std::uint32_t number, std::size_t size = 17) {
    Bytes bytes(size);
    bytes[0] = 1;
    bytes[3] = 0xC2;
    bytes[4] = 0xB0;
    for (std::size_t i = 0; i < 4; ++i) bytes[13 + i] = static_cast<std::uint8_t>(number >> (8 * i));
    return bytes;
}

std::uint32_t numberOf(ByteView record) {
    return record[13] | std::uint32_t{record[14]} << 8 | std::uint32_t{record[15]} << 16 |
           std::uint32_t{record[16]} << 24;
}

Bytes xml(DictionaryRef entries) { return *writeXmlPropertyList(std::move(entries)); }

const Bytes kStart = xml(Dictionary::make(
    {{"SetState", "Streaming"}, {"SetOskraLogCodes", Array::make({0xB0C2})}, {"SetPlExtraCodes", Array::make({1})}}));

// A client on the same event loop as the service: it sends its requests on a plain socket, so as not to wait for
// itself.
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
    UniqueFd connectTo(const std::string& port) { return test::rawConnect(_directory / (port + ".port")); }
    static void tellOn(const UniqueFd& connection, std::uint8_t flags, const Bytes& message, std::int32_t id) {
        ASSERT_TRUE(test::rawSend(connection, datagram(1, flags, id, 1, textOf(message))));
    }
    static DictionaryRef askOn(const UniqueFd& connection, const Bytes& message, std::int32_t id) {
        tellOn(connection, 1, message, id);
        if (!runUntil([&] { return test::rawHasData(connection); })) return nullptr;
        const auto reply = test::rawReceive(connection);
        const auto read = reply ? readPropertyList(ByteView(*reply).subspan(20)) : Result<Value>(Failure{"closed"});
        return read ? read->dictionary() : nullptr;
    }

    const std::filesystem::path _directory;
    const std::string _name;
    std::unique_ptr<LocalPort> _port;
};

class TelephonyServiceTest : public testing::Test {
protected:
    void start(TelephonyService::Limits limits = {}) {
        _service = std::make_unique<TelephonyService>(_ports, _source, limits, [this] { return now; });
        ASSERT_FALSE(_service->open());
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

    test::TemporaryDirectory _temporary;
    std::filesystem::path _directory = _temporary.path() / "ports";
    HostMessagePorts _ports{_directory};
    test::RecordingLog _log;
    Environment::Scope _scope{Environment{.log = &_log}};
    TestSource _source;
    std::unique_ptr<TelephonyService> _service;
    std::chrono::nanoseconds now{0};
};

}  // namespace

TEST_F(TelephonyServiceTest, OpensAChannelAndNamesTheTechnology) {
    start();
    auto client = makeClient("client");
    client->openChannel();
    EXPECT_EQ(client->channelName.rfind("com.zorvik.TelephonyService.LogChannel.", 0), 0U);
    const DictionaryRef answer = client->askChannel(xml(Dictionary::make({{"GetTechnology", "GetTechnology"}})));
    ASSERT_TRUE(answer);
    EXPECT_EQ(*answer, *Dictionary::make({{"GetTechnology", "kPLLogChannelTechnology_Oskra_LTE"}}));
    EXPECT_EQ(_source.starts, 0);  // nobody streams yet
    EXPECT_TRUE(_log.lines().empty());
}

TEST_F(TelephonyServiceTest, DeliversTheRecordsThatWereAskedForUnchanged) {
    start();
    auto client = makeClient("client");
    client->read();
    client->stream();
    ASSERT_EQ(_source.starts, 1);
    Bytes other = record(0);
    other[3] = 0xC1;
    Bytes extended = record(2);
    extended[0] = 255;
    extended[3] = 1;
    extended[4] = 0;
    Bytes prefixed = record(3);
    prefixed.insert(prefixed.begin(), {0x81, 0x12});
    EXPECT_TRUE(_source.give(record(1)));
    EXPECT_FALSE(_source.give(other));
    EXPECT_TRUE(_source.give(extended));
    EXPECT_TRUE(_source.give(prefixed));
    EXPECT_FALSE(_source.give(Bytes{1, 0, 0}));
    ASSERT_TRUE(runUntil([&] { return client->records.size() == 3; }));
    EXPECT_EQ(client->records, (std::vector<Bytes>{record(1), extended, prefixed}));
}

TEST_F(TelephonyServiceTest, DeliversEverythingOfATechnologyWithoutCodes) {
    _source.spoken = Technology::IFX;
    start();
    auto client = makeClient("client");
    client->read();
    client->stream(xml(Dictionary::make({{"SetState", "Streaming"}})));
    EXPECT_TRUE(_source.give(bytesOf("<plist version=\"1.0\"><dict/></plist>")));
    ASSERT_TRUE(runUntil([&] { return client->records.size() == 1; }));
}

TEST_F(TelephonyServiceTest, DeliversNothingBeforeTheStartAndNoCodeThatWasNotAskedFor) {
    start();
    auto other = makeClient("other");
    other->stream();
    auto client = makeClient("client");
    client->read();
    client->openChannel();
    _source.give(record(1));
    client->tell(xml(Dictionary::make({{"SetState", "Streaming"}})));
    settle();
    _source.give(record(2));
    client->tell(kStart);
    settle();
    _source.give(record(3));
    ASSERT_TRUE(runUntil([&] { return !client->records.empty(); }));
    EXPECT_EQ(client->records, std::vector<Bytes>{record(3)});
    EXPECT_EQ(_source.starts, 1);
}

TEST_F(TelephonyServiceTest, ServesSeveralClientsEachWithItsOwnCodes) {
    start();
    auto a = makeClient("a");
    auto b = makeClient("b");
    a->read();
    b->read();
    a->stream();
    b->stream(xml(Dictionary::make({{"SetState", "Streaming"}, {"SetOskraLogCodes", Array::make({0xB0C1, 0xB0C2})}})));
    EXPECT_NE(a->channelName, b->channelName);
    Bytes other = record(5);
    other[3] = 0xC1;
    _source.give(record(4));
    _source.give(other);
    ASSERT_TRUE(runUntil([&] { return b->records.size() == 2 && a->records.size() == 1; }));
    EXPECT_EQ(b->records, (std::vector<Bytes>{record(4), other}));
    EXPECT_EQ(a->records, std::vector<Bytes>{record(4)});
}

TEST_F(TelephonyServiceTest, ForgetsAClientThatVanishesTogetherWithItsPort) {
    start();
    auto client = makeClient("client");
    client->stream();
    EXPECT_EQ(_service->channelCount(), 1U);
    const auto file = _directory / (client->channelName + ".port");
    EXPECT_TRUE(std::filesystem::exists(file));
    client.reset();
    ASSERT_TRUE(runUntil([&] { return _service->channelCount() == 0; }));
    EXPECT_FALSE(std::filesystem::exists(file));
    EXPECT_FALSE(_source.give(record(1)));
}

TEST_F(TelephonyServiceTest, SurvivesDeliveringToAClientThatHasJustVanished) {
    start();
    auto client = makeClient("client");
    client->stream();
    client.reset();
    _source.give(record(1));  // before the service could notice
    EXPECT_EQ(_service->channelCount(), 1U);
    ASSERT_TRUE(runUntil([&] { return _service->channelCount() == 0; }));
}

TEST_F(TelephonyServiceTest, LetsAClientReconnectUnderItsName) {
    start();
    std::set<std::string> names;
    for (int i = 0; i < 10; ++i) {
        auto client = makeClient("client");
        client->openChannel();
        names.insert(client->channelName);
    }
    EXPECT_EQ(names.size(), 10U);
}

TEST_F(TelephonyServiceTest, StalledClientLosesItsOwnOldestRecordsAndNobodyElses) {
    start({.queue = {.records = 100, .bytes = 1 << 20}});
    auto healthy = makeClient("healthy");
    auto stalled = makeClient("stalled");  // reads nothing
    healthy->read();
    healthy->stream();
    stalled->stream();
    constexpr std::uint32_t kRecords = 20'000;
    for (std::uint32_t i = 0; i < kRecords; ++i) {
        _source.give(record(i));
        if (i % 200 == 0) settle();
    }
    ASSERT_TRUE(runUntil([&] { return healthy->records.size() == kRecords; }));
    for (std::uint32_t i = 0; i < kRecords; ++i) ASSERT_EQ(numberOf(healthy->records[i]), i);
    EXPECT_TRUE(_log.lines().empty());

    stalled->read();  // and catches up
    ASSERT_TRUE(
        runUntil([&] { return !stalled->records.empty() && numberOf(stalled->records.back()) == kRecords - 1; }));
    settle();
    const std::size_t lost = kRecords - stalled->records.size();
    EXPECT_GT(lost, 10'000U);
    EXPECT_EQ(_log.lines(), (Lines{{4, "Client stalled was too slow and lost " + std::to_string(lost) + " records"}}));
    const std::size_t kept = stalled->records.size();
    for (std::uint32_t i = 0; i < 100; ++i)  // the newest are the ones that were kept
        EXPECT_EQ(numberOf(stalled->records[kept - 100 + i]), kRecords - 100 + i);
    EXPECT_EQ(numberOf(stalled->records.front()), 0U);  // was in the socket already
}

TEST_F(TelephonyServiceTest, CountsWhatAStalledClientLostWhenItLeaves) {
    start({.queue = {.records = 10, .bytes = 1 << 20}});
    auto stalled = makeClient("stalled");
    stalled->stream();
    while (_source.someoneIsHungry()) _source.give(record(0));  // until the socket is full: one record waits
    for (int i = 0; i < 14; ++i) _source.give(record(1));
    stalled.reset();
    ASSERT_TRUE(runUntil([&] { return _service->channelCount() == 0; }));
    EXPECT_EQ(_log.lines(), (Lines{{4, "Client stalled was too slow and lost 5 records"}}));
}

TEST_F(TelephonyServiceTest, TellsTheSourceWhenAClientHasCaughtUp) {
    start();
    auto client = makeClient("client");
    client->stream();
    std::size_t given = 0;
    while (_source.someoneIsHungry()) _source.give(record(static_cast<std::uint32_t>(given++)));
    EXPECT_EQ(_source.feeds, 0);
    client->read();
    ASSERT_TRUE(runUntil([&] { return client->records.size() == given; }));
    EXPECT_GE(_source.feeds, 1);
    EXPECT_TRUE(_source.someoneIsHungry());
}

TEST_F(TelephonyServiceTest, AnswersCommandsItCannotUseWithAnErrorAndOneLine) {
    start();
    auto client = makeClient("client");
    client->openChannel();
    const auto refused = [&](const Bytes& message, const std::string& reason, std::int32_t id = 0) {
        _log.clear();
        const DictionaryRef answer = client->askChannel(message, id);
        ASSERT_TRUE(answer);
        EXPECT_EQ(*answer, *Dictionary::make({{"Error", 1}, {"ErrorDomain", 1}}));
        EXPECT_EQ(_log.lines(), (Lines{{3, "Dropped a command of client client: " + reason}}));
    };
    refused(xml(Dictionary::make({{"SetState", 5}})), "SetState is not \"Streaming\"");
    refused(xml(Dictionary::make({{"Format", "disk"}})), "it asks for nothing known");
    refused(xml(Dictionary::make({{"SetState", "Streaming"}, {"SetOskraLogCodes", "all"}})),
            "SetOskraLogCodes is no array");
    refused(kStart, "its id is 7", 7);
    EXPECT_EQ(_source.starts, 0);
    client->tell(xml(Dictionary::make({{"SetState", "Streaming"}, {"Later", "x"}})));
    settle();
    EXPECT_EQ(_source.starts, 1);
    EXPECT_EQ(_log.lines().back(), test::RecordingLog::Line(4, "Client client asked for 1 unknown things"));
}

TEST_F(TelephonyServiceTest, AnswersBadChannelRequestsWithAnError) {
    start();
    auto client = makeClient("client");
    const std::string control = "com.zorvik.TelephonyService";
    const std::vector<std::pair<Bytes, int>> requests = {
        {Bytes{}, 1},
        {Bytes{'b', 'p', 'l', 'i', 's', 't', '0', '0'}, 1},
        {xml(Dictionary::make({})), 1},
        {xml(Dictionary::make({{"CreateLogChannel", 5}})), 1},
        {xml(Dictionary::make({{"CreateLogChannel", "client"}, {"More", 1}})), 1},
        {xml(Dictionary::make({{"CreateLogChannel", ""}})), 3},
        {xml(Dictionary::make({{"CreateLogChannel", "../../etc/passwd"}})), 3},
        {xml(Dictionary::make({{"CreateLogChannel", "nobody"}})), 3},
        {xml(Dictionary::make({{"CreateLogChannel", "com.zorvik.TelephonyService"}})), 3},
    };
    for (const auto& [request, error] : requests) EXPECT_EQ(errorOf(client->ask(control, request)), Value(error));
    EXPECT_EQ(errorOf(client->ask(control, xml(Dictionary::make({{"CreateLogChannel", "client"}})), 9)), Value(1));
    EXPECT_EQ(_service->channelCount(), 0U);
    EXPECT_EQ(errorOf(client->requestChannel()), Value(0));
}

TEST_F(TelephonyServiceTest, LimitsTheChannelsOfOneClientAndOfAll) {
    start({.channels = 6, .channelsPerClient = 4});
    auto greedy = makeClient("greedy");
    for (int i = 0; i < 4; ++i) EXPECT_EQ(errorOf(greedy->requestChannel()), Value(0));
    for (int i = 0; i < 20; ++i) EXPECT_EQ(errorOf(greedy->requestChannel()), Value(2));
    auto b = makeClient("b");
    auto c = makeClient("c");
    auto d = makeClient("d");
    EXPECT_EQ(errorOf(b->requestChannel()), Value(0));
    EXPECT_EQ(errorOf(c->requestChannel()), Value(0));
    EXPECT_EQ(errorOf(d->requestChannel()), Value(2));
    greedy.reset();
    settle();
    EXPECT_EQ(errorOf(d->requestChannel()), Value(0));
}

TEST_F(TelephonyServiceTest, OutlivesRandomBytesOnBothItsPorts) {
    start();
    auto client = makeClient("client");
    client->read();
    client->stream();
    const UniqueFd control = test::rawConnect(_directory / "com.zorvik.TelephonyService.port");
    std::uint32_t state = 99;
    const auto random = [&state] { return state = state * 1664525U + 1013904223U; };
    for (int i = 0; i < 300; ++i) {
        std::string noise(random() % 300, '\0');
        for (char& c : noise) c = static_cast<char>(random() >> 24);
        test::rawSend(control, datagram(1, static_cast<std::uint8_t>(i % 2), 0, 1, noise));
        test::rawSend(client->channel, datagram(1, static_cast<std::uint8_t>(i % 2), 0, 1, noise));
        test::rawSend(client->channel, Bytes(noise.begin(), noise.end()));
        if (i % 10 == 0) settle();
    }
    settle();
    _source.give(record(7));
    ASSERT_TRUE(runUntil([&] { return client->records.size() == 1; }));
    EXPECT_EQ(_service->channelCount(), 1U);
}

TEST_F(TelephonyServiceTest, IsOneOfAKind) {
    start();
    TelephonyService second(_ports, _source);
    const auto failure = second.open();
    ASSERT_TRUE(failure);
    EXPECT_EQ(failure->reason, "another telephony service is running");
}

TEST_F(TelephonyServiceTest, LeavesNoPortsBehind) {
    start();
    auto client = makeClient("client");
    client->stream();
    _service.reset();
    client.reset();
    EXPECT_TRUE(std::filesystem::is_empty(_directory));
}

TEST_F(TelephonyServiceTest, TellsItsStatusWithoutAnyClient) {
    start();
    EXPECT_EQ(*status(), *Dictionary::make({{"Source", "a test"},
                                            {"Technology", "LTE"},
                                            {"Records", 0},
                                            {"Codes", Array::make({})},
                                            {"Clients", Array::make({})}}));
}

TEST_F(TelephonyServiceTest, TellsRatesByCodeAndWhatEveryClientGot) {
    start();
    auto client = makeClient("client");
    client->read();
    client->stream();
    Bytes extended = record(2);
    extended[0] = 255;
    extended[3] = 1;
    extended[4] = 0;
    for (int i = 0; i < 4; ++i) _source.give(record(1));
    _source.give(extended);
    _source.give(Bytes{1, 0, 0});  // too short for a code, so that nobody can have asked for it
    now = std::chrono::seconds(2);
    const DictionaryRef answer = status();
    EXPECT_EQ((*answer)["Records"], Value(6));
    EXPECT_EQ((*answer)["Codes"],
              Value(Array::make({Dictionary::make({{"Records", 1}, {"PerSecond", 0.5}}),
                                 Dictionary::make({{"Code", 0xB0C2}, {"Records", 4}, {"PerSecond", 2.0}}),
                                 Dictionary::make({{"Code", 0xFF0001}, {"Records", 1}, {"PerSecond", 0.5}})})));
    EXPECT_EQ((*answer)["Clients"],
              Value(Array::make({Dictionary::make(
                  {{"Name", "client"}, {"Streaming", true}, {"Delivered", 5}, {"Waiting", 0}, {"Dropped", 0}})})));
}

TEST_F(TelephonyServiceTest, CountsWhatAClientWasTooSlowFor) {
    start({.queue = {.records = 10, .bytes = 1'000'000}});
    auto client = makeClient("client");  // never reads
    client->stream();
    constexpr int kGiven = 5'000;
    for (int i = 0; i < kGiven; ++i) _source.give(record(1, 1'000));
    const Value clients = (*status())["Clients"];
    ASSERT_EQ(clients.array()->size(), 1U);
    const Dictionary& told = *(*clients.array())[0].dictionary();
    EXPECT_EQ(told["Waiting"], Value(10));
    EXPECT_GT(told["Dropped"].number()->integer(), 0);
    EXPECT_EQ(told["Delivered"].number()->integer() + told["Dropped"].number()->integer(), kGiven - 10);
}
