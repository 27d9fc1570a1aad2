#include <gtest/gtest.h>

#include <QQuickItem>

#include "platform/telephony/TelephonyProtocol.h"
#include "tests/ui/ScreenFixture.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using test::sampleTree;
using test::Scene;
using test::text;

/// What the screen says when no readings come, and why.
class ConnectionHints : public test::ScreenFixture {
protected:
    /// Launched and shown; nothing has run yet.
    Scene& launch() {
        scene = std::make_unique<Scene>();
        return *scene;
    }
    void expectInPlaceOfRows(const char* reason) {
        scene->settle();
        EXPECT_TRUE(scene->shows(text(reason))) << reason;
        EXPECT_EQ(rows(), 0);
    }
    int rows() { return scene->app().navigation()->topViewController().rowCount(); }
    QQuickItem* inToolbar(const char* name) {
        return scene->itemOfType("StatusBar")->findChild<QQuickItem*>(text(name));
    }
    /// The quiet line; empty when it is not there.
    std::string note() {
        const QQuickItem* item = inToolbar("note");
        return item->isVisible() ? item->property("text").toString().toStdString() : std::string();
    }
    std::string status() { return inToolbar("status")->property("text").toString().toStdString(); }
    static QRectF areaOf(const QQuickItem* item) { return item->mapRectToScene({0, 0, item->width(), item->height()}); }
    static QRectF drawnAreaOf(const QQuickItem* item) {
        return item->mapRectToScene({0, 0, item->implicitWidth(), item->implicitHeight()});
    }
};

TEST_F(ConnectionHints, WaitAtFirst) {
    launch();
    expectInPlaceOfRows("Waiting for the modem");
    EXPECT_EQ(note(), "");
}

TEST_F(ConnectionHints, SayThatNoServiceIsRunningAndWhatComesAfterThat) {
    launch().telephony.reachable = false;
    scene->connect();
    expectInPlaceOfRows("No telephony service is running");
    EXPECT_EQ(note(), "");  // it is said already
    EXPECT_EQ(status(), "Connecting");
    scene->telephony.reachable = true;
    scene->pass(5s);
    expectInPlaceOfRows("Waiting for the modem");
    EXPECT_FALSE(scene->shows(text("No telephony service is running")));
    scene->show(sampleTree(3));
    EXPECT_EQ(rows(), 3);
    EXPECT_FALSE(scene->shows(text("Waiting for the modem")));
}

TEST_F(ConnectionHints, SayThatKelvoIsAlreadyOpen) {
    launch().ports.taken.insert("com.zorvik.BasebandStateReport.LogChannel");
    scene->connect();
    expectInPlaceOfRows("Kelvo is already open");
    scene->ports.taken.clear();  // the other one was closed
    scene->pass(5s);
    expectInPlaceOfRows("Waiting for the modem");
}

TEST_F(ConnectionHints, SayThatTheServiceDoesNotAnswer) {
    launch().telephony.answer = {.error = {.domain = kPLErrorDomainClient, .error = kPLErrorNoAnswer}, .portName = ""};
    scene->connect();
    expectInPlaceOfRows("The telephony service does not answer");
}

TEST_F(ConnectionHints, SayThatTheModemSendsNothing) {
    launch().connect();
    scene->pass(8s);
    expectInPlaceOfRows("Waiting for the modem");
    EXPECT_EQ(note(), "");
    scene->pass(2s);
    expectInPlaceOfRows("The modem sends nothing");
    EXPECT_EQ(note(), "No records for 10 s");
    scene->pass(14s);
    expectInPlaceOfRows("The modem sends nothing");
    EXPECT_EQ(note(), "No records for 24 s");
    scene->show(sampleTree(3));
    scene->settle();
    EXPECT_EQ(note(), "");
    EXPECT_FALSE(scene->shows(text("The modem sends nothing")));
    EXPECT_EQ(rows(), 3);
}

TEST_F(ConnectionHints, TellHowLongRecordsHaveStayedAway) {
    start();  // two seconds after the last record
    scene->pass(6s);
    EXPECT_EQ(note(), "");
    scene->pass(2s);
    EXPECT_EQ(note(), "No records for 10 s");
    scene->pass(14s);
    EXPECT_EQ(note(), "No records for 24 s");
    EXPECT_EQ(status(), "Updated 2011-03-04 at 09:15:04");
    scene->show(sampleTree(3));
    EXPECT_EQ(note(), "");
    EXPECT_EQ(status(), "Updated 2011-03-04 at 09:15:28");
}

TEST_F(ConnectionHints, AreOnEveryPaneThatIsShown) {
    start();
    scene->pass(22s);
    scene->tapText(text("Serving Cell"));
    expectTop("Serving Cell");
    EXPECT_EQ(note(), "No records for 24 s");
    scene->pass(2s);
    EXPECT_EQ(note(), "No records for 26 s");
    scene->press(Qt::Key_Escape);
    expectTop("Kelvo");
    EXPECT_EQ(note(), "No records for 26 s");
}

TEST_F(ConnectionHints, TellWhyTheConnectionIsLostBesideTheValuesThatStay) {
    start();
    scene->loseService();
    scene->pass(2s);
    scene->settle();
    EXPECT_EQ(status(), "Connecting...");
    EXPECT_EQ(note(), "No telephony service is running");
    EXPECT_EQ(rows(), 3);
    scene->reviveService();
    scene->pass(5s);
    EXPECT_EQ(note(), "");
}

/// Windows of every width have the same toolbar with the quiet line and without it.
class QuietLine : public ConnectionHints, public testing::WithParamInterface<int> {};

TEST_P(QuietLine, MovesNothingAndCoversNothing) {
    start(true, {GetParam(), 640});
    const QQuickItem* list = scene->itemOfType("QQuickListView");
    const QQuickItem* toolbar = scene->itemOfType("StatusBar");
    const QQuickItem* save = scene->itemWithText(text("Save"));
    const QRectF before[] = {areaOf(list), areaOf(toolbar), drawnAreaOf(inToolbar("status")), areaOf(save)};
    scene->pass(22s);
    scene->settle();
    ASSERT_EQ(note(), "No records for 24 s");
    const QRectF after[] = {areaOf(list), areaOf(toolbar), drawnAreaOf(inToolbar("status")), areaOf(save)};
    for (int part = 0; part < 4; ++part) EXPECT_EQ(after[part], before[part]) << part;

    const QRectF line = drawnAreaOf(inToolbar("note"));
    EXPECT_EQ(line.left(), after[2].left());
    EXPECT_GE(line.top(), after[2].bottom() - 1);  // the room of letters that reach below the line
    EXPECT_LE(line.bottom(), after[1].bottom());
    EXPECT_LE(line.right(), after[3].left());
}

INSTANTIATE_TEST_SUITE_P(Widths, QuietLine, testing::Values(240, 360, 412, 1280));

}  // namespace
}  // namespace kelvo
