#include "telephony/line/HostModemLines.h"

#include <gtest/gtest.h>
#include <termios.h>
#include <unistd.h>

#include <QLocalServer>
#include <QLocalSocket>
#include <QTcpServer>
#include <QTcpSocket>
#include <fstream>

#include "tests/support/EventLoop.h"
#include "tests/support/PseudoTerminal.h"
#include "tests/support/TemporaryDirectory.h"

namespace kelvo {
namespace {

using test::PseudoTerminal;
using test::runUntil;

struct Heard final : ModemLine::Listener {
    void lineOpened() override { ++opened; }
    void lineGave(std::span<std::uint8_t> bytes) override { given.insert(given.end(), bytes.begin(), bytes.end()); }
    void lineClosed(const std::string& reason) override { closed.push_back(reason); }

    int opened = 0;
    Bytes given;
    std::vector<std::string> closed;
};

Result<std::unique_ptr<ModemLine>> lineTo(const std::string& address, Heard& heard) {
    HostModemLines lines(*PortAddress::parse(address, false), {});
    return lines.next(heard, false);
}

const Bytes kFrame{0x00, 0x0D, 0x0A, 0x11, 0x13, 0x03, 0x04, 0x7F, 0xFF, 0x7E};  // what a terminal would interpret

}  // namespace

TEST(SerialLine, CarriesEveryByteBothWays) {
    PseudoTerminal terminal;
    Heard heard;
    auto line = lineTo(terminal.path, heard);
    ASSERT_TRUE(line);
    (*line)->open();
    ASSERT_EQ(heard.opened, 1) << (heard.closed.empty() ? "" : heard.closed[0]);
    EXPECT_EQ((*line)->name(), terminal.path);
    (*line)->send(kFrame);
    Bytes sent;
    ASSERT_TRUE(runUntil([&] {
        const Bytes more = terminal.read();
        sent.insert(sent.end(), more.begin(), more.end());
        return sent.size() >= kFrame.size();
    }));
    EXPECT_EQ(sent, kFrame);
    ASSERT_EQ(::write(terminal.modem.get(), kFrame.data(), kFrame.size()), static_cast<ssize_t>(kFrame.size()));
    ASSERT_TRUE(runUntil([&] { return heard.given.size() >= kFrame.size(); }));
    EXPECT_EQ(heard.given, kFrame);
    EXPECT_TRUE(heard.closed.empty());
}

TEST(SerialLine, GivesAllThatGathersAndAtOnceWhatIsWaitedFor) {
    PseudoTerminal terminal;
    Heard heard;
    auto line = lineTo(terminal.path, heard);
    (*line)->open();
    for (const bool gathers : {true, false, true}) {
        (*line)->mayGather(gathers);
        heard.given.clear();
        Bytes sent;
        for (int piece = 0; piece < 20; ++piece) {
            ASSERT_TRUE(terminal.write(kFrame));
            sent.insert(sent.end(), kFrame.begin(), kFrame.end());
            test::settle();
        }
        ASSERT_TRUE(runUntil([&] { return heard.given.size() >= sent.size(); }));
        EXPECT_EQ(heard.given, sent);
    }
    ASSERT_TRUE(terminal.write(kFrame));  // into a rest, and the modem goes
    terminal.modem.reset();
    ASSERT_TRUE(runUntil([&] { return !heard.closed.empty(); }));
}

TEST(SerialLine, TellsOnceThatTheModemHasGone) {
    PseudoTerminal terminal;
    Heard heard;
    auto line = lineTo(terminal.path, heard);
    (*line)->open();
    ASSERT_EQ(heard.opened, 1);
    terminal.modem.reset();
    ASSERT_TRUE(runUntil([&] { return !heard.closed.empty(); }));
    test::settle();
    EXPECT_EQ(heard.closed.size(), 1U);
}

TEST(SerialLine, IsNeverTheControllingTerminal) {
    PseudoTerminal terminal;
    Heard heard;
    auto line = lineTo(terminal.path, heard);
    (*line)->open();
    ASSERT_EQ(heard.opened, 1);
    EXPECT_EQ(::tcgetsid(terminal.modem.get()), -1);  // no session has it
}

TEST(SerialLine, SaysNothingOnceItIsMuted) {
    PseudoTerminal terminal;
    Heard heard;
    auto line = lineTo(terminal.path, heard);
    (*line)->open();
    (*line)->mute();
    ASSERT_EQ(::write(terminal.modem.get(), kFrame.data(), kFrame.size()), static_cast<ssize_t>(kFrame.size()));
    terminal.modem.reset();
    test::settle();
    EXPECT_TRUE(heard.given.empty());
    EXPECT_TRUE(heard.closed.empty());
}

TEST(SocketLine, CarriesBytesOverTcpAndTellsWhenItIsHungUp) {
    QTcpServer server;
    ASSERT_TRUE(server.listen(QHostAddress::LocalHost));
    Heard heard;
    auto line = lineTo("tcp:127.0.0.1:" + std::to_string(server.serverPort()), heard);
    (*line)->open();
    ASSERT_TRUE(runUntil([&] { return heard.opened == 1 && server.hasPendingConnections(); }));
    QTcpSocket* modem = server.nextPendingConnection();
    (*line)->send(kFrame);
    ASSERT_TRUE(runUntil([&] { return modem->bytesAvailable() >= static_cast<qint64>(kFrame.size()); }));
    modem->write(reinterpret_cast<const char*>(kFrame.data()), static_cast<qint64>(kFrame.size()));
    modem->disconnectFromHost();
    ASSERT_TRUE(runUntil([&] { return !heard.closed.empty(); }));
    EXPECT_EQ(heard.given, kFrame);
    test::settle();
    EXPECT_EQ(heard.closed.size(), 1U);
}

TEST(SocketLine, CarriesBytesOverAUnixSocketWhoseKindIsSeen) {
    const test::TemporaryDirectory directory;
    const std::string path = directory.path() / "router";
    QLocalServer server;
    ASSERT_TRUE(server.listen(QString::fromStdString(path)));
    for (const std::string& address : {"unix:" + path, path}) {
        Heard heard;
        auto line = lineTo(address, heard);
        ASSERT_TRUE(line);
        (*line)->open();
        ASSERT_TRUE(runUntil([&] { return heard.opened == 1 && server.hasPendingConnections(); }));
        QLocalSocket* modem = server.nextPendingConnection();
        modem->write(reinterpret_cast<const char*>(kFrame.data()), static_cast<qint64>(kFrame.size()));
        ASSERT_TRUE(runUntil([&] { return heard.given.size() >= kFrame.size(); }));
        EXPECT_EQ(heard.given, kFrame);
    }
}

TEST(SocketLine, SaysWhyNobodyIsThere) {
    const test::TemporaryDirectory directory;
    for (const std::string& address :
         {"unix:" + (directory.path() / "none").string(), std::string("tcp:127.0.0.1:1")}) {
        Heard heard;
        auto line = lineTo(address, heard);
        (*line)->open();
        ASSERT_TRUE(runUntil([&] { return !heard.closed.empty(); })) << address;
        EXPECT_EQ(heard.opened, 0);
        EXPECT_EQ(heard.closed, std::vector<std::string>{"nobody is there"});
    }
}

TEST(SocketLine, SaysInOneWayThatItWasHungUp) {
    const test::TemporaryDirectory directory;
    const std::string path = directory.path() / "router";
    QLocalServer local;
    ASSERT_TRUE(local.listen(QString::fromStdString(path)));
    QTcpServer tcp;
    ASSERT_TRUE(tcp.listen(QHostAddress::LocalHost));
    for (const std::string& address : {"unix:" + path, "tcp:127.0.0.1:" + std::to_string(tcp.serverPort())}) {
        Heard heard;
        auto line = lineTo(address, heard);
        (*line)->open();
        ASSERT_TRUE(runUntil(
            [&] { return heard.opened == 1 && (local.hasPendingConnections() || tcp.hasPendingConnections()); }));
        if (QLocalSocket* modem = local.nextPendingConnection()) modem->disconnectFromServer();
        if (QTcpSocket* modem = tcp.nextPendingConnection()) modem->disconnectFromHost();
        ASSERT_TRUE(runUntil([&] { return !heard.closed.empty(); }));
        EXPECT_EQ(heard.closed, std::vector<std::string>{"it hung up"});
    }
}

TEST(HostModemLines, SaysWhatAPathIsNot) {
    const test::TemporaryDirectory directory;
    Heard heard;
    const auto missing = lineTo(directory.path() / "none", heard);
    ASSERT_FALSE(missing);
    EXPECT_EQ(missing.error().reason, "No such file or directory");
    std::ofstream(directory.path() / "file") << "x";
    const auto file = lineTo(directory.path() / "file", heard);
    ASSERT_FALSE(file);
    EXPECT_EQ(file.error().reason, "it is no device");
}

TEST(HostModemLines, TakesACharacterDeviceThatIsNoTerminalForAPhonesOwn) {
    Heard heard;
    auto line = lineTo("/dev/null", heard);
    ASSERT_TRUE(line);
    (*line)->open();
    EXPECT_EQ(heard.opened, 0);  // it knows no such mode
    EXPECT_EQ(heard.closed.size(), 1U);
}

}  // namespace kelvo
