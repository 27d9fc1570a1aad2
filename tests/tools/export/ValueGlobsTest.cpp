#include "tools/export/ValueGlobs.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

ValueGlobs globsOf(const std::vector<std::string>& words) {
    auto globs = ValueGlobs::of(words);
    EXPECT_TRUE(globs);
    return globs ? *globs : ValueGlobs();
}

TEST(ValueGlobs, WantEverythingWhenNothingIsSaid) {
    EXPECT_TRUE(globsOf({}).want("/A/B"));
    EXPECT_TRUE(globsOf({}).unmatched().empty());
}

TEST(ValueGlobs, StarsCrossSlashesAndCapitalsDoNotMatter) {
    ValueGlobs globs = globsOf({"*rsrp", "/serving cell info/*ID"});
    EXPECT_TRUE(globs.want("/Neighbor Cells List/PCI 301, EARFCN 1300/Measured RSRP"));
    EXPECT_TRUE(globs.want("/Serving Cell Info/Physical Cell ID"));
    EXPECT_FALSE(globs.want("/Serving Cell Info/Cell Identity"));
    EXPECT_FALSE(globs.want("/Serving Cell Measurements/Measured RSRQ"));
}

TEST(ValueGlobs, TellWhichWordsNothingIsCalled) {
    ValueGlobs globs = globsOf({"*RSRP", "/Nowhere", "throughput"});
    EXPECT_TRUE(globs.want("/A/RSRP"));
    EXPECT_FALSE(globs.want("/A/RSRQ"));
    EXPECT_EQ(globs.unmatched(), (std::vector<std::string>{"/Nowhere", "throughput"}));
}

TEST(ValueGlobs, KnowWholePathsFromPatterns) {
    EXPECT_EQ(globsOf({"/A/B", "/C"}).wholePaths(), (std::vector<std::string>{"/A/B", "/C"}));
    EXPECT_TRUE(globsOf({"/A/B", "/C*"}).wholePaths().empty());
    EXPECT_TRUE(globsOf({"signal"}).wholePaths().empty());
    EXPECT_TRUE(globsOf({}).wholePaths().empty());
}

TEST(ValueGlobs, RefuseAWordThatIsNoName) {
    const auto globs = ValueGlobs::of({"signals"});
    ASSERT_FALSE(globs);
    EXPECT_EQ(globs.error().reason,
              "--values takes signal, cell, neighbours, registration, throughput, or paths such as '*RSRP*', not "
              "signals");
}

struct ShortName {
    const char* name;
    std::vector<const char*> paths;
    std::vector<const char*> others;
};

TEST(ValueGlobs, ShortNamesStandForTheScreensOfAllFamilies) {
    const std::vector<ShortName> names = {
        {"signal",
         {"/Serving Cell Measurements/Measured RSRP", "/Serving Cell Measurements/Average RSRQ",
          "/Serving Cell Measurements/Measured RSSI",
          "/Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP",
          "/UMTS Cells/Active Set/PSC 394/RSCP", "/UMTS Cells/Active Set/PSC 394/Energy Per Chip",
          "/GSM Cell and Neighbours/GSM Serving Cell/RSSI", "/1x/Active Set/180", "/1x/Rx0 AGC", "/EV-DO/Tx AGC",
          "/CCTRCH SIR/channel 1, timeslot 3/SIR/0", "/Serving/RSCP"},
         {"/Serving Cell Measurements/Qrxlevmin", "/Neighbor Cells List/PCI 1/Measured RSRP", "/1x/Rx0 Channel",
          "/UMTS Cells/Monitored Set/PSC 1/RSCP"}},
        {"cell",
         {"/Serving Cell Info/Physical Cell ID", "/Serving Cell Measurements/E-ARFCN",
          "/UMTS Radio/UMTS RR Info/Cell ID", "/UMTS Radio/UMTS RR Info/Downlink Frequency",
          "/GSM Cell and Neighbours/GSM Serving Cell/BSIC", "/System/Base Station ID", "/EV-DO/Channel",
          "/Serving/CellId", "/Serving/UARFCN"},
         {"/Serving Cell Measurements/Measured RSRP", "/Serving/RSCP", "/UMTS Radio/UMTS RR Info/RRC State"}},
        {"neighbours",
         {"/Measured Neighbor Cells/PCI 366, EARFCN 1300/Filtered RSRP", "/Neighbor Cells List/PCI 2/Srxlev",
          "/Reselection Candidates List/LTE, EARFCN 1300/Ranking Value", "/UMTS Cells/Monitored Set/PSC 1/RSCP",
          "/UMTS Cells/Non-Ranked UMTS Set/PSC 1/RSCP", "/GSM Cell and Neighbours/GSM Set/ARFCN 37, BSIC 44/RSSI",
          "/GSM Cell and Neighbours/Neighboring Cells/ARFCN 1/RSSI", "/Neighbor Cell List/UARFCN 10063/Filter RSCP",
          "/Neighbours/GSM/ARFCN 48, BSIC 16/RSSI"},
         {"/UMTS Cells/Active Set/PSC 394/RSCP", "/GSM Cell and Neighbours/GSM Serving Cell/RSSI"}},
        {"registration",
         {"/Registration and Network/Serving PLMN/Mobile Country Code", "/UMTS Radio/UMTS RR Info/RRC State",
          "/Serving Cell Info/Tracking Area Code", "/1x/State", "/EV-DO/Session State", "/RRC Info/State",
          "/Registration/State", "/Registration", "/Connection/State"},
         {"/Connection/TxPower", "/Serving Cell Info/Physical Cell ID"}},
        {"throughput",
         {"/Rates and Errors/EV-DO Forward Rate", "/UMTS Radio/HSDPA Info/Sub Frames",
          "/Counters/BLER/Transport Channels/channel 1/CRC Received", "/TRCH BLER/channel 5/TRCH BLER Measurement",
          "/Connection/Throughput"},
         {"/Connection/State", "/1x/State"}},
    };
    for (const ShortName& name : names) {
        ValueGlobs globs = globsOf({name.name});
        for (const char* path : name.paths) EXPECT_TRUE(globs.want(path)) << name.name << " " << path;
        for (const char* path : name.others) EXPECT_FALSE(globs.want(path)) << name.name << " " << path;
    }
    EXPECT_TRUE(globsOf({"neighbors"}).want("/Neighbor Cells List/PCI 2/Srxlev"));
}

}  // namespace
}  // namespace kelvo
