#include "tests/telephony/port/PortFixture.h"

using namespace kelvo;
using namespace kelvo::test;

namespace {

const QStringList kDrive{"--replay", captureOf("lte")};

}  // namespace

TEST_F(PortTest, AServiceThatWasKilledIsFollowedByOneThatFindsTheModemStreaming) {
    const Records all = ordinaryRecords("lte");
    plugModemIn(kDrive);
    serve("lte", kLteCodes);
    ASSERT_TRUE(receive(2));
    _daemon.kill();
    ASSERT_TRUE(_daemon.waitForFinished(10'000));
    Records records = client->records;
    leave();
    serve("lte", kLteCodes);
    ASSERT_TRUE(receive(3));
    EXPECT_EQ(state(), "");
    for (const char* key : {"BadChecksums", "BadEscapes", "TooShort", "LyingLengths", "Unfinished"})
        EXPECT_EQ(count(key), 0) << key;  // what streamed to nobody is not this reader's
    records.insert(records.end(), client->records.begin(), client->records.end());
    EXPECT_TRUE(isIn(records, all));
    EXPECT_LT(placeOf(client->records, all), all.size());  // and none is missing from then on
}

TEST_F(PortTest, AModemThatIsPulledOutIsWaitedForAndItsClientsNoticeAPauseAlone) {
    const Records all = ordinaryRecords("lte");
    plugModemIn(kDrive);
    serve("lte", kLteCodes);
    ASSERT_TRUE(receive(1));
    const std::size_t descriptors = descriptorsOfTheService();
    for (std::int64_t openings = 2; openings < 4; ++openings) {
        pullOrPutPlug();
        ASSERT_TRUE(runUntil([&] { return state() == "the modem has gone: it hung up"; })) << state();
        const std::size_t before = client->records.size();
        pullOrPutPlug();
        ASSERT_TRUE(receive(before + 1));
        EXPECT_EQ(count("Openings"), openings);
        EXPECT_EQ(state(), "");
        EXPECT_EQ(portState(), "running");
        EXPECT_TRUE(runUntil([&] { return descriptorsOfTheService() <= descriptors; }));  // once this test's have gone
    }
    EXPECT_TRUE(client->remote->isValid());
    EXPECT_TRUE(isIn(client->records, all));
    const std::string port = link().toStdString();
    const Records cycle{"the modem at " + port + ": the modem has gone: it hung up; trying again",
                        port + ": the modem is back"};
    EXPECT_EQ(lines(), (Records{"Serving the modem at " + port + ", the log of a modem that speaks LTE", cycle[0],
                                cycle[1], cycle[0], cycle[1]}));
}

TEST_F(PortTest, AModemThatHangsUpInTheMiddleOfAFrameCostsThatFrameAlone) {
    const Records all = ordinaryRecords("lte");
    plugModemIn(kDrive + QStringList{"--faults", "hang-up,flood"});
    serve("lte", kLteCodes);
    const std::string port = link().toStdString();
    ASSERT_TRUE(says(port + ": the modem is back"));
    EXPECT_EQ(lines()[1], port + ": loses records: 1 unfinished frame");
    EXPECT_EQ(lines()[2], port + ": no longer loses records; it was 1 unfinished frame");
    EXPECT_EQ(lines()[3], "the modem at " + port + ": the modem has gone: it hung up; trying again");
    EXPECT_EQ(lines()[4], port + ": the modem is back");
    EXPECT_GE(count("Unfinished"), 1);
    EXPECT_EQ(count("BadChecksums"), 0);
    const Records first(client->records.begin(), client->records.begin() + 40);
    EXPECT_EQ(placeOf(first, all), 0U);
}

TEST_F(PortTest, TheModemSendsWhatItsClientsWantNow) {
    const auto hasRecordOf = [this](const char* code) {
        return runUntil([&] {
            return std::ranges::any_of(client->records,
                                       [&](const std::string& record) { return record.substr(3, 2) == code; });
        });
    };
    plugModemIn({"--simulate", "lte", "--faults", "flood"});
    serve("lte", {0xB17F});
    ASSERT_TRUE(hasRecordOf("\x7F\xB1"));
    EXPECT_FALSE(std::ranges::any_of(client->records,
                                     [](const std::string& record) { return record.substr(3, 2) == "\x79\xB1"; }));
    client->stream({0xB17F, 0xB179});
    EXPECT_TRUE(hasRecordOf("\x79\xB1"));
    client->stream({0xB179});
    const std::int64_t delivered = count("Delivered");
    EXPECT_TRUE(runUntil([&] { return count("Delivered") > delivered + 10; }));
    EXPECT_EQ(state(), "");
}

TEST_F(PortTest, TheModemIsSilencedWhenTheServiceIsToldToEnd) {
    plugModemIn(kDrive);
    serve("lte", kLteCodes);
    ASSERT_TRUE(receive(1));
    stopDaemon();
    const UniqueFd reader(::open(link().toStdString().c_str(), O_RDWR | O_NOCTTY | O_NONBLOCK | O_CLOEXEC));
    ASSERT_TRUE(reader);
    const std::string version("\x00\x78\xF0\x7E", 4);
    ASSERT_EQ(::write(reader.get(), version.data(), version.size()), 4);
    std::string heard;
    ASSERT_TRUE(runUntil([&] {
        char bytes[256];
        const ssize_t size = ::read(reader.get(), bytes, sizeof bytes);
        if (size > 0) heard.append(bytes, static_cast<std::size_t>(size));
        return heard.size() >= 58;
    }));
    EXPECT_EQ(heard[0], '\x00');  // its version, 58 bytes with its frame, and no record before it
    EXPECT_EQ(heard.size(), 58U);
}
