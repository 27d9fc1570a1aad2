#include <gtest/gtest.h>

#include "tests/ui/Contrast.h"
#include "tests/ui/DetailsFixture.h"
#include "ui/Theme.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using test::contrast;
using test::text;

/// A value that no record writes any more.
class Freshness : public test::DetailsFixture {
protected:
    static constexpr const char* kKey = "Serving Filtered RSRP";

    QColor drawn(const char* shown) { return scene->itemWithText(text(shown))->property("color").value<QColor>(); }
    QString heard(const char* key = kKey) { return scene->row(text(key))->accessibleName(); }
    /// A record of code `code` whose own time is `seconds` after the first moment of the test's stream.
    void deliverAt(LogCode code, std::size_t size, std::uint64_t seconds) {
        constexpr std::uint64_t kStart = 1'450'000'000;              // since 1980-01-06
        const std::uint64_t stamp = (kStart + seconds) * 800 << 16;  // in steps of 1.25 ms
        test::Record record(code, size);
        record.u32(5, static_cast<std::uint32_t>(stamp)).u32(9, static_cast<std::uint32_t>(stamp >> 32));
        scene->ports.deliver(KelvoModel::kLogChannelPortName, 0, record.bytes());
    }
};

TEST_F(Freshness, GoesAfterThirtySecondsWithoutARecord) {
    startLte();
    openSection();
    scene->pass(26s);  // and two since the record, before its refresh
    EXPECT_EQ(drawn("-95.00 dBm"), Theme().secondaryText());
    EXPECT_EQ(heard(), text("Serving Filtered RSRP, -95.00 dBm"));
    scene->pass(2s);
    EXPECT_EQ(drawn("-95.00 dBm"), Theme().oldText());
    EXPECT_EQ(heard(), text("Serving Filtered RSRP, -95.00 dBm, 30 seconds old"));
    scene->pass(10s);
    EXPECT_EQ(heard(), text("Serving Filtered RSRP, -95.00 dBm, 40 seconds old"));
    scene->pass(100s);
    EXPECT_EQ(heard(), text("Serving Filtered RSRP, -95.00 dBm, 2 minutes old"));

    measure(-95);  // the same once more
    EXPECT_EQ(heard(), text("Serving Filtered RSRP, -95.00 dBm"));
    EXPECT_EQ(drawn("-95.00 dBm"), Theme().secondaryText());
}

TEST_F(Freshness, IsEachValuesOwn) {
    startLte();
    openSection();
    for (int i = 0; i < 20; ++i) {
        scene->ports.deliver(KelvoModel::kLogChannelPortName, 0, test::Record(0xB0C2, 38).bytes());
        scene->pass(2s);
    }
    EXPECT_EQ(heard(), text("Serving Filtered RSRP, -95.00 dBm, 40 seconds old"));
    scene->app().navigation()->popViewController();
    scene->settle();
    openSection("Serving Cell Info");
    EXPECT_EQ(heard("Upload Bandwidth"), text("Upload Bandwidth, Unknown"));
    EXPECT_FALSE(heard("Num Tx Antennas").contains(text("old")));  // never written
}

TEST_F(Freshness, GoesWithTheConnection) {
    startLte();
    openSection();
    scene->loseService();
    scene->pass(42s);
    EXPECT_FALSE(scene->app().model()->isConnected());
    EXPECT_EQ(heard(), text("Serving Filtered RSRP, -95.00 dBm, 40 seconds old"));
}

TEST_F(Freshness, GoesByTheStreamsTimeInAReplay) {
    startLte();
    openSection();
    deliverAt(0xB179, 29, 0);
    scene->pass(2s);
    deliverAt(0xB0C2, 38, 60);  // a minute of the stream went by in these two seconds
    scene->pass(2s);
    EXPECT_EQ(heard(), text("Serving Filtered RSRP, -140.00 dBm, 60 seconds old"));
}

TEST_F(Freshness, LeavesRowsThatOpenAlone) {
    startLte();
    scene->pass(100s);
    EXPECT_EQ(heard(kSection), text(kSection));
}

TEST_F(Freshness, IsReadableInEitherScheme) {
    startLte();
    for (const bool dark : {false, true}) {
        test::Scene::useDarkColours(dark);
        const Theme theme;
        EXPECT_GE(contrast(theme.oldText(), theme.row()), 4.5) << dark;
        EXPECT_GT(contrast(theme.secondaryText(), theme.row()), 1.25 * contrast(theme.oldText(), theme.row())) << dark;
    }
}

TEST_F(Freshness, TellsTheAgeInTheDetails) {
    startLte();
    openDetails();
    EXPECT_EQ(textOf("written"), text("2 seconds ago, by record 1"));
    EXPECT_EQ(textOf("record"), text("0xb179  LTE intra-frequency, connected"));
    scene->pass(38s);
    EXPECT_EQ(textOf("written"), text("40 seconds ago, by record 1"));
    EXPECT_EQ(textOf("modemTime"), QString());
    deliverAt(0xB179, 29, 0);
    scene->pass(2s);
    EXPECT_EQ(textOf("written"), text("2 seconds ago, by record 2"));
    EXPECT_EQ(textOf("modemTime"), text("Modem time 2025-12-17 09:46:40.000 UTC"));
    EXPECT_EQ(textOf("dumpWords"), text("Bytes 23 to 24 of 29"));
    EXPECT_TRUE(textOf("dump").startsWith(text("0000:&nbsp;01&nbsp;1c&nbsp;00&nbsp;79&nbsp;b1")))
        << textOf("dump").toStdString();
    EXPECT_TRUE(textOf("dump").contains(text("<b><u>00</u></b>")));
}

}  // namespace
}  // namespace kelvo
