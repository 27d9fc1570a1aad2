#include "telephony/StatusText.h"

#include <gtest/gtest.h>

using namespace kelvo;

TEST(StatusText, ListsCodesAndClients) {
    const auto answer = Dictionary::make(
        {{"Source", "the capture x.pcap"},
         {"Technology", "GSM"},
         {"Records", 1234},
         {"Codes", Array::make({Dictionary::make({{"Records", 3}, {"PerSecond", 0.04}}),
                                Dictionary::make({{"Code", 0x5134}, {"Records", 1200}, {"PerSecond", 19.96}}),
                                Dictionary::make({{"Code", 0x5B34}, {"Records", 2}, {"PerSecond", 0.1}}),
                                Dictionary::make({{"Code", 0x1234}, {"Records", 5}, {"PerSecond", 0.2}}),
                                Dictionary::make({{"Code", 0xFF0001}, {"Records", 31}, {"PerSecond", 0.5}})})},
         {"Clients",
          Array::make(
              {Dictionary::make(
                   {{"Name", "window"}, {"Streaming", true}, {"Delivered", 1200}, {"Waiting", 30}, {"Dropped", 4}}),
               Dictionary::make(
                   {{"Name", "other"}, {"Streaming", false}, {"Delivered", 0}, {"Waiting", 0}, {"Dropped", 0}})})}});
    EXPECT_EQ(*statusText(answer),
              "Source      the capture x.pcap\n"
              "Technology  GSM\n"
              "Records     1234\n"
              "\n"
              "  Log code                                       per second        in all\n"
              "  none                                                  0.0             3\n"
              "  0x5134  GSM serving cell                             20.0          1200\n"
              "  0x5b34  GSM serving cell, dual SIM                    0.1             2\n"
              "  0x1234                                                0.2             5\n"
              "  0xff0001  Cell information                            0.5            31\n"
              "\n"
              "Clients\n"
              "  window: streaming, 1200 delivered, 30 waiting, 4 dropped\n"
              "  other: not streaming yet, 0 delivered, 0 waiting, 0 dropped\n");
}

TEST(StatusText, TellsTheSourcesState) {
    const auto answer = Dictionary::make({{"Source", "the capture x.pcap"},
                                          {"State", "the capture has ended"},
                                          {"Technology", "GSM"},
                                          {"Records", 3},
                                          {"Codes", Array::make({})},
                                          {"Clients", Array::make({})}});
    EXPECT_EQ(statusText(answer)->find("Source      the capture x.pcap\n"
                                       "State       the capture has ended\n"
                                       "Technology  GSM\n"),
              0U);
}

TEST(StatusText, RefusesWhatIsNoStatus) {
    EXPECT_FALSE(statusText(Value("text")));
    EXPECT_FALSE(statusText(Dictionary::make({{"Error", 1}, {"ErrorDomain", 1}})));
}

TEST(StatusText, ShowsStateAndPort) {
    const auto status = Dictionary::make({{"Source", "the modem at /dev/ttyUSB2"},
                                          {"Technology", "LTE"},
                                          {"Records", 5},
                                          {"Codes", Array::make({})},
                                          {"Clients", Array::make({})},
                                          {"State", "the modem has gone: it hung up"},
                                          {"Port", Dictionary::make({{"Name", ""},
                                                                     {"State", "closed"},
                                                                     {"Target", "T"},
                                                                     {"Subscription", 2},
                                                                     {"EncryptsRecords", true},
                                                                     {"Losing", true},
                                                                     {"Bytes", 100},
                                                                     {"Waiting", 3}})}});
    EXPECT_EQ(*statusText(status),
              "Source      the modem at /dev/ttyUSB2\n"
              "State       the modem has gone: it hung up\n"
              "Technology  LTE\n"
              "Records     5\n"
              "\n"
              "  Log code                                       per second        in all\n"
              "  none\n"
              "\n"
              "Clients\n"
              "  none\n"
              "\n"
              "Port\n"
              "  State                     closed\n"
              "  Target                    T\n"
              "  SIM                       2\n"
              "  this modem encrypts its records\n"
              "  loses records now\n"
              "  Bytes                     100\n"
              "  Waiting in the modem      3\n");
}

TEST(StatusJson, HoldsTheAnswerAsItIs) {
    const auto status = Dictionary::make({{"Source", "a \"test\"\x1b"},
                                          {"Records", 5},
                                          {"PerSecond", 0.5},
                                          {"Losing", true},
                                          {"Codes", Array::make({Dictionary::make({{"Code", 45250}})})}});
    EXPECT_EQ(*statusJson(status),
              "{\n"
              "  \"Source\": \"a \\\"test\\\"\\u001b\",\n"
              "  \"Records\": 5,\n"
              "  \"PerSecond\": 0.5,\n"
              "  \"Losing\": true,\n"
              "  \"Codes\": [\n"
              "    {\n"
              "      \"Code\": 45250\n"
              "    }\n"
              "  ]\n"
              "}\n");
    EXPECT_FALSE(statusJson("text"));
}
