#include "tests/telephony/ServiceFixture.h"

#include <set>

using namespace kelvo;
using namespace kelvo::test;

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

TEST_F(TelephonyServiceTest, IsOneOfAKind) {
    start();
    TelephonyService second(_ports, _source);
    const Result<void> opened = second.open();
    ASSERT_FALSE(opened);
    EXPECT_EQ(opened.error().reason,
              "another telephony service is running (process " + std::to_string(::getpid()) + ")");
}

TEST_F(TelephonyServiceTest, LeavesNoPortsBehind) {
    start();
    auto client = makeClient("client");
    client->stream();
    _service.reset();
    client.reset();
    EXPECT_TRUE(std::filesystem::is_empty(_directory));
}
