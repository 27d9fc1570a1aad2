#include "tests/telephony/ServiceFixture.h"

using namespace kelvo;
using namespace kelvo::test;

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
    EXPECT_EQ(_log.lines().back(), RecordingLog::Line(4, "Client client asked for 1 unknown things"));
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
    const UniqueFd control = rawConnect(_directory / "com.zorvik.TelephonyService.port");
    std::uint32_t state = 99;
    const auto random = [&state] { return state = state * 1664525U + 1013904223U; };
    for (int i = 0; i < 300; ++i) {
        std::string noise(random() % 300, '\0');
        for (char& c : noise) c = static_cast<char>(random() >> 24);
        rawSend(control, datagram(1, static_cast<std::uint8_t>(i % 2), 0, 1, noise));
        rawSend(client->channel, datagram(1, static_cast<std::uint8_t>(i % 2), 0, 1, noise));
        rawSend(client->channel, Bytes(noise.begin(), noise.end()));
        if (i % 10 == 0) settle();
    }
    settle();
    _source.give(record(7));
    ASSERT_TRUE(runUntil([&] { return client->records.size() == 1; }));
    EXPECT_EQ(_service->channelCount(), 1U);
}
