#include <gtest/gtest.h>

#include <QProcess>
#include <QProcessEnvironment>

#include "tests/support/TemporaryDirectory.h"

namespace kelvo {
namespace {

constexpr int kPatience = 20'000;  // milliseconds; a wait ends as soon as its condition holds

/// The program itself, as a process: how it starts, and with which status it ends.
class Program : public testing::Test {
protected:
    /// With nothing of a desktop but the named platform.
    void start(const char* platform, const QStringList& arguments = {},
               const QString& command = QStringLiteral(KELVO_PROGRAM)) {
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        for (const char* name : {"DISPLAY", "WAYLAND_DISPLAY", "WAYLAND_SOCKET", "DBUS_SESSION_BUS_ADDRESS"}) {
            environment.remove(QLatin1String(name));
        }
        environment.insert(QStringLiteral("XDG_RUNTIME_DIR"), QString::fromStdString(runtime.path().string()));
        environment.insert(QStringLiteral("QT_QPA_PLATFORM"), QLatin1String(platform));
        program.setProcessEnvironment(environment);
        program.start(command, arguments);
    }
    /// The same for a file, in a terminal.
    void startInTerminal(const char* platform, const char* file) {
        // "script" gives it a terminal, tells its status and shows what it says.
        start(platform,
              {QStringLiteral("-qec"), QStringLiteral(KELVO_PROGRAM " ") + QLatin1String(file),
               QStringLiteral("/dev/null")},
              QStringLiteral("script"));
    }
    /// The one line that it ends with, and nothing else, having failed in an orderly way.
    std::string lineOfFailure() {
        EXPECT_TRUE(program.waitForFinished(kPatience));
        EXPECT_EQ(program.exitStatus(), QProcess::NormalExit);
        EXPECT_EQ(program.exitCode(), 1);
        EXPECT_EQ(program.readAllStandardOutput(), QByteArray());
        const QByteArray said = program.readAllStandardError();
        EXPECT_EQ(said.count('\n'), 1) << said.constData();
        EXPECT_TRUE(said.endsWith('\n'));
        return said.trimmed().toStdString();
    }

    test::TemporaryDirectory runtime;
    QProcess program;
};

TEST_F(Program, SaysInOneLineThatThereIsNoDisplay) {
    start("xcb");
    EXPECT_EQ(lineOfFailure().find("kelvo: no window can be opened: "), 0U);
}

TEST_F(Program, SaysInOneLineThatThePlatformIsUnknown) {
    start("of-another-world");
    const std::string line = lineOfFailure();
    EXPECT_EQ(line.find("kelvo: no window can be opened: "), 0U);
    EXPECT_NE(line.find("of-another-world"), std::string::npos) << line;
}

TEST_F(Program, SaysInOneLineWhatIsWrongWithAFileAndInAWindowBehindAFileManager) {
    start("offscreen", {QStringLiteral("/nowhere/drive.pcap")});
    program.setReadChannel(QProcess::StandardError);
    ASSERT_TRUE(program.waitForReadyRead(kPatience));
    EXPECT_FALSE(program.waitForFinished(0));  // the window is there until somebody closes it
    program.terminate();
    EXPECT_EQ(lineOfFailure(), "kelvo: /nowhere/drive.pcap cannot be opened: No such file or directory");
}

TEST_F(Program, LeavesItAtThatLineInATerminal) {
    startInTerminal("offscreen", "/nowhere/drive.kelvo");
    ASSERT_TRUE(program.waitForFinished(kPatience));
    EXPECT_EQ(program.exitCode(), 1);
    EXPECT_EQ(program.readAllStandardOutput(),
              QByteArray("kelvo: /nowhere/drive.kelvo cannot be opened: No such file or directory\r\n"));
}

TEST_F(Program, LeavesTheSecondStartToTheFirstWindow) {
    start("offscreen");
    program.setReadChannel(QProcess::StandardError);
    ASSERT_TRUE(program.waitForReadyRead(kPatience));  // it has started, and looks for a telephony service
    QProcess second;
    second.setProcessEnvironment(program.processEnvironment());
    second.start(QStringLiteral(KELVO_PROGRAM), QStringList());
    ASSERT_TRUE(second.waitForFinished(kPatience));
    EXPECT_EQ(second.exitCode(), 0);
    EXPECT_EQ(second.readAllStandardError(), QByteArray());
    EXPECT_EQ(program.state(), QProcess::Running);
    program.terminate();
    ASSERT_TRUE(program.waitForFinished(kPatience));
}

TEST_F(Program, EndsWithZeroWhenItIsAskedToEnd) {
    start("offscreen");
    program.setReadChannel(QProcess::StandardError);
    ASSERT_TRUE(program.waitForReadyRead(kPatience));  // it has started, and looks for a telephony service
    program.terminate();
    ASSERT_TRUE(program.waitForFinished(kPatience));
    EXPECT_EQ(program.exitStatus(), QProcess::NormalExit);
    EXPECT_EQ(program.exitCode(), 0);
}

}  // namespace
}  // namespace kelvo
