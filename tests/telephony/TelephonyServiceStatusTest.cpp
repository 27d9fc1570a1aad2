#include "tests/telephony/ServiceFixture.h"

using namespace kelvo;
using namespace kelvo::test;

TEST_F(TelephonyServiceTest, TellsItsStatusWithoutAnyClient) {
    start();
    EXPECT_EQ(*status(), *Dictionary::make({{"Source", "a test"},
                                            {"Technology", "LTE"},
                                            {"Records", 0},
                                            {"Codes", Array::make({})},
                                            {"Clients", Array::make({})}}));
}

TEST_F(TelephonyServiceTest, TellsTheStateOfItsSourceWhenThereIsSomethingToSay) {
    start();
    _source.condition = "the capture has ended";
    EXPECT_EQ((*status())["State"], Value("the capture has ended"));
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
