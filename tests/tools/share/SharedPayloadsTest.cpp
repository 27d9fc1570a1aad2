#include "tools/share/SharedPayloads.h"

#include <gtest/gtest.h>

#include "platform/encodings/PropertyList.h"

namespace kelvo {
namespace {

struct SharedPayloads : testing::Test {
    /// The shared payload as a tree; none when there is none.
    Value share(LogCode code, const Value& payload) {
        const auto shared = sharedPayload(replacer, code, *writeXmlPropertyList(payload));
        return shared ? *readPropertyList(*shared) : Value();
    }
    std::uint64_t removed() const {
        std::uint64_t all = 0;
        for (const auto& [what, count] : replacer.tally().removed()) all += count;
        return all;
    }
    static std::string at(const Value& dictionary, const char* key) {
        const std::string* text = (*dictionary.dictionary())[key].string();
        return text != nullptr ? *text : "(none)";
    }

    Replacer replacer{{}, Pseudonyms::secretOf("a test")};
};

TEST_F(SharedPayloads, OfSimFilesReplaceThoseThatNameSomebody) {
    const Value shared = share(0xFF0000, Dictionary::make({{"kSimFile_ICCID", "8900101000000123456"},
                                                           {"kSimFile_MSISDN", "+0015550123"},
                                                           {"kSimFile_HPPLMN", "05"},
                                                           {"kSimFile_AD", Bytes{0, 0, 1, 2}},
                                                           {"kSimFile_PNN", "Test Network"},
                                                           {"kSimFile_FPLMN", Bytes{0x62, 0xF2, 0x10}}}));
    EXPECT_NE(at(shared, "kSimFile_ICCID"), "8900101000000123456");
    EXPECT_EQ(at(shared, "kSimFile_ICCID").size(), 19U);
    EXPECT_NE(at(shared, "kSimFile_MSISDN"), "+0015550123");
    EXPECT_EQ(at(shared, "kSimFile_HPPLMN"), "05");
    EXPECT_EQ(*(*shared.dictionary())["kSimFile_AD"].data(), Bytes({0, 0, 1, 2}));
    EXPECT_NE(at(shared, "kSimFile_PNN"), "Test Network");
    EXPECT_NE(*(*shared.dictionary())["kSimFile_FPLMN"].data(), Bytes({0x62, 0xF2, 0x10}));
    EXPECT_EQ(removed(), 0U);
}

TEST_F(SharedPayloads, LeaveOutWhatNobodyKnows) {
    const Value shared = share(0xFF0000, Dictionary::make({{"kSimFile_IMSI", "310410123456789"},
                                                           {"kSimFile_HPPLMN", "310410123456789"},
                                                           {"kSimFile_RATMODE", Dictionary::make({{"a", "b"}})}}));
    EXPECT_TRUE(shared.dictionary()->empty());
    EXPECT_EQ(removed(), 3U);
}

TEST_F(SharedPayloads, OfCellsKeepLevelsAndChannels) {
    const Value shared =
        share(0xFF0001, Array::make({Dictionary::make(
                            {{"kPLCellMonitorCellRadioAccessTechnology", "kPLCellMonitorRadioAccessTechnologyGSM"},
                             {"kPLCellMonitorCellType", "kPLCellMonitorCellTypeServing"},
                             {"kPLCellMonitorMCC", 262},
                             {"kPLCellMonitorCellId", 21'345},
                             {"kPLCellMonitorLAC", 4566},
                             {"kPLCellMonitorARFCN", 62},
                             {"kPLCellMonitorRSSI", 32'767},
                             {"kPLCellMonitorLatitude", 52'520'008}})}));
    const Dictionary& cell = *(*shared.array())[0].dictionary();
    EXPECT_EQ(cell["kPLCellMonitorARFCN"].number()->integer(), 62);
    EXPECT_EQ(cell["kPLCellMonitorRSSI"].number()->integer(), 32'767);
    EXPECT_NE(cell["kPLCellMonitorMCC"].number()->integer(), 262);
    EXPECT_NE(cell["kPLCellMonitorCellId"].number()->integer(), 21'345);
    EXPECT_EQ(cell["kPLCellMonitorLAC"].number()->integer(), replacer.number(Identity::Area, "field", 4566));
    EXPECT_EQ(cell.find("kPLCellMonitorLatitude"), nullptr);
    EXPECT_EQ(removed(), 1U);
}

TEST_F(SharedPayloads, OfCellsTellTheSiteByTheirTechnology) {
    const auto cell = [](const char* technology, int identity) {
        return Dictionary::make({{"kPLCellMonitorCellRadioAccessTechnology", technology},
                                 {"kPLCellMonitorCellType", "kPLCellMonitorCellTypeServing"},
                                 {"kPLCellMonitorCellId", identity}});
    };
    const Value shared = share(0xFF0001, Array::make({cell("kPLCellMonitorRadioAccessTechnologyLTE", 27'439'618),
                                                      cell("kPLCellMonitorRadioAccessTechnologyUMTS", 44'041'665),
                                                      cell("kPLCellMonitorRadioAccessTechnologyUTRAN2", 44'041'666)}));
    const auto identity = [&](std::size_t i) {
        return (*(*shared.array())[i].dictionary())["kPLCellMonitorCellId"].number()->integer();
    };
    EXPECT_EQ(identity(0), replacer.number(Identity::EutranCell, "field", 27'439'618));
    EXPECT_EQ(identity(1), replacer.number(Identity::UtranCell, "field", 44'041'665));
    EXPECT_EQ(identity(2), replacer.number(Identity::UtranCell, "field", 44'041'666));
}

TEST_F(SharedPayloads, OfCellsLeaveOutThoseThatAreNone) {
    const Value shared =
        share(0xFF0001, Array::make({"a cell", Dictionary::make({{"kPLCellMonitorCellType", "home"}})}));
    EXPECT_EQ(shared.array()->size(), 0U);
    EXPECT_EQ(removed(), 2U);
}

TEST_F(SharedPayloads, OfContextsReplaceAddressesAndKeepTheRest) {
    const Value shared = share(0xFF0002, Array::make({Dictionary::make({{"Context ID", "5"},
                                                                        {"APN", "internet"},
                                                                        {"PDP Type", "IPv4"},
                                                                        {"PDP Address", "10.20.30.40"},
                                                                        {"Quality of Service", "QCI 9"},
                                                                        {"User", "anna"}})}));
    const Value& context = (*shared.array())[0];
    EXPECT_EQ(at(context, "APN"), "internet");
    EXPECT_EQ(at(context, "Quality of Service"), "QCI 9");
    EXPECT_NE(at(context, "PDP Address"), "10.20.30.40");
    EXPECT_EQ(at(context, "User"), "(none)");
    EXPECT_EQ(removed(), 1U);
}

TEST_F(SharedPayloads, OfOtherKindsAreNone) {
    EXPECT_FALSE(share(0xFF0000, Array::make({"8900101"})));
    EXPECT_FALSE(share(0xFF0001, Dictionary::make({{"a", "b"}})));
    EXPECT_FALSE(share(0xFF0002, "internet"));
    EXPECT_FALSE(share(0xFF0003, Array::make({"a"})));
}

TEST_F(SharedPayloads, CallATextWithALongNumberNotPlain) {
    EXPECT_TRUE(isPlainText("EGPRS MCS-9, 12345678 bit/s"));
    EXPECT_FALSE(isPlainText("of 310410123456789"));
    EXPECT_FALSE(isPlainText(std::string(65, 'a')));
}

TEST_F(SharedPayloads, OfCellMonitorsReplaceIdentitiesInTheirTree) {
    const Value tree = Dictionary::make(
        {{"Serving", Dictionary::make({{"Cell", Dictionary::make({{"Technology", "GSM"},
                                                                  {"MCC", "262"},
                                                                  {"MNC", "01"},
                                                                  {"LAC", "4566"},
                                                                  {"CellId", "21345"},
                                                                  {"ARFCN", "62"},
                                                                  {"RSSI", "-71 dBm"}})}})},
         {"Neighbours",
          Dictionary::make({{"GSM", Array::make({"1", Dictionary::make({{"ARFCN", "70"}, {"BSIC", "23"}})})}})},
         {"Registration", Dictionary::make({{"State", "Registered"}})}});
    const Value shared = sharedTree(replacer, tree);
    const Value& cell = (*(*shared.dictionary())["Serving"].dictionary())["Cell"];
    EXPECT_EQ(at(cell, "ARFCN"), "62");
    EXPECT_EQ(at(cell, "RSSI"), "-71 dBm");
    EXPECT_EQ(at(cell, "LAC"), std::to_string(replacer.number(Identity::Area, "field", 4566)));
    EXPECT_NE(at(cell, "CellId"), "21345");
    EXPECT_EQ(at(cell, "CellId").size(), 5U);
    EXPECT_EQ(at(cell, "MNC").size(), 2U);
    const Array& gsm = *(*(*shared.dictionary())["Neighbours"].dictionary())["GSM"].array();
    EXPECT_EQ(*gsm[0].string(), "1");
    EXPECT_EQ(at(gsm[1], "ARFCN"), "70");
    EXPECT_NE(at(gsm[1], "BSIC"), "23");
    EXPECT_EQ(at((*shared.dictionary())["Registration"], "State"), "Registered");
    EXPECT_EQ(removed(), 0U);
}

TEST_F(SharedPayloads, OfCellMonitorsLeaveOutWhatNobodyKnowsInItsPlace) {
    const Value tree = Dictionary::make({{"Serving", "310410123456789"},
                                         {"310410123456789", "home"},
                                         {"Neighbours", Array::make({"310410123456789", "x"})},
                                         {"Connection", Dictionary::make({{"State", "call to +15550123456"}})}});
    const Value shared = sharedTree(replacer, tree);
    const Dictionary& entries = *shared.dictionary();
    ASSERT_EQ(entries.size(), 4U);
    EXPECT_EQ(at(shared, "Serving"), "");
    EXPECT_EQ(at(shared, "Removed 1"), "");
    EXPECT_EQ(*(*entries["Neighbours"].array())[0].string(), "");
    EXPECT_EQ(at(entries["Connection"], "State"), "");
    EXPECT_EQ(removed(), 4U);
}

TEST_F(SharedPayloads, OfCellMonitorsAreTreesOfTextsAlone) {
    EXPECT_FALSE(sharedTree(replacer, Dictionary::make({{"Serving", 7}})));
    EXPECT_FALSE(sharedTree(replacer, Bytes{1, 2}));
}

}  // namespace
}  // namespace kelvo
