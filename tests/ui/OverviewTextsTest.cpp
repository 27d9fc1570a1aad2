#include <gtest/gtest.h>

#include "tests/ui/OverviewFixture.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using overview::group;
using overview::list;
using overview::shown;
using test::text;

/// The reference pilot's level as a record's reading: its text says more than its number.
class ReferencePilot final : public Quantity {
public:
    void print(std::string& text, std::int64_t) const override { text = "(ref pilot) -9.58 dB"; }
    std::optional<Measurement> measure(std::int64_t) const override { return Measurement{-9.58, "dB"}; }
};
constexpr ReferencePilot kReferencePilot;

/// What stands on the overview, family by family, in the order in which a screen reader reads it.
class OverviewTexts : public test::OverviewFixture {
protected:
    std::string behindTitle() {
        const QStringList all = heard();
        const QStringList frame = {text("Overview"), text("Back to Kelvo"), text("Overview")};
        EXPECT_EQ(all.mid(0, 3), frame);
        EXPECT_EQ(all.back(), text("Updated 2011-03-04 at 09:15:04"));
        return joined(all.mid(3, all.size() - 4));
    }
    static std::string lines(std::initializer_list<const char*> texts) {
        QStringList lines;
        for (const char* line : texts) lines.append(QString::fromUtf8(line));
        return joined(lines);
    }
    static Value pilots() {
        const Value set = shown({{"0;180", "-9.58 dB"}, {"1;240", "-19.67 dB"}}, 6);
        set.dictionary()->slot("0;180").set({.raw = 0, .quantity = &kReferencePilot}, 6);
        return set;
    }
};

TEST_F(OverviewTexts, OfLte) {
    startModem(kPLLogChannelTechnology_Oskra_LTE);
    openOverview();
    showValues(group(
        {{"Serving Cell Info", shown({{"Physical Cell ID", "185"},
                                      {"Cell Identity", "27439618"},
                                      {"Tracking Area Code", "1042"},
                                      {"Download Frequency", "1300"},
                                      {"Upload Frequency", "19300"},
                                      {"Download Bandwidth", "20 MHz"},
                                      {"Upload Bandwidth", "10 MHz"}},
                                     4)},
         {"Serving Cell Measurements", shown({{"E-ARFCN", "1300"},
                                              {"Physical Cell ID", "185"},
                                              {"Measured RSRP", "-96.50 dBm"},
                                              {"Measured RSRQ", "-9.25 dB"}},
                                             5)},
         {"Neighbor Measurements", shown({{"E-ARFCN", "1300"}}, 5)},
         {"Neighbor Cells List",
          list({shown({{"Physical Cell ID", "17"}, {"Measured RSRP", "-99.75 dBm"}, {"Measured RSRQ", "-14.00 dB"}}, 5),
                shown({{"Physical Cell ID", "44"}, {"Measured RSRP", "-95.00 dBm"}, {"Measured RSRQ", "-11.00 dB"}},
                      5)})},
         {"Reselection Candidates List",
          list({shown({{"Candidate RAT Type", "UTRAN"}, {"U ARFCN", "10562"}, {"PSC", "99"}}, 5)})},
         {"PDP Context Info",
          list({shown({{"Context ID", "5"}, {"APN", "internet"}, {"State", "Active"}, {"PDP Address", "10.2.3.4"}},
                      5)})}}));
    EXPECT_EQ(behindTitle(),
              lines({"LTE, idle", "EARFCN 1300, PCI 185", "RSRP -96.50 dBm, fair, 0 s ago",
                     "RSRQ -9.25 dB, excellent, 0 s ago", "Area, TAC 1042",
                     "Cell identity, 27439618 (eNB 107186, sector 2)", "Band, 3 (1815.0 MHz down, 1720.0 MHz up)",
                     "Bandwidth, 20 MHz down, 10 MHz up", "Cells around", "Cells around",
                     "EARFCN 1300, PCI 44, RSRP -95.00 dBm, RSRQ -11.00 dB, 1.5 dB stronger than the serving cell, "
                     "heard 0 s ago",
                     "EARFCN 1300, PCI 17, RSRP -99.75 dBm, RSRQ -14.00 dB, 3.25 dB weaker than the serving cell, "
                     "heard 0 s ago",
                     "UARFCN 10562, PSC 99, candidate, heard 0 s ago", "Registration and data",
                     "internet (5), Active, 10.2.3.4", "What happened", "What happened",
                     "09:15:04, Context up, internet (5)", "09:15:04, Cell found, EARFCN 1300, PCI 185, -96.50 dBm"}));
    for (const char* words :
         {"-96.50", "dBm", "fair", "-9.25", "excellent", "+1.50 dB", "-3.25 dB", "candidate, 0 s ago"}) {
        EXPECT_TRUE(scene->shows(text(words))) << words;
    }
}

TEST_F(OverviewTexts, OfGsmWithoutAQuality) {
    startModem(kPLLogChannelTechnology_Oskra_GSM);
    openOverview();
    showValues(group(
        {{"GSM Cell and Neighbours",
          group({{"GSM Serving Cell", shown({{"Cell ID", "292"}, {"ARFCN", "21"}, {"BSIC", "44"}, {"RSSI", "45"}}, 9)},
                 {"GSM RR Info", shown({{"RR State", "RR_IDLE"}})},
                 {"Neighboring Cells", list({shown({{"ARFCN", "23"}, {"RSSI", "39"}, {"BSIC", "42"}}, 9)})}})},
         {"Registration and Network", group({{"Serving PLMN", shown({{"Mobile Country Code", "001"},
                                                                     {"Mobile Network Code", "01"},
                                                                     {"Location Area Code", "4354"},
                                                                     {"Routing Area Code", "1"},
                                                                     {"Service Type", "NORMAL_SERVICE"}})},
                                             {"Process PS", shown({{"MM State", "GMM_REGISTERED"}})}})}}));
    EXPECT_EQ(behindTitle(),
              lines({"GSM, RR_IDLE", "ARFCN 21, BSIC 44", "RxLev -65 dBm, excellent, 0 s ago", "Area, LAC 4354, RAC 1",
                     "Color codes, NCC 5, BCC 4", "Cell identity, 292", "Band, GSM 900 (939.2 MHz down, 894.2 MHz up)",
                     "Network, 001-01", "Cells around", "Cells around",
                     "ARFCN 23, BSIC 42, RxLev -71 dBm, 6 dB weaker than the serving cell, heard 0 s ago",
                     "Registration and data", "Service, NORMAL_SERVICE", "GMM, GMM_REGISTERED", "What happened",
                     "What happened", "09:15:04, Cell found, ARFCN 21, BSIC 44, -65 dBm"}));
    EXPECT_FALSE(named("qualityGauge")->isVisible());
    EXPECT_FALSE(scene->shows(text("Quality")));  // no column has a heading that no cell fills
    EXPECT_TRUE(scene->shows(text("To serving")));
}

TEST_F(OverviewTexts, OfCdmaWhoseCellsHaveAQualityAlone) {
    startModem(kPLLogChannelTechnology_Oskra_CDMA);
    openOverview();
    const Value oneX = shown({{"01;State", "Traffic [8]"},
                              {"05;Rx0 AGC", "-74.60 dBm"},
                              {"06;Rx0 Channel", "283"},
                              {"07;Rx0 Band Class", "800 MHz cellular band [0]"}},
                             6);
    oneX.dictionary()->set("02;Active Set", pilots());
    showValues(group(
        {{"1;1x", oneX},
         {"4;System", shown({{"1;Roaming Indicator", "OFF [0]"}, {"2;System ID", "4110"}, {"3;Network ID", "2"}})}}));
    EXPECT_EQ(behindTitle(), lines({"CDMA2000 1x, in traffic", "channel 283, PN 180", "Rx AGC -74.60 dBm, 0 s ago",
                                    "Ec/Io -9.58 dB, good, 0 s ago", "Area, SID 4110, NID 2",
                                    "Band, BC 0 (878.5 MHz down, 833.5 MHz up)", "Cells around", "Cells around",
                                    "channel 283, PN 240, active, Ec/Io -19.67 dB, heard 0 s ago",
                                    "Registration and data", "Roaming, OFF", "What happened", "What happened",
                                    "09:15:04, Cell found, channel 283, PN 180, -74.60 dBm"}));
    EXPECT_TRUE(scene->shows(text("-19.67 dB")));
    EXPECT_FALSE(scene->shows(text("Level")));  // no cell around has one
    EXPECT_TRUE(scene->shows(text("Quality")));
    EXPECT_FALSE(scene->shows(text("To serving")));
}

TEST_F(OverviewTexts, OfUtraTddWhoseLevelHasNoUnitAndNoGrade) {
    startModem(kPLLogChannelTechnology_Oskra_UTRAN2);
    openOverview();
    const auto row = [](const char* uarfcn, const char* cell, const char* level, const char* status) {
        return shown({{"UARFCN", uarfcn}, {"Cell ID", cell}, {"Filter RSCP", level}, {"Status", status}}, 4);
    };
    showValues(group({{"RRC Info", shown({{"State", "Cell DCH"}})},
                      {"Serving Cell Info", shown({{"Local Area Code", "2102"}, {"Downlink UARFCN", "10063"}})},
                      {"Neighbor Cell List",
                       list({row("10055", "105", "0.109375", "MSET"), row("10063", "14", "0.125000", "ASET")})},
                      {"TRCH BLER", list({shown({{"TRCH ID", "5"}, {"TRCH BLER Measurement", "42"}})})}}));
    EXPECT_EQ(behindTitle(),
              lines({"UTRA TDD, Cell DCH", "UARFCN 10063, cell 14", "RSCP 0.125000, 0 s ago", "Area, LAC 2102",
                     "Band, a (2012.6 MHz both ways)", "Cells around", "Cells around",
                     "UARFCN 10055, cell 105, RSCP 0.109375, 0.02 weaker than the serving cell, heard 0 s ago",
                     "Registration and data", "BLER, channel 5, 42", "What happened", "What happened",
                     "09:15:04, Cell found, UARFCN 10063, cell 14, 0.125000"}));
}

TEST_F(OverviewTexts, OfTheCellMonitor) {
    startModem(kPLLogChannelTechnology_IFX);
    openOverview();
    showValues(group({{"Serving", shown({{"Technology", "UMTS"},
                                         {"LAC", "2152"},
                                         {"UARFCN", "10562"},
                                         {"SCN", "17"},
                                         {"RSCP", "-101 dBm"},
                                         {"ECN0", "-8.5 dB"}},
                                        3)},
                      {"Neighbours", group({{"GSM", list({shown("72", 3)})}})},
                      {"Registration", shown("Registered")},
                      {"Connection", shown({{"State", "Call"}, {"Errors", "0.2 %"}})}}));
    EXPECT_EQ(behindTitle(),
              lines({"UMTS, Call", "UARFCN 10562, PSC 17", "RSCP -101 dBm, 0 s ago", "Ec/N0 -8.5 dB, good, 0 s ago",
                     "Area, LAC 2152", "Band, I (2112.4 MHz down, 1922.4 MHz up)", "Cells around", "Cells around",
                     "ARFCN 72, heard 0 s ago", "Registration and data", "Registration, Registered", "Errors, 0.2 %",
                     "What happened", "What happened", "09:15:04, Cell found, UARFCN 10562, PSC 17, -101 dBm"}));
}

TEST_F(OverviewTexts, AgeWhileNothingComes) {
    startLte();
    measure(-95, {{366, -100}});
    openOverview();
    scene->pass(14s);
    EXPECT_TRUE(isHeard("RSRP -95.00 dBm, fair, 14 s ago")) << joined(heard());
    scene->pass(20s);
    EXPECT_TRUE(scene->shows(text("lost, 34 s ago")));
    EXPECT_TRUE(scene->app().overview()->level()->isOld());
}

TEST_F(OverviewTexts, TellHowTheLevelHasGone) {
    startLte();
    measure(-101);
    measure(-88);
    openOverview();
    QAccessibleInterface* gauge = QAccessible::queryAccessibleInterface(named("levelGauge"));
    EXPECT_EQ(gauge->text(QAccessible::Description),
              text("-88 dBm, between -101 and -88 in the last two minutes, rising"));
}

TEST_F(OverviewTexts, TellOfAConnectionThatIsLost) {
    startLte();
    openOverview();
    scene->loseService();
    scene->pass(4s);
    scene->settle();
    EXPECT_TRUE(scene->shows(text("Connection lost")));
    EXPECT_TRUE(scene->shows(text("-95.00")));  // what is known is still shown, with its age
}

}  // namespace
}  // namespace kelvo
