#include "overview/Tracker.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "tests/overview/Observations.h"

namespace kelvo::overview {
namespace {

using namespace std::chrono_literals;
using Kind = Event::Kind;

TEST(Tracker, AChangeOfCellOutOfAConnectionIsAReselection) {
    Tracker tracker;
    tracker.note(servedBy("A", 1), kStart);
    tracker.note(servedBy("A", 2, "-101.00 dBm"), kStart + 2s);
    tracker.note(servedBy("B", 3, "-88.00 dBm"), kStart + 4s);
    ASSERT_EQ(tracker.events().size(), 2u);
    EXPECT_EQ(tracker.events()[0].kind, Kind::CellFound);
    EXPECT_EQ(tracker.events()[0].to, "A");
    EXPECT_EQ(tracker.events()[0].levelBefore, "");
    const Event& change = tracker.events()[1];
    EXPECT_EQ(change.kind, Kind::Reselection);
    EXPECT_EQ(change.time, kStart + 4s);
    EXPECT_EQ(change.from, "A");
    EXPECT_EQ(change.to, "B");
    EXPECT_EQ(change.levelBefore, "-101.00 dBm");
    EXPECT_EQ(change.levelAfter, "-88.00 dBm");
    EXPECT_EQ(change.record, 3u);
}

TEST(Tracker, AChangeOfCellWithinAConnectionIsAHandover) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.isDedicated = true;
    tracker.note(seen, kStart);
    seen = servedBy("B", 2);
    seen.isDedicated = true;
    tracker.note(seen, kStart + 10ms);
    EXPECT_EQ(tracker.events().back().kind, Kind::Handover);
}

TEST(Tracker, AConnectionThatBeganWithTheNewCellIsNotHandedOver) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.state = "idle";
    tracker.note(seen, kStart);
    seen.state = "connected";  // which a record tells before the cell's
    seen.isDedicated = true;
    tracker.note(seen, kStart + 1s);
    seen.cell = "B";
    seen.cellRecord = 2;
    tracker.note(seen, kStart + 1s + 9ms);
    EXPECT_EQ(tracker.events().back().kind, Kind::Reselection);
}

TEST(Tracker, ALevelThatIsOlderThanTheChangeIsTheOldCells) {
    Tracker tracker;
    tracker.note(servedBy("A", 1, "-95.00 dBm"), kStart);
    Observation seen = servedBy("B", 3, "-95.00 dBm");
    seen.level->figure.record = 2;
    tracker.note(seen, kStart + 1s);
    EXPECT_EQ(tracker.events().back().levelAfter, "");
    tracker.note(servedBy("B", 4, "-80.00 dBm"), kStart + 2s);
    EXPECT_EQ(tracker.events().back().levelAfter, "-80.00 dBm");
    tracker.note(servedBy("B", 5, "-70.00 dBm"), kStart + 3s);
    EXPECT_EQ(tracker.events().back().levelAfter, "-80.00 dBm");
}

TEST(Tracker, ALevelOfLongAgoSaysNothingOfAChangeOfCell) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.isDedicated = true;
    tracker.note(seen, kStart);
    Observation later = seen;
    later.cell = "B";
    later.cellRecord = 2;
    tracker.note(later, kStart + 31s);
    EXPECT_EQ(tracker.events().back().kind, Kind::Reselection);
    EXPECT_EQ(tracker.events().back().levelBefore, "");
}

TEST(Tracker, AnotherRadioIsOneEventAndNotThree) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.band = "3";
    seen.state = "idle";
    tracker.note(seen, kStart);
    Observation later = servedBy("B", 2);
    later.access = "UMTS";
    later.band = "I";
    later.state = "CELL_DCH";
    tracker.note(later, kStart + 1s);
    ASSERT_EQ(tracker.events().size(), 3u);
    EXPECT_EQ(tracker.events()[1].kind, Kind::Reselection);
    EXPECT_EQ(tracker.events()[2].kind, Kind::Access);
}

TEST(Tracker, APhoneThatNeverHadServiceHasNotLostIt) {
    Tracker tracker;
    Observation seen;
    tracker.note(seen, kStart - 1s);
    seen.knowsService = true;
    seen.isWithoutService = true;
    tracker.note(seen, kStart);
    EXPECT_TRUE(tracker.events().empty());
    seen.isWithoutService = false;
    tracker.note(seen, kStart + 2s);
    ASSERT_EQ(tracker.events().size(), 1u);
    EXPECT_EQ(tracker.events().back().kind, Kind::ServiceBack);
    EXPECT_EQ(tracker.events().back().to, "after 2.0 s");
}

TEST(Tracker, TheServingCellIsNoneOfThoseAround) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.cells = {heard("B", -80, 1), heard("A", -90, 1)};
    tracker.note(seen, kStart);
    EXPECT_EQ(identities(tracker), (std::vector<std::string>{"B"}));
    Observation later = servedBy("B", 2);
    later.cells = {heard("A", -91, 2)};
    tracker.note(later, kStart + 1s);
    EXPECT_EQ(identities(tracker), (std::vector<std::string>{"A"}));
}

TEST(Tracker, StatesAreToldWhenTheyChangeAndNotWhenTheyAppear) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    tracker.note(seen, kStart);
    seen.state = "idle";
    seen.area = "TAC 1";
    seen.registrationState = "GMM_REGISTERED";
    tracker.note(seen, kStart + 1s);
    EXPECT_EQ(tracker.events().size(), 1u);
    seen.state = "connected";
    seen.area = "TAC 2";
    seen.registrationState = "GMM_DEREGISTERED";
    seen.reject = "LOCATION_AREA_NOT_ALLOWED";
    tracker.note(seen, kStart + 2s);
    ASSERT_EQ(tracker.events().size(), 5u);
    EXPECT_EQ(tracker.events()[1].kind, Kind::State);
    EXPECT_EQ(tracker.events()[2].kind, Kind::Area);
    EXPECT_EQ(tracker.events()[2].from, "TAC 1");
    EXPECT_EQ(tracker.events()[2].to, "TAC 2");
    EXPECT_EQ(tracker.events()[3].kind, Kind::Registration);
    EXPECT_EQ(tracker.events()[4].kind, Kind::Reject);
    EXPECT_EQ(tracker.events()[4].to, "LOCATION_AREA_NOT_ALLOWED");
}

TEST(Tracker, TheAreasPartsAreOneChange) {
    Tracker tracker;
    const auto see = [&](const char* area, Time::duration after) {
        Observation seen = servedBy("A", 1);
        seen.area = area;
        tracker.note(seen, kStart + after);
    };
    see("URA 1", 0s);
    see("LAC 11, URA 1", 1s);  // which was not known before
    EXPECT_EQ(tracker.events().size(), 1u);
    see("LAC 11, URA 2", 10s);
    see("LAC 12, URA 2", 12s);
    ASSERT_EQ(tracker.events().size(), 2u);
    EXPECT_EQ(tracker.events()[1].time, kStart + 10s);
    EXPECT_EQ(tracker.events()[1].from, "LAC 11, URA 1");
    EXPECT_EQ(tracker.events()[1].to, "LAC 12, URA 2");
    EXPECT_EQ(tracker.events()[1].values.back(), (EventValue{"Area", "LAC 11, URA 1", "LAC 12, URA 2"}));
    see("LAC 13, URA 2", 12s);  // the same part again: another change
    ASSERT_EQ(tracker.events().size(), 3u);
    see("LAC 13, URA 3", 14s + 1us);  // too late to be of it
    EXPECT_EQ(tracker.events().size(), 4u);
    EXPECT_EQ(tracker.events()[3].from, "LAC 13, URA 2");
}

TEST(Tracker, AnAreaThatComesBackIsNoChangeAndAnotherIs) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    for (const char* area : {"LAC 11", "", "LAC 11", "", "LAC 12"}) {
        seen.area = area;
        tracker.note(seen, kStart);
    }
    ASSERT_EQ(tracker.events().size(), 2u);
    EXPECT_EQ(tracker.events()[1].from, "LAC 11");
    EXPECT_EQ(tracker.events()[1].to, "LAC 12");
}

TEST(Tracker, ACellWhoseCodeComesLaterIsOneChange) {
    Tracker tracker;
    const auto see = [&](const char* cell, std::uint64_t record, Time::duration after) {
        Observation seen = servedBy(cell, record);
        seen.cellComesInParts = true;
        tracker.note(seen, kStart + after);
    };
    see("ARFCN 21, BSIC 44", 1, 0s);
    see("ARFCN 23, BSIC 44", 2, 10s);
    see("ARFCN 23, BSIC 42", 3, 11s);
    ASSERT_EQ(tracker.events().size(), 2u);
    EXPECT_EQ(tracker.events()[1].time, kStart + 10s);
    EXPECT_EQ(tracker.events()[1].from, "ARFCN 21, BSIC 44");
    EXPECT_EQ(tracker.events()[1].to, "ARFCN 23, BSIC 42");
    EXPECT_EQ(tracker.events()[1].values[0], (EventValue{"Cell", "ARFCN 21, BSIC 44", "ARFCN 23, BSIC 42"}));
    see("ARFCN 25, BSIC 42", 4, 12s);
    EXPECT_EQ(tracker.events().size(), 3u);
}

TEST(Tracker, WithTheStateInTheNewCellAChangeIsAHandover) {
    for (const auto& [after, kind] : {std::pair(2s, Kind::Handover), std::pair(3s, Kind::Reselection)}) {
        Tracker tracker;
        Observation seen = servedBy("A", 1);
        seen.isDedicated = true;
        tracker.note(seen, kStart);
        seen = servedBy("B", 2);
        tracker.note(seen, kStart + 1s);
        EXPECT_EQ(tracker.events()[1].kind, Kind::Reselection);
        seen.isDedicated = true;
        tracker.note(seen, kStart + 1s + after);
        EXPECT_EQ(tracker.events()[1].kind, kind);
    }
}

TEST(Tracker, WhileTheStateIsNotKnownAPhoneIsAsItWas) {
    for (const auto& [between, kind] : {std::pair("", Kind::Handover), std::pair("idle", Kind::Reselection)}) {
        Tracker tracker;
        Observation seen = servedBy("A", 1);
        seen.state = "connected";
        seen.isDedicated = true;
        tracker.note(seen, kStart);
        seen.state = between;
        seen.isDedicated = false;
        tracker.note(seen, kStart + 100ms);
        seen = servedBy("B", 2);
        seen.state = "connected";
        seen.isDedicated = true;
        tracker.note(seen, kStart + 200ms);
        const auto& events = tracker.events();
        const auto change = std::ranges::find(events, std::string("B"), &Event::to);
        ASSERT_NE(change, events.end());
        EXPECT_EQ(change->kind, kind);
    }
}

TEST(Tracker, CarriersThatAreToldInTurnAreNoHandovers) {
    Tracker tracker;
    std::uint64_t record = 0;
    const auto see = [&](const char* cell, const char* level, Time::duration after) {
        Observation seen = servedBy(cell, ++record, level);
        seen.isDedicated = seen.cellIsOneOfSeveral = true;
        tracker.note(seen, kStart + after);
    };
    for (int turn = 0; turn < 10; ++turn) {
        see("A", "-109.00 dBm", turn * 160ms);
        see("B", "-107.00 dBm", turn * 160ms + 40ms);
    }
    EXPECT_EQ(tracker.events().size(), 1u);
    EXPECT_EQ(tracker.latest().cell, "A");
    EXPECT_EQ(tracker.latest().level->figure.text, "-109.00 dBm");
    EXPECT_EQ(identities(tracker), std::vector<std::string>{"B"});
    EXPECT_EQ(tracker.cells()[0].heard.mark, "active");
    see("B", "-106.00 dBm", 1600ms);
    EXPECT_EQ(tracker.events().size(), 1u);
    see("B", "-106.00 dBm", 2s);  // of A nothing has come for half a second
    ASSERT_EQ(tracker.events().size(), 2u);
    EXPECT_EQ(tracker.events()[1].kind, Kind::Handover);
    EXPECT_EQ(tracker.events()[1].to, "B");
}

TEST(Tracker, AFigureThatARecordLeftOutStaysAndAges) {
    Tracker tracker;
    tracker.note(servedBy("A", 1, "-90.00 dBm"), kStart);
    Observation seen = servedBy("A", 2);
    seen.level.reset();
    tracker.note(seen, kStart + 5s);
    EXPECT_EQ(tracker.latest().level->figure.text, "-90.00 dBm");
    EXPECT_EQ(tracker.levelTime(), kStart);
    seen.cell = "B";
    seen.cellRecord = 3;
    tracker.note(seen, kStart + 6s);
    EXPECT_FALSE(tracker.latest().level);
}

TEST(Tracker, ContextsComeAndGo) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.contexts = {{"internet (5)", "Active", true}, {"ims (6)", "Inactive", false}};
    tracker.note(seen, kStart);
    seen.contexts = {{"internet (5)", "Inactive", false}, {"ims (6)", "Active", true}};
    tracker.note(seen, kStart + 1s);
    ASSERT_EQ(tracker.events().size(), 4u);
    EXPECT_EQ(tracker.events()[1].kind, Kind::ContextUp);
    EXPECT_EQ(tracker.events()[1].to, "internet (5)");
    EXPECT_EQ(tracker.events()[2].kind, Kind::ContextDown);
    EXPECT_EQ(tracker.events()[2].from, "internet (5)");
    EXPECT_EQ(tracker.events()[3].kind, Kind::ContextUp);
    EXPECT_EQ(tracker.events()[3].to, "ims (6)");
}

TEST(Tracker, LossOfServiceHasALength) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.knowsService = true;
    tracker.note(seen, kStart);
    seen.isWithoutService = true;
    tracker.note(seen, kStart + 1s);
    seen.isWithoutService = false;
    tracker.note(seen, kStart + 13500ms);
    ASSERT_EQ(tracker.events().size(), 3u);
    EXPECT_EQ(tracker.events()[1].kind, Kind::ServiceLost);
    EXPECT_EQ(tracker.events()[2].kind, Kind::ServiceBack);
    EXPECT_EQ(tracker.events()[2].to, "after 12.5 s");
}

TEST(Tracker, EventsAreKeptForADayAndNoMoreThanTwoThousand) {
    Tracker tracker;
    for (std::uint64_t i = 0; i < 2500; ++i) tracker.note(servedBy(i % 2 == 0 ? "A" : "B", i + 1), kStart);
    EXPECT_EQ(tracker.events().size(), 2000u);
    EXPECT_EQ(tracker.events().front().record, 501u);
    tracker.note(servedBy("C", 3000), kStart + 24h + 1s);
    EXPECT_EQ(tracker.events().size(), 1u);

    Tracker patient({.events = 3000, .span = 48h});
    for (std::uint64_t i = 0; i < 2500; ++i) patient.note(servedBy(i % 2 == 0 ? "A" : "B", i + 1), kStart);
    patient.note(servedBy("C", 3000), kStart + 24h + 1s);
    EXPECT_EQ(patient.events().size(), 2501u);
}

TEST(Tracker, AnEventTellsTheValuesBeforeAndAfter) {
    Tracker tracker;
    Observation seen = servedBy("A", 1, "-101.00 dBm");
    seen.area = "TAC 1";
    seen.serving = {{"Band", "3"}, {"Network", "262-01"}};
    tracker.note(seen, kStart);
    Observation later = servedBy("B", 3, "-101.00 dBm");
    later.level->figure.record = 2;  // the old cell's still
    later.area = "TAC 2";
    later.serving = {{"Band", "20"}, {"Network", "262-01"}, {"Bandwidth", "10 MHz"}};
    tracker.note(later, kStart + 2s);
    const std::vector<EventValue> values = {{"Cell", "A", "B"},
                                            {"RSRP", "-101.00 dBm", ""},
                                            {"Area", "TAC 1", "TAC 2"},
                                            {"Band", "3", "20"},
                                            {"Bandwidth", "", "10 MHz"}};
    ASSERT_EQ(tracker.events().size(), 3u);
    EXPECT_EQ(tracker.events()[1].kind, Kind::Reselection);
    EXPECT_EQ(tracker.events()[1].values, values);
    EXPECT_EQ(tracker.events()[2].kind, Kind::Area);
    EXPECT_EQ(tracker.events()[2].values, values);

    later.level = rsrp("-88.00 dBm", -88, 4);
    later.quality = Measure{"RSRQ", {"-9.00 dB", -9, "dB", 4}, ""};
    tracker.note(later, kStart + 3s);
    EXPECT_EQ(tracker.events()[1].levelAfter, "-88.00 dBm");
    EXPECT_EQ(tracker.events()[1].values[1], (EventValue{"RSRP", "-101.00 dBm", "-88.00 dBm"}));
    EXPECT_EQ(tracker.events()[1].values.back(), (EventValue{"RSRQ", "", "-9.00 dB"}));
    EXPECT_EQ(tracker.events()[2].values[1], (EventValue{"RSRP", "-101.00 dBm", "-88.00 dBm"}));
}

TEST(Tracker, LevelsOfTwoRadiosAreTwoValues) {
    Tracker tracker;
    tracker.note(servedBy("A", 1, "-95.00 dBm"), kStart);
    Observation seen = servedBy("B", 2, "-80.00 dBm");
    seen.access = "UMTS";
    seen.level->name = "RSCP";
    tracker.note(seen, kStart + 2s);
    EXPECT_EQ(
        tracker.events()[1].values,
        (std::vector<EventValue>{
            {"Cell", "A", "B"}, {"RSRP", "-95.00 dBm", ""}, {"RSCP", "", "-80.00 dBm"}, {"Radio", "LTE", "UMTS"}}));
}

TEST(Tracker, TwoThousandEventsHoldSixMegabytesAtMost) {
    Tracker tracker;
    for (int i = 0; i < 700; ++i) {
        Observation seen;
        const std::string text = std::string(9, static_cast<char>('a' + i % 2)) + std::string(300, 'x');
        seen.cell = seen.access = seen.state = seen.area = seen.registrationState = text;
        seen.cellRecord = static_cast<std::uint64_t>(i) + 1;
        seen.level = Measure{text, {text, -90, "dBm", seen.cellRecord}, ""};
        for (int fact = 0; fact < 20; ++fact) seen.serving.push_back({std::to_string(fact) + text, text});
        tracker.note(seen, kStart);
    }
    ASSERT_EQ(tracker.events().size(), 2000u);
    std::size_t bytes = 0;
    const auto count = [&](const std::string& text) { bytes += text.capacity() > 15 ? text.capacity() + 17 : 0; };
    for (const Event& event : tracker.events()) {
        bytes += sizeof event + event.values.capacity() * sizeof(EventValue);
        for (const std::string* text : {&event.from, &event.to, &event.levelBefore, &event.levelAfter}) count(*text);
        for (const EventValue& value : event.values) {
            for (const std::string* text : {&value.name, &value.before, &value.after}) count(*text);
        }
    }
    EXPECT_LT(bytes, 6'000'000u);
    EXPECT_EQ(tracker.events().back().from.size(), 128u);
    EXPECT_EQ(tracker.events().back().values.size(), 8u);
    EXPECT_EQ(tracker.events().back().values[0].before.size(), 48u);
}

TEST(Tracker, ATextIsNotCutWithinACharacter) {
    Tracker tracker;
    tracker.note(servedBy(("A" + std::string(126, 'x') + "\xC3\xA4").c_str(), 1), kStart);
    EXPECT_EQ(tracker.events()[0].to, "A" + std::string(126, 'x'));
}

TEST(Tracker, TheConnectionsLossHasALengthAndTheTimeOfDay) {
    Tracker tracker;
    tracker.note(servedBy("A", 1), Time(5s), kStart);
    EXPECT_EQ(tracker.events()[0].time, kStart);
    EXPECT_EQ(tracker.levelTime(), Time(5s));
    tracker.noteConnectionLost(kStart + 1s);
    tracker.noteConnectionBack(kStart + 8s, 7s);
    EXPECT_EQ(tracker.events()[1].kind, Kind::ConnectionLost);
    EXPECT_EQ(tracker.events()[2].kind, Kind::ConnectionBack);
    EXPECT_EQ(tracker.events()[2].to, "after 7.0 s");
    tracker.restart();
    EXPECT_EQ(tracker.events().size(), 3u);
    EXPECT_EQ(tracker.latest().cell, "");
    EXPECT_EQ(tracker.levelTime(), std::nullopt);
}

}  // namespace
}  // namespace kelvo::overview
