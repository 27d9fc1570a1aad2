#include "tests/tools/KelvoctlTest.h"

namespace kelvo {
namespace {

using test::contentsOf;
using test::expectFailure;
using test::Finished;

struct ExplainCommand : test::KelvoctlTest {};

TEST_F(ExplainCommand, TellsTheMeaningTheStandardAndWhoMeansIt) {
    const Finished done = kelvoctl({"explain", "srxlev"});
    EXPECT_EQ(done.status, 0) << done.errors;
    EXPECT_EQ(done.output,
              "Srxlev  (LTE)\n"
              "  How far the cell's level lies above what it asks for: a cell is suitable to camp on only above 0.\n"
              "  3GPP TS 36.304, 5.2.3.2\n");
}

TEST_F(ExplainCommand, TellsEveryMeaningOfAKeyOnce) {
    const std::string text = kelvoctl({"explain", "Cell ID"}).output;
    EXPECT_NE(text.find("(GSM: UMTS RR Info; UTRAN: Serving Cell Info)"), std::string::npos) << text;
    EXPECT_NE(text.find("(GSM: GSM Serving Cell)"), std::string::npos) << text;
    EXPECT_NE(text.find("3GPP TS 23.003, 4.3.1"), std::string::npos) << text;
    EXPECT_NE(kelvoctl({"explain", "EF-ICCID"}).output.find("(GSM; LTE; UTRAN)"), std::string::npos);
    EXPECT_NE(kelvoctl({"explain", "Frequency Offset"}).output.find("no standard, the modem's own"), std::string::npos);
}

TEST_F(ExplainCommand, OffersWhatIsCalledNearlyLikeIt) {
    expectFailure(kelvoctl({"explain", "Srxlv"}), "no value is called \"Srxlv\"; there is: Srxlev");
    expectFailure(kelvoctl({"explain", "measured rsr"}),
                  "no value is called \"measured rsr\"; there is: Measured RSRP, Measured RSRQ, Measured RSSI");
    expectFailure(kelvoctl({"explain", "xylophone"}),
                  "no value is called \"xylophone\"; kelvoctl explain --all lists them");
    expectFailure(kelvoctl({"explain"}), "say which value to explain, or --all");
}

TEST_F(ExplainCommand, ThePageOfAllValuesIsCurrent) {
    EXPECT_EQ(kelvoctl({"explain", "--all"}).output, contentsOf(KELVO_VALUES_PAGE))
        << "kelvoctl explain --all >docs/values.md writes it anew";
}

}  // namespace
}  // namespace kelvo
