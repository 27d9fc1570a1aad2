#include "ui/EventRows.h"

#include <gtest/gtest.h>

#include <QSignalSpy>

#include "platform/system/Environment.h"
#include "tests/support/ManualClock.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using overview::Event;

class EventRowsTest : public testing::Test {
protected:
    static constexpr long long kNoon = 1795348800;  // 2026-11-22 12:00 UTC

    void happen(std::chrono::seconds after, const char* to) {
        events.push_back({.time = overview::Time(std::chrono::seconds(kNoon)) + after,
                          .kind = Event::Kind::State,
                          .from = "idle",
                          .to = to});
    }
    QString textAt(int row, int role) const { return rows.data(rows.index(row), role).toString(); }

    test::ManualClock clock{kNoon};
    Environment::Scope environment{{.clock = &clock}};
    std::deque<Event> events;
    EventRows rows;
};

TEST_F(EventRowsTest, TellsOfNewOnesAsRowsAtTheTop) {
    happen(1s, "connected");
    rows.update(events);
    QSignalSpy inserted(&rows, &EventRows::rowsInserted);
    QSignalSpy changed(&rows, &EventRows::dataChanged);
    happen(2s, "busy");
    happen(2s, "asleep");
    rows.update(events);
    ASSERT_EQ(inserted.count(), 1);
    EXPECT_EQ(inserted[0][1].toInt(), 0);
    EXPECT_EQ(inserted[0][2].toInt(), 1);
    EXPECT_EQ(changed.count(), 0);
    EXPECT_EQ(textAt(0, EventRows::WhatRole), QString::fromUtf8("idle → asleep"));
    EXPECT_EQ(textAt(1, EventRows::WhatRole), QString::fromUtf8("idle → busy"));
    EXPECT_EQ(textAt(2, EventRows::TimeRole), QStringLiteral("12:00:01"));
}

TEST_F(EventRowsTest, TellsTheDayOfAnotherDay) {
    happen(-13h, "connected");
    happen(0s, "busy");
    rows.update(events);
    EXPECT_EQ(textAt(0, EventRows::DayRole), QString());
    EXPECT_EQ(textAt(1, EventRows::DayRole), QStringLiteral("2026-11-21"));
    EXPECT_EQ(textAt(1, EventRows::SentenceRole),
              QStringLiteral("2026-11-21, 23:00:00, State change, from idle to connected"));
}

TEST_F(EventRowsTest, FillsInWhatComesLater) {
    happen(1s, "connected");
    rows.update(events);
    EXPECT_FALSE(rows.data(rows.index(0), EventRows::OpensRole).toBool());
    QSignalSpy changed(&rows, &EventRows::dataChanged);
    events[0].levelAfter = "-80 dBm";
    events[0].values = {{"RSRP", "-95 dBm", "-80 dBm"}};
    rows.update(events);
    EXPECT_EQ(changed.count(), 1);
    EXPECT_EQ(textAt(0, EventRows::LevelsRole), QStringLiteral("-80 dBm"));
    EXPECT_TRUE(rows.data(rows.index(0), EventRows::OpensRole).toBool());
}

TEST_F(EventRowsTest, ShowsTwentyAndMoreOnRequest) {
    for (int i = 0; i < 2000; ++i) happen(std::chrono::seconds(i), "connected");
    rows.update(events);
    EXPECT_EQ(rows.count(), 20);
    EXPECT_TRUE(rows.hasMore());
    rows.showMore(events);
    EXPECT_EQ(rows.count(), 70);
    events.pop_front();
    happen(2000s, "busy");
    rows.update(events);
    EXPECT_EQ(rows.count(), 70);
    EXPECT_EQ(textAt(0, EventRows::WhatRole), QString::fromUtf8("idle → busy"));
    EXPECT_EQ(textAt(69, EventRows::TimeRole), QStringLiteral("12:32:11"));  // 69 seconds before the newest
}

TEST_F(EventRowsTest, OfAFullListTheOldestRowBecomesTheNewest) {
    for (int i = 0; i < 20; ++i) happen(std::chrono::seconds(i), "connected");
    events[0].values = {{"RSRP", "-95 dBm", "-80 dBm"}};
    rows.update(events);
    rows.toggle(19);
    QSignalSpy moved(&rows, &EventRows::rowsMoved);
    QSignalSpy inserted(&rows, &EventRows::rowsInserted);
    QSignalSpy removed(&rows, &EventRows::rowsRemoved);
    happen(20s, "busy");
    happen(21s, "asleep");
    rows.update(events);
    ASSERT_EQ(moved.count(), 1);
    EXPECT_EQ(moved[0][1].toInt(), 18);
    EXPECT_EQ(moved[0][2].toInt(), 19);
    EXPECT_EQ(moved[0][4].toInt(), 0);
    EXPECT_EQ(inserted.count() + removed.count(), 0);
    EXPECT_EQ(rows.count(), 20);
    EXPECT_EQ(textAt(0, EventRows::TimeRole), QStringLiteral("12:00:21"));
    EXPECT_EQ(textAt(1, EventRows::WhatRole), QString::fromUtf8("idle → busy"));
    EXPECT_EQ(textAt(2, EventRows::TimeRole), QStringLiteral("12:00:19"));
    EXPECT_EQ(textAt(19, EventRows::TimeRole), QStringLiteral("12:00:02"));
    EXPECT_FALSE(rows.hasOpen());
}

TEST_F(EventRowsTest, TakesUpMoreNewOnesThanItHasRows) {
    happen(0s, "connected");
    rows.update(events);
    for (int i = 1; i < 50; ++i) happen(std::chrono::seconds(i), "busy");
    rows.update(events);
    EXPECT_EQ(rows.count(), 20);
    EXPECT_EQ(textAt(0, EventRows::TimeRole), QStringLiteral("12:00:49"));
    EXPECT_EQ(textAt(19, EventRows::TimeRole), QStringLiteral("12:00:30"));
    for (int i = 50; i < 80; ++i) happen(std::chrono::seconds(i), "idle");
    rows.update(events);
    EXPECT_EQ(rows.count(), 20);
    EXPECT_EQ(textAt(0, EventRows::TimeRole), QStringLiteral("12:01:19"));
    EXPECT_EQ(textAt(19, EventRows::TimeRole), QStringLiteral("12:01:00"));
}

TEST_F(EventRowsTest, ForgetsWhatIsNoLongerKept) {
    for (int i = 0; i < 5; ++i) happen(std::chrono::seconds(i), "connected");
    rows.update(events);
    events.erase(events.begin(), events.begin() + 3);
    rows.update(events);
    EXPECT_EQ(rows.count(), 2);
    EXPECT_EQ(textAt(1, EventRows::TimeRole), QStringLiteral("12:00:03"));
}

TEST_F(EventRowsTest, OpensOneAtATimeAndOnlyWhatHasValues) {
    for (int i = 0; i < 3; ++i) happen(std::chrono::seconds(i), "connected");
    events[1].values = events[2].values = {{"RSRP", "-95 dBm", "-80 dBm"}};
    rows.update(events);
    rows.toggle(0);
    rows.toggle(1);
    EXPECT_FALSE(rows.data(rows.index(0), EventRows::IsOpenRole).toBool());
    EXPECT_TRUE(rows.data(rows.index(1), EventRows::IsOpenRole).toBool());
    rows.toggle(2);
    EXPECT_FALSE(rows.hasOpen());
    EXPECT_FALSE(rows.closeAll());
    rows.toggle(0);
    EXPECT_TRUE(rows.closeAll());
}

}  // namespace
}  // namespace kelvo
