#include "overview/LiveOverview.h"

#include "tests/model/MonitoredModel.h"

namespace kelvo::overview {
namespace {

using namespace std::chrono_literals;
using Kind = Event::Kind;

constexpr long long kNoon = 1795348800;  // 2026-11-22 12:00 UTC
constexpr const char* kGsm = "kPLLogChannelTechnology_Oskra_GSM";

class LiveOverviewTest : public test::MonitoredModel {
protected:
    LiveOverviewTest() {
        model = std::make_unique<KelvoModel>(
            KelvoModel::Services{.queue = queue,
                                 .ports = ports,
                                 .telephony = telephony,
                                 .updateViewControllerFromModel = [this] { live->refreshed(); },
                                 .connectionChanged = [this] { live->connectionChanged(); },
                                 .encode = encode});
        live = std::make_unique<LiveOverview>(*model);
    }

    /// The serving cell in idle mode; levels in steps of a quarter from -140 dBm, qualities from -30 dB.
    static Bytes idle(std::uint32_t cell, std::uint32_t level, std::uint32_t quality = 80) {
        return test::Record(0xB17F, 33).u16(17, 1300).u16(19, cell).u32(21, level | quality << 18).bytes();
    }
    /// A carrier in connected mode, measured as if it served.
    static Bytes carrier(std::uint32_t channel, std::uint32_t cell, std::uint32_t level = 160) {
        return test::Record(0xB179, 29).u16(17, channel).u16(19, cell).u16(23, level).u16(25, 80).bytes();
    }
    /// Time goes by, of the queue and of the day.
    void pass(std::chrono::nanoseconds time) {
        for (; time > 0s; time -= 1s) {
            clock.advance(1s);
            queue.advance(1s);
        }
    }
    std::vector<Kind> kinds() const {
        std::vector<Kind> kinds;
        for (const Event& event : live->tracker().events()) kinds.push_back(event.kind);
        return kinds;
    }
    static std::vector<double> numbers(const LiveOverview::Line& line) {
        std::vector<double> numbers;
        for (const LiveOverview::Point& point : line.points) numbers.push_back(point.number);
        return numbers;
    }
    const Event& last() const { return live->tracker().events().back(); }

    test::ManualClock clock{kNoon};
    Environment::Scope noon{{.log = &log, .clock = &clock, .resources = &resources}};
    std::unique_ptr<LiveOverview> live;
};

TEST_F(LiveOverviewTest, FollowsTheValuesAtEachRefresh) {
    startLte();
    deliver(idle(84, 200));
    EXPECT_EQ(live->tracker().latest().cell, "");
    EXPECT_EQ(live->levelAge(), std::nullopt);
    pass(2s);
    EXPECT_EQ(live->tracker().latest().cell, "EARFCN 1300, PCI 84");
    EXPECT_EQ(live->tracker().latest().level->figure.text, "-90.00 dBm");
    EXPECT_EQ(live->levelAge(), 0s);
    pass(7s);
    EXPECT_EQ(live->levelAge(), 7s);
    EXPECT_EQ(live->qualityAge(), 7s);
    deliver(idle(12, 240, 100));
    pass(1s);
    ASSERT_EQ(kinds(), (std::vector{Kind::CellFound, Kind::Reselection}));
    EXPECT_EQ(last().time, Time(std::chrono::seconds(kNoon + 10)));
    EXPECT_EQ(last().values, (std::vector<EventValue>{{"Cell", "EARFCN 1300, PCI 84", "EARFCN 1300, PCI 12"},
                                                      {"RSRP", "-90.00 dBm", "-80.00 dBm"},
                                                      {"RSRQ", "-10.00 dB", "-5.00 dB"}}));
    EXPECT_EQ(live->servingCells(), (std::deque<TrendChange>{{10s, "EARFCN 1300, PCI 12"}}));
}

TEST_F(LiveOverviewTest, TheLinesHoldTwoMinutesOfReadings) {
    startLte();
    deliver(idle(84, 200));
    pass(2s);
    deliver(idle(84, 204));
    pass(2s);
    pass(2s);  // nothing has come
    deliver(idle(84, 204));
    pass(2s);
    EXPECT_EQ(live->level().name, "RSRP");
    EXPECT_EQ(live->level().unit, "dBm");
    EXPECT_EQ(live->quality().name, "RSRQ");
    EXPECT_EQ(numbers(live->level()), (std::vector{-90.0, -89.0, -89.0}));
    EXPECT_EQ(numbers(live->quality()), (std::vector{-10.0, -10.0, -10.0}));
    EXPECT_EQ(live->level().points.front().at, 2s);
    pass(115s);
    live->letPass();
    EXPECT_EQ(live->lineTime(), 123s);
    EXPECT_EQ(live->level().points.front().at, 4s);
    pass(10s);
    live->letPass();
    EXPECT_TRUE(live->level().points.empty());
}

TEST_F(LiveOverviewTest, ASecondCarrierIsNoChangeOfCellWhicheverTheRefreshShows) {
    startLte();
    deliver(idle(84, 200));
    pass(2s);
    for (const char shown : std::string("221222112122212222222121")) {
        deliver(shown == '1' ? carrier(5780, 185) : carrier(1300, 84, 164));
        deliver(shown == '2' ? carrier(5780, 185) : carrier(1300, 84, 164));
        pass(2s);
        EXPECT_EQ(live->tracker().latest().cell, "EARFCN 1300, PCI 84");
    }
    EXPECT_EQ(kinds(), (std::vector{Kind::CellFound, Kind::State}));
    EXPECT_TRUE(live->servingCells().empty());
    EXPECT_EQ(live->tracker().latest().level->figure.text, "-99.00 dBm");
    ASSERT_EQ(live->tracker().cells().size(), 1u);
    EXPECT_EQ(live->tracker().cells()[0].heard.identity, "EARFCN 5780, PCI 185");
    EXPECT_EQ(live->tracker().cells()[0].heard.mark, "active");
}

TEST_F(LiveOverviewTest, AnotherCellOnTheServingChannelServesAtOnce) {
    startLte();
    deliver(carrier(1300, 84));
    pass(2s);
    deliver(carrier(5780, 185));
    pass(2s);
    deliver(carrier(1300, 12));
    pass(2s);
    EXPECT_EQ(live->tracker().latest().cell, "EARFCN 1300, PCI 12");
    EXPECT_EQ(kinds(), (std::vector{Kind::CellFound, Kind::Handover}));
}

TEST_F(LiveOverviewTest, ACarrierServesWhenTheServingOneIsNoLongerTold) {
    startLte();
    deliver(carrier(1300, 84));
    pass(2s);  // seen
    for (int refresh = 0; refresh < 13; ++refresh) {
        deliver(carrier(5780, 185));
        pass(2s);
        EXPECT_EQ(live->tracker().latest().cell, "EARFCN 1300, PCI 84");
    }
    deliver(carrier(5780, 185));
    pass(2s);
    EXPECT_EQ(live->tracker().latest().cell, "EARFCN 5780, PCI 185");
    EXPECT_EQ(kinds(), (std::vector{Kind::CellFound, Kind::Handover, Kind::Band}));
}

TEST_F(LiveOverviewTest, ACarrierThatIsNoLongerToldEitherServesNever) {
    startLte();
    deliver(carrier(1300, 84));
    pass(2s);
    deliver(carrier(5780, 185));
    for (int refresh = 0; refresh < 30; ++refresh) {
        deliver(test::Record(0xB0C1, 22).u8(20, 2).bytes());  // nothing of carriers
        pass(2s);
    }
    EXPECT_EQ(live->tracker().latest().cell, "EARFCN 1300, PCI 84");
    EXPECT_EQ(kinds(), (std::vector{Kind::CellFound}));
}

TEST_F(LiveOverviewTest, TheLinesStayShortHoweverOftenAModelRefreshes) {
    startLte();
    for (std::uint32_t i = 0; i < 300; ++i) {
        deliver(idle(i % 2 == 0 ? 84 : 12, i));
        live->refreshed();
    }
    EXPECT_EQ(live->level().points.size(), 128u);
    EXPECT_DOUBLE_EQ(live->level().points.back().number, -140 + 299 * 0.25);
    EXPECT_EQ(live->servingCells().size(), 128u);
}

TEST_F(LiveOverviewTest, CellsGetLostWhileNothingComes) {
    startLte();
    deliver(idle(84, 200));
    deliver(test::Record(0xB180, 41).u16(17, 1300).u32(21, 301 | 80u << 17).bytes());  // one cell, -100 dBm
    pass(2s);
    ASSERT_EQ(live->tracker().cells().size(), 1u);
    EXPECT_FALSE(live->tracker().cells()[0].isLost);
    pass(31s);
    live->letPass();
    EXPECT_TRUE(live->tracker().cells()[0].isLost);
    pass(10s);
    live->letPass();
    EXPECT_TRUE(live->tracker().cells().empty());
}

TEST_F(LiveOverviewTest, TellsOfTheConnectionsLossAndOfItsLength) {
    startLte();
    deliver(idle(84, 200));
    pass(2s);
    ports.killPeer();
    pass(2s);
    ASSERT_EQ(kinds(), (std::vector{Kind::CellFound, Kind::ConnectionLost}));
    EXPECT_EQ(last().time, Time(std::chrono::seconds(kNoon + 4)));
    pass(4s);
    ports.listening.insert("service");
    pass(10s);
    ASSERT_EQ(kinds(), (std::vector{Kind::CellFound, Kind::ConnectionLost, Kind::ConnectionBack}));
    EXPECT_EQ(last().to, "after 5.0 s");
    EXPECT_EQ(last().time, Time(std::chrono::seconds(kNoon + 9)));
    EXPECT_EQ(live->tracker().latest().cell, "EARFCN 1300, PCI 84");
    EXPECT_EQ(live->levelAge(), 16s);
}

TEST_F(LiveOverviewTest, TellsOfALossBetweenTwoLooks) {
    startLte();
    pass(2s);
    EXPECT_TRUE(kinds().empty());
    ports.killPeer();
    ports.listening.insert("service");
    pass(2s);
    live->letPass();
    ASSERT_EQ(kinds(), (std::vector{Kind::ConnectionLost, Kind::ConnectionBack}));
    EXPECT_EQ(last().to, "after 0.0 s");
}

TEST_F(LiveOverviewTest, BeforeTheFirstConnectionNothingIsLost) {
    ports.listening.clear();
    model->restartMonitor();
    pass(30s);
    EXPECT_FALSE(model->isConnected());
    EXPECT_TRUE(kinds().empty());
}

TEST_F(LiveOverviewTest, AnotherModemStartsAnewAndKeepsWhatHappened) {
    startLte();
    deliver(idle(84, 200));
    pass(2s);
    ports.onRequest = test::speaking(kGsm);
    model->restartMonitor();
    pass(2s);
    EXPECT_EQ(live->tracker().latest().cell, "");
    EXPECT_TRUE(live->level().points.empty());
    const std::vector before{Kind::CellFound, Kind::ConnectionLost, Kind::ConnectionBack};
    EXPECT_EQ(kinds(), before);

    ports.onRequest = test::speaking(kLte);
    model->restartMonitor();
    live->refreshed();
    EXPECT_EQ(live->tracker().latest().cell, "") << "of the modem before the last";
    deliver(idle(84, 204));
    pass(2s);
    EXPECT_EQ(live->tracker().latest().level->figure.text, "-89.00 dBm");
    EXPECT_EQ(last().kind, Kind::CellFound);
}

}  // namespace
}  // namespace kelvo::overview
