#include <gtest/gtest.h>

#include <QProcess>
#include <nlohmann/json.hpp>

#include "tests/support/EventLoop.h"
#include "tests/support/RunProgram.h"

using namespace kelvo;

namespace {

// The program itself, beside a modem that is played.
class DoctorCommandTest : public testing::Test {
protected:
    std::string play(const QStringList& arguments) {
        _modem.start(KELVO_MODEM, QStringList{"--simulate", "lte"} + arguments);
        if (!test::runUntil([this] { return _modem.canReadLine(); })) return "no modem";
        return _modem.readLine().trimmed().toStdString();
    }
    ~DoctorCommandTest() override {
        _modem.terminate();
        _modem.waitForFinished(10'000);
    }
    static void expectAnswer(const std::string& place) {
        const auto done = test::run(KELVOCTL, {"doctor", "--port", place, "--probe"});
        EXPECT_EQ(done.status, 0) << done.errors;
        EXPECT_NE(done.output.find("it is \"PLAYED\", build \"KELVO-MODEM-1\"\n"), std::string::npos) << done.output;
        EXPECT_NE(done.output.find("  LTE screens    all 9\n"), std::string::npos) << done.output;
        EXPECT_TRUE(done.output.ends_with("\nNext: run \"kelvo-telephonyd --port " + place + "\", and then kelvo\n"))
            << done.output;
    }

    test::TemporaryDirectory _directory;
    QProcess _modem;
};

}  // namespace

TEST_F(DoctorCommandTest, AsksAModemOnALine) {
    const std::string link = _directory.file("modem");
    ASSERT_EQ(play({"--on", QString::fromStdString(link)}), link);
    expectAnswer(link);
    expectAnswer(link);  // and leaves it as it was
}

TEST_F(DoctorCommandTest, AsksAModemOnATcpPort) { expectAnswer(play({"--on", "tcp:0"})); }

TEST_F(DoctorCommandTest, AsksAModemOnAUnixSocket) {
    expectAnswer(play({"--on", QString::fromStdString("unix:" + _directory.file("socket"))}));
}

TEST_F(DoctorCommandTest, TellsWhatIsNotThere) {
    const std::string path = _directory.file("nothing");
    const auto done = test::run(KELVOCTL, {"doctor", "--port", path, "--probe", "--json"});
    EXPECT_EQ(done.status, 0) << done.errors;
    const auto json = nlohmann::json::parse(done.output);
    EXPECT_EQ(json["ports"][0]["exists"], false);
    EXPECT_EQ(json["next"], "plug the modem in: " + path + " is not there");
    const auto refused = test::run(KELVOCTL, {"doctor", "--port", "tcp:127.0.0.1:1", "--probe"});
    EXPECT_EQ(refused.status, 0);
    EXPECT_NE(refused.output.find("  asked          cannot be opened: "), std::string::npos) << refused.output;
}

TEST_F(DoctorCommandTest, WritesNoRuleForWhatUdevCannotKnow) {
    const auto done = test::run(KELVOCTL, {"doctor", "--port", "tcp:127.0.0.1:1", "--udev-rule"});
    EXPECT_EQ(done.status, 1);
    EXPECT_EQ(done.errors, "kelvoctl: tcp:127.0.0.1:1 is not on USB: udev cannot tell it from others\n");
}
