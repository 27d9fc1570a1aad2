#include <signal.h>

#include <algorithm>

#include "tests/support/CaptureFile.h"
#include "tests/telephony/DaemonFixture.h"

using namespace kelvo;
using namespace std::chrono_literals;
using test::runUntil;
using Client = test::DaemonClient;

namespace {

class DaemonTest : public test::DaemonFixture {
protected:
    void SetUp() override {
        CaptureWriter writer = test::captureAt(_capture, Technology::IFX);
        for (int i = 0; i < 3; ++i)
            ASSERT_TRUE(writer.append(CaptureTime(std::chrono::hours(i)), bytesOf("tree " + std::to_string(i))));
    }
    using DaemonFixture::startDaemon;
    void startDaemon() { startDaemon({"--replay", QString::fromStdString(_capture), "--speed", "max"}); }

    std::filesystem::path _capture = _temporary.path() / "ifx.pcap";
};

}  // namespace

TEST_F(DaemonTest, ServesAClientFromFirstToLastWord) {
    startDaemon();
    Client client(_ports, *_connection);
    ASSERT_TRUE(client.remote);
    const auto query = writeXmlPropertyList(Dictionary::make({{"GetTechnology", "GetTechnology"}}));
    const auto answer = client.remote->request(0, *query, 1s, 1s);
    ASSERT_TRUE(answer);
    EXPECT_EQ((*readPropertyList(*answer)->dictionary())["GetTechnology"], Value("kPLLogChannelTechnology_IFX"));
    client.stream();
    ASSERT_TRUE(runUntil([&] { return client.records.size() == 3; }));
    EXPECT_EQ(client.records, (std::vector<std::string>{"tree 0", "tree 1", "tree 2"}));
    EXPECT_TRUE(client.remote->isValid());  // the channel stays after the last packet
    run({"--status"});
    EXPECT_NE(_output.find("State       the capture has ended\n"), std::string::npos) << _output;

    stopDaemon();
    EXPECT_FALSE(client.remote->isValid());
    std::vector<std::string> files;
    for (const auto& file : std::filesystem::directory_iterator(_directory)) files.push_back(file.path().filename());
    std::sort(files.begin(), files.end());
    EXPECT_EQ(files, (std::vector<std::string>{"client.lock", "client.port"}));
}

TEST_F(DaemonTest, RecordsWhatItStreams) {
    const auto recorded = _temporary.path() / "recorded.pcap";
    startDaemon(
        {"--replay", QString::fromStdString(_capture), "--speed", "max", "--record", QString::fromStdString(recorded)});
    Client client(_ports, *_connection);
    ASSERT_TRUE(client.remote);
    client.stream();
    ASSERT_TRUE(runUntil([&] { return client.records.size() == 3; }));
    stopDaemon();
    auto capture = CaptureReader::open(recorded);
    ASSERT_TRUE(capture);
    EXPECT_EQ(capture->technology(), Technology::IFX);
    std::vector<std::string> records;
    while (const auto packet = *capture->next()) records.emplace_back(textOf(packet->bytes));
    EXPECT_EQ(records, client.records);
}

TEST_F(DaemonTest, RecordsOverNothingUnlessForcedAndNeverOverWhatItReplays) {
    const QString capture = QString::fromStdString(_capture);
    const std::string before = test::contentsOf(_capture);
    const std::filesystem::path link = _temporary.path() / "again.pcap";
    std::filesystem::create_hard_link(_capture, link);
    const QString earlier = QString::fromStdString(_temporary.write("earlier.pcap", bytesOf("earlier")));
    using Failed = std::pair<int, std::string>;
    EXPECT_EQ(run({"--replay", capture, "--record", capture, "--force"}),
              Failed(1, "kelvo-telephonyd: " + _capture.string() + " is the file being read\n"));
    EXPECT_EQ(run({"--replay", capture, "--record", QString::fromStdString(link), "--force"}),
              Failed(1, "kelvo-telephonyd: " + link.string() + " is the file being read\n"));
    EXPECT_EQ(run({"--replay", capture, "--record", earlier}),
              Failed(1, "kelvo-telephonyd: " + earlier.toStdString() + " exists already; --force replaces it\n"));
    EXPECT_EQ(test::contentsOf(_capture), before);

    startDaemon({"--replay", capture, "--speed", "max", "--record", earlier, "--force"});
    EXPECT_EQ(test::contentsOf(earlier.toStdString()), "earlier");  // it stays until there is something to record
    Client client(_ports, *_connection);
    client.stream();
    ASSERT_TRUE(runUntil([&] { return client.records.size() == 3; }));
    stopDaemon();
    EXPECT_EQ(test::contentsOf(earlier.toStdString()).size(), before.size());  // the same packets, an hour less apart
}

TEST_F(DaemonTest, EndsCleanlyOnAnInterrupt) {
    startDaemon();
    ::kill(static_cast<pid_t>(_daemon.processId()), SIGINT);
    ASSERT_TRUE(_daemon.waitForFinished(10'000));
    EXPECT_EQ(_daemon.exitCode(), 0);
    EXPECT_TRUE(std::filesystem::is_empty(_directory));
}

TEST_F(DaemonTest, IsStartedAgainAfterAViolentEnd) {
    startDaemon();
    _daemon.kill();
    ASSERT_TRUE(_daemon.waitForFinished(10'000));
    _connection.reset();
    startDaemon();
    stopDaemon();
}

TEST_F(DaemonTest, RefusesToRunTwice) {
    startDaemon();
    const auto [status, error] = run({"--replay", QString::fromStdString(_capture)});
    EXPECT_EQ(status, 1);
    EXPECT_EQ(error, "kelvo-telephonyd: another telephony service is running (process " +
                         std::to_string(_daemon.processId()) + ")\n");
    stopDaemon();
}

TEST_F(DaemonTest, TellsItsStatusToWhoeverAsks) {
    startDaemon({"--simulate", "lte", "--seed", "7"});
    const auto [status, error] = run({"--status"});
    EXPECT_EQ(status, 0) << error;
    EXPECT_EQ(_output,
              "Source      a simulated LTE modem, seed 7\n"
              "Technology  LTE\n"
              "Records     0\n"
              "\n"
              "  Log code                                       per second        in all\n"
              "  none\n"
              "\n"
              "Clients\n"
              "  none\n");
    stopDaemon();
}

TEST_F(DaemonTest, SaysInOneLineWhatIsWrongWithItsCommandLine) {
    const QString capture = QString::fromStdString(_capture);
    const QString missing = QString::fromStdString(_temporary.path() / "missing");
    for (const QStringList& arguments : {QStringList{"--replay"},
                                         QStringList{"--replay", missing},
                                         QStringList{"--replay", capture, "--speed", "0"},
                                         QStringList{"--replay", capture, "--speed", "-1"},
                                         QStringList{"--replay", capture, "--speed", "fast"},
                                         QStringList{"--replay", capture, "--speed", "inf"},
                                         QStringList{"--replay", capture, "more"},
                                         QStringList{"--simulate", "nmt"},
                                         QStringList{"--simulate", "lte", "--replay", capture},
                                         QStringList{"--replay", capture, "--seed", "1"},
                                         QStringList{"--simulate", "lte", "--loop"},
                                         QStringList{"--simulate", "lte", "--seed", "-1"},
                                         QStringList{"--simulate", "lte", "--record", "/nowhere/at.all"},
                                         QStringList{"--status"},
                                         QStringList{"--status", "--record", "x"},
                                         QStringList{"--status", "--simulate", "lte"},
                                         QStringList{"--simulate", "lte", "--generation", "2012"},
                                         QStringList{"--replay", capture, "--generation", "2014"},
                                         QStringList{"--simulate", "ifx", "--generation", "2010"},
                                         QStringList{"--simulate", "lte", "--force"},
                                         QStringList{"--replay", "/proc/self/mem"}}) {
        const auto [status, error] = run(arguments);
        EXPECT_EQ(status, 1);
        EXPECT_EQ(std::count(error.begin(), error.end(), '\n'), 1) << error;
        EXPECT_EQ(error.rfind("kelvo-telephonyd: ", 0), 0U) << error;
    }
}

TEST_F(DaemonTest, SaysPlainlyWhatIsWrongAboutAPort) {
    const auto notHere = [](const std::string& host) {
        return "--port: " + host +
               " is not this machine; whoever is in between could make the screens up (--allow-remote permits it)";
    };
    const std::pair<QStringList, std::string> wrong[] = {
        {{"--port"}, "--port: 1 required auto|PATH|tcp:HOST:PORT|unix:PATH missing"},
        {{"--port", ""}, "--port: there is no port without a name"},
        {{"--port", "unix:"}, "--port: unix: lacks its path"},
        {{"--port", "tcp:"}, "--port: tcp: is not tcp:HOST:PORT"},
        {{"--port", "tcp:localhost"}, "--port: tcp:localhost is not tcp:HOST:PORT"},
        {{"--port", "tcp:localhost:0"}, "--port: tcp:localhost:0 is not tcp:HOST:PORT"},
        {{"--port", "tcp:localhost:65536"}, "--port: tcp:localhost:65536 is not tcp:HOST:PORT"},
        {{"--port", "tcp:192.0.2.1:5"}, notHere("192.0.2.1")},
        {{"--port", "tcp:phone.example:5"}, notHere("phone.example")},
        {{"--port", "x", "--technology", "ifx"}, "--technology: ifx is not to be had at a port"},
        {{"--port", "x", "--technology", "nmt"}, "--technology: nmt is none of gsm, cdma, lte, utran, auto"},
        {{"--port", "x", "--subscription", "0"}, "--subscription: 0 is no number from 1 to 255"},
        {{"--port", "x", "--subscription", "256"}, "--subscription: 256 is no number from 1 to 255"},
        {{"--port", "x", "--subscription", "-1"}, "--subscription: -1 is no number from 1 to 255"},
        {{"--port", "x", "--subscription", "one"}, "--subscription: one is no number from 1 to 255"},
        {{"--port", "x", "--record", "f", "--record-frames", "f"}, "--record: its file is that of --record-frames"},
        {{"--port", "x", "--record-frames", "/nowhere/f"}, "/nowhere/f cannot be written: No such file or directory"},
        {{"--port", "x", "--speed", "2"}, "--speed excludes --port"},
        {{"--port", "x", "--loop"}, "--loop requires --replay"},
        {{"--port", "x", "--seed", "1"}, "--seed requires --simulate"},
        {{"--port", "x", "--json"}, "--json requires --status"},
        {{"--port", "x", "--force"}, "--force requires --record or --record-frames"},
        {{"--port", "x", "--simulate", "lte"}, "--simulate excludes --port"},
        {{"--port", "x", "--replay", "y"}, "--replay excludes --port"},
        {{"--port", "x", "--status"}, "--status excludes --port"},
        {{"--simulate", "lte", "--technology", "lte"}, "--technology requires --port"},
        {{"--simulate", "lte", "--subscription", "1"}, "--subscription requires --port"},
        {{"--simulate", "lte", "--record-frames", "f"}, "--record-frames requires --port"},
        {{"--simulate", "lte", "--allow-remote"}, "--allow-remote requires --port"},
        {{"--simulate", "lte", "--no-dtr-rts"}, "--no-dtr-rts requires --port"},
        {{"--status", "--json"}, "no telephony service is running"},
    };
    for (const auto& [arguments, reason] : wrong) {
        const auto [status, error] = run(arguments);
        EXPECT_EQ(status, 1);
        EXPECT_EQ(error, "kelvo-telephonyd: " + reason + "\n");
        EXPECT_EQ(_output, "");
    }
}

TEST_F(DaemonTest, TakesEveryOptionOfAPortAndWaitsForOneThatIsNotThere) {
    const QString port = QString::fromStdString(_temporary.file("modem"));
    const std::string recorded = _temporary.file("recorded.pcap");
    const std::string frames = _temporary.write("recorded.frames", bytesOf("earlier"));
    startDaemon({"--port", port, "--technology", "lte", "--subscription", "2", "--allow-remote", "--no-dtr-rts",
                 "--record", QString::fromStdString(recorded), "--record-frames", QString::fromStdString(frames),
                 "--force"});
    Client client(_ports, *_connection);
    ASSERT_TRUE(client.remote);
    client.stream({0xB0C2});
    ASSERT_TRUE(runUntil([&] {
        run({"--status"});
        return _output.find("State       it cannot be opened: No such file or directory\n") != std::string::npos;
    })) << _output;
    EXPECT_EQ(_output.rfind("Source      the modem at " + port.toStdString() + "\n", 0), 0U);
    EXPECT_NE(_output.find("\n  State                     closed\n"), std::string::npos) << _output;
    EXPECT_NE(_output.find("\n  SIM                       2\n"), std::string::npos) << _output;
    EXPECT_EQ(run({"--status", "--json"}), (std::pair<int, std::string>(0, "")));
    for (const char* part : {R"("Source": "the modem at )", R"("Technology": "LTE")", R"("Subscription": 2)",
                             R"("BadChecksums": 0)", R"("State": "closed")"})
        EXPECT_NE(_output.find(part), std::string::npos) << part << " in " << _output;
    stopDaemon();
    EXPECT_FALSE(std::filesystem::exists(recorded));  // there was nothing to record
    EXPECT_EQ(test::contentsOf(frames), "earlier");
}

TEST_F(DaemonTest, SaysThatATechnologyIsNotKnownWhileNobodyHasListened) {
    startDaemon({"--port", "auto"});
    run({"--status"});
    EXPECT_EQ(_output.rfind("Source      the modem that is plugged in\nTechnology  not known yet\n", 0), 0U) << _output;
    stopDaemon();
}

TEST_F(DaemonTest, SaysPlainlyWhatIsWrongWithASeed) {
    const std::pair<const char*, const char*> wrong[] = {
        {"-1", "-1 is not a whole number from 0"},
        {"abc", "abc is not a whole number from 0"},
        {"18446744073709551616", "18446744073709551616 is too large; the largest number is 18446744073709551615"},
    };
    for (const auto& [seed, reason] : wrong) {
        const auto [status, error] = run({"--simulate", "lte", "--seed", seed});
        EXPECT_EQ(status, 1);
        EXPECT_EQ(error, std::string("kelvo-telephonyd: --seed: ") + reason + "\n");
    }
}

TEST_F(DaemonTest, SaysPlainlyWhichModemsHaveGenerations) {
    EXPECT_EQ(run({"--simulate", "lte", "--generation", "2012"}).second,
              "kelvo-telephonyd: --generation: 2012 is none of 2010, 2014, 2018\n");
    EXPECT_EQ(run({"--simulate", "cdma", "--generation", "2014"}).second,
              "kelvo-telephonyd: --generation: CDMA records have one layout, whatever the year: only lte and gsm have "
              "generations\n");
}

TEST_F(DaemonTest, HelpsOnStandardOutput) {
    const auto [status, error] = run({"--help"});
    EXPECT_EQ(status, 0);
    EXPECT_EQ(error, "");
    for (const char* word : {"--replay", "--loop", "--speed", "--simulate", "--seed", "--generation", "--record",
                             "--force", "--status", "--version", "--port", "--technology", "--subscription",
                             "--record-frames", "--allow-remote", "--no-dtr-rts", "--json"})
        EXPECT_NE(_output.find(word), std::string::npos);
}
