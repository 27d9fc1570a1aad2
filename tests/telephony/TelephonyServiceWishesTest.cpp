#include "tests/telephony/ServiceFixture.h"

using namespace kelvo;
using namespace kelvo::test;

namespace {

Bytes startWith(std::initializer_list<Value> codes) {
    return xml(Dictionary::make({{"SetState", "Streaming"}, {"SetOskraLogCodes", Array::make(codes)}}));
}

RecordFilter::Codes codesOf(std::initializer_list<std::size_t> list) {
    RecordFilter::Codes codes;
    for (const std::size_t code : list) codes.set(code);
    return codes;
}

}  // namespace

TEST_F(TelephonyServiceTest, TellsTheSourceWhatTheClientsWantTogether) {
    start();
    auto a = makeClient("a");
    a->openChannel();
    EXPECT_TRUE(_source.wishes.empty());  // it does not stream
    a->tell(startWith({0xB0C2, 0xB0C1}));
    settle();
    ASSERT_EQ(_source.wishes.size(), 1U);
    EXPECT_TRUE(_source.wishes[0].streaming);
    EXPECT_EQ(_source.wishes[0].ordinary, codesOf({0xB0C1, 0xB0C2}));
    auto b = makeClient("b");
    b->stream(startWith({0xB0C2, 0x5134}));
    ASSERT_EQ(_source.wishes.size(), 2U);
    EXPECT_EQ(_source.wishes[1].ordinary, codesOf({0xB0C1, 0xB0C2, 0x5134}));
    a.reset();
    ASSERT_TRUE(runUntil([&] { return _source.wishes.size() == 3; }));
    EXPECT_EQ(_source.wishes[2].ordinary, codesOf({0xB0C2, 0x5134}));
    b->tell(xml(Dictionary::make({{"SetOskraLogCodes", Array::make({0xB0C2})}})));
    settle();
    ASSERT_EQ(_source.wishes.size(), 4U);
    EXPECT_EQ(_source.wishes[3].ordinary, codesOf({0xB0C2}));
    b->tell(startWith({0xB0C2}));  // nothing new
    settle();
    EXPECT_EQ(_source.wishes.size(), 4U);
    b.reset();
    ASSERT_TRUE(runUntil([&] { return _source.wishes.size() == 5; }));
    EXPECT_FALSE(_source.wishes[4].streaming);
    EXPECT_EQ(_source.wishes[4].ordinary, codesOf({}));
}

TEST_F(TelephonyServiceTest, KeepsExtendedCodesFromTheModem) {
    start();
    auto client = makeClient("client");
    client->stream(xml(Dictionary::make({{"SetState", "Streaming"}, {"SetPlExtraCodes", Array::make({1, 2})}})));
    ASSERT_EQ(_source.wishes.size(), 1U);
    EXPECT_TRUE(_source.wishes[0].streaming);
    EXPECT_EQ(_source.wishes[0].ordinary, codesOf({}));
}

TEST_F(TelephonyServiceTest, FindsOutATechnologyThatIsNotKnownAndKeepsTheAnswerForTheChannelsLife) {
    _source.spoken = std::nullopt;
    start();
    const Bytes query = xml(Dictionary::make({{"GetTechnology", "GetTechnology"}}));
    auto client = makeClient("client");
    client->openChannel();
    EXPECT_EQ(_source.searches, 0);
    EXPECT_EQ(errorOf(client->askChannel(query)), Value(5));
    EXPECT_EQ(_source.searches, 1);
    _source.spoken = Technology::GSM;
    EXPECT_EQ(*client->askChannel(query), *Dictionary::make({{"GetTechnology", "kPLLogChannelTechnology_Oskra_GSM"}}));
    _source.spoken = Technology::LTE;  // the phone has changed
    EXPECT_EQ(*client->askChannel(query), *Dictionary::make({{"GetTechnology", "kPLLogChannelTechnology_Oskra_GSM"}}));
    auto later = makeClient("later");
    later->openChannel();
    EXPECT_EQ(*later->askChannel(query), *Dictionary::make({{"GetTechnology", "kPLLogChannelTechnology_Oskra_LTE"}}));
    EXPECT_EQ(_source.searches, 1);
}

TEST_F(TelephonyServiceTest, DeliversRecordsOfATechnologyThatIsNotKnownYet) {
    _source.spoken = std::nullopt;
    start();
    auto client = makeClient("client");
    client->read();
    client->stream();
    EXPECT_TRUE(_source.give(record(1)));
    ASSERT_TRUE(runUntil([&] { return client->records.size() == 1; }));
    EXPECT_EQ((*status())["Technology"], Value("not known yet"));
}

TEST_F(TelephonyServiceTest, TellsStateAndPortOfItsSource) {
    start();
    EXPECT_EQ(status()->find("State"), nullptr);
    EXPECT_EQ(status()->find("Port"), nullptr);
    _source.condition = "the modem has gone";
    _source.port = Dictionary::make({{"BadChecksums", 3}});
    EXPECT_EQ((*status())["State"], Value("the modem has gone"));
    EXPECT_EQ((*(*status())["Port"].dictionary())["BadChecksums"], Value(3));
}
