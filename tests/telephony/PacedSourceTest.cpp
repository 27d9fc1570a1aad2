#include "telephony/PacedSource.h"

#include <gtest/gtest.h>

#include <fstream>
#include <string>
#include <vector>

#include "platform/system/Environment.h"
#include "telephony/CaptureStream.h"
#include "tests/support/CaptureFile.h"
#include "tests/support/EventLoop.h"
#include "tests/support/FileSizeLimit.h"
#include "tests/support/ManualQueue.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"

using namespace kelvo;
using namespace std::chrono_literals;
using std::chrono::nanoseconds;

namespace {

// Notes every record with the time it came, in milliseconds.
class NotingSink final : public RecordSink {
public:
    explicit NotingSink(const test::ManualQueue& queue) : _queue(queue) {}

    bool take(ByteView record) override {
        const auto ms = std::chrono::duration_cast<std::chrono::milliseconds>(_queue.now()).count();
        notes.push_back(std::to_string(ms) + std::string(textOf(record)));
        if (appetite > 0) --appetite;
        return wanted;
    }
    bool isHungry() const override { return appetite > 0; }

    std::vector<std::string> notes;
    int appetite = 1'000'000;
    bool wanted = true;

private:
    const test::ManualQueue& _queue;
};

using Notes = std::vector<std::string>;

class PacedSourceTest : public testing::Test {
protected:
    // A capture of packets "a", "b", … taken at these times (milliseconds from some day on).
    void capture(const std::vector<int>& times, Technology technology = Technology::LTE) {
        CaptureWriter writer = test::captureAt(_path, technology);
        std::string text = "a";
        for (const int ms : times) {
            ASSERT_TRUE(writer.append(CaptureTime(1'600'000'000s + std::chrono::milliseconds(ms)), bytesOf(text)));
            ++text[0];
        }
    }
    struct Replay {
        bool loop = false;
        PacedSource::Speed speed = 1.0;
    };
    void open(Replay how) {
        auto stream = CaptureStream::open(_path, how.loop);
        ASSERT_TRUE(stream) << stream.error().reason;
        _source = std::make_unique<PacedSource>(std::move(stream).value(), how.speed, _queue,
                                                [this] { return _queue.now(); });
    }
    void open() { open(Replay()); }
    void play(Replay how) {
        open(how);
        _source->start(_sink);
        _queue.run();
    }
    void play() { play(Replay()); }

    test::TemporaryDirectory _temporary;
    std::filesystem::path _path = _temporary.path() / "test.pcap";
    test::ManualQueue _queue;
    NotingSink _sink{_queue};
    test::RecordingLog _log;
    Environment::Scope _scope{Environment{.log = &_log}};
    std::unique_ptr<PacedSource> _source;
};

}  // namespace

TEST_F(PacedSourceTest, NamesTheTechnologyOfTheCapture) {
    for (const Technology technology : {Technology::IFX, Technology::GSM, Technology::CDMA, Technology::UTRAN}) {
        capture({}, technology);
        open();
        EXPECT_EQ(_source->technology(), technology);
    }
}

TEST_F(PacedSourceTest, KeepsTheTimeBetweenPacketsFromTheStartOn) {
    capture({500, 500, 1500, 4000});
    open();
    _queue.advance(10s);
    EXPECT_TRUE(_sink.notes.empty());
    _source->start(_sink);
    _queue.advance(10s);
    EXPECT_EQ(_sink.notes, (Notes{"10000a", "10000b", "11000c", "13500d"}));
}

TEST_F(PacedSourceTest, StaysSilentAfterTheLastPacket) {
    capture({0, 10});
    play();
    _queue.advance(24h);
    EXPECT_EQ(_sink.notes.size(), 2U);
    EXPECT_TRUE(_log.lines().empty());
}

TEST_F(PacedSourceTest, MultipliesTheSpeed) {
    capture({0, 1000, 4000});
    play({.speed = 2.0});
    _queue.advance(10s);
    EXPECT_EQ(_sink.notes, (Notes{"0a", "500b", "2000c"}));
    _sink.notes.clear();
    const auto begin = _queue.now() / 1ms;
    play({.speed = 0.5});
    _queue.advance(10s);
    EXPECT_EQ(_sink.notes, (Notes{std::to_string(begin) + "a", std::to_string(begin + 2000) + "b",
                                  std::to_string(begin + 8000) + "c"}));
}

TEST_F(PacedSourceTest, LoopsAfterTheMeanInterval) {
    capture({0, 100, 400});  // mean 200 ms
    play({.loop = true});
    _queue.advance(1200ms);
    EXPECT_EQ(_sink.notes, (Notes{"0a", "100b", "400c", "600a", "700b", "1000c", "1200a"}));
}

TEST_F(PacedSourceTest, LoopsASinglePacketOnceASecondAndNoneNever) {
    capture({0});
    play({.loop = true});
    _queue.advance(2s);
    EXPECT_EQ(_sink.notes, (Notes{"0a", "1000a", "2000a"}));
    capture({});
    play({.loop = true});
    _queue.advance(10s);
    EXPECT_EQ(_sink.notes.size(), 3U);
}

TEST_F(PacedSourceTest, LoopsWithoutSpinningWhenAllPacketsHaveOneTime) {
    capture({0, 0});
    play({.loop = true});
    _queue.advance(20ms);
    EXPECT_EQ(_sink.notes, (Notes{"0a", "0b", "10a", "10b", "20a", "20b"}));
}

TEST_F(PacedSourceTest, SendsAPacketThatIsOlderThanTheOneBeforeAtOnce) {
    capture({0, 1000, 300, 1200});
    play();
    _queue.advance(2s);
    EXPECT_EQ(_sink.notes, (Notes{"0a", "1000b", "1000c", "1200d"}));
}

TEST_F(PacedSourceTest, ShortensLongPausesToFiveSecondsOfTheCapture) {
    capture({0, 3'600'000, 3'604'000});
    play();
    _queue.advance(20s);
    EXPECT_EQ(_sink.notes, (Notes{"0a", "5000b", "9000c"}));
    _sink.notes.clear();
    const auto begin = _queue.now() / 1ms;
    play({.speed = 10.0});
    _queue.advance(20s);
    EXPECT_EQ(_sink.notes, (Notes{std::to_string(begin) + "a", std::to_string(begin + 500) + "b",
                                  std::to_string(begin + 900) + "c"}));
}

TEST_F(PacedSourceTest, GoesAsFastAsAHungryClientReads) {
    capture({0, 1000, 2000, 3000});
    _sink.appetite = 2;
    play({.speed = std::nullopt});
    _queue.advance(1h);
    EXPECT_EQ(_sink.notes, (Notes{"0a", "0b"}));
    _sink.appetite = 10;
    _source->feed();
    _source->feed();
    _queue.run();
    EXPECT_EQ(_sink.notes, (Notes{"0a", "0b", "3600000c", "3600000d"}));
}

TEST_F(PacedSourceTest, RestsWhenAThousandRecordsWereRefusedAtFullSpeed) {
    capture({0, 1});
    _sink.wanted = false;
    play({.loop = true, .speed = std::nullopt});
    EXPECT_EQ(_sink.notes.size(), 1024U);
    _queue.advance(999ms);
    EXPECT_EQ(_sink.notes.size(), 1024U);
    _queue.advance(1ms);
    EXPECT_EQ(_sink.notes.size(), 2048U);
}

TEST_F(PacedSourceTest, LetsOtherWorkRunAmongManyPackets) {
    capture(std::vector<int>(1000, 0));
    open();
    _source->start(_sink);
    std::size_t before = 0;
    _queue.post([&] { before = _sink.notes.size(); });
    _queue.run();
    EXPECT_EQ(_sink.notes.size(), 1000U);
    EXPECT_LE(before, 256U);
}

TEST_F(PacedSourceTest, SaysWhenTheCaptureHasEnded) {
    capture({0, 100});
    play();
    EXPECT_EQ(_source->state(), "");
    _queue.advance(100ms);
    EXPECT_EQ(_source->state(), "the capture has ended");
}

TEST_F(PacedSourceTest, SaysWhereADamagedCaptureHasEnded) {
    capture({0, 100});
    std::filesystem::resize_file(_path, std::filesystem::file_size(_path) - 1);
    play();
    EXPECT_EQ(_sink.notes, Notes{"0a"});
    const std::string expected = "the capture has ended: " + _path.string() + " cannot be read at packet 2: ";
    EXPECT_EQ(_source->state().substr(0, expected.size()), expected);
}

TEST_F(PacedSourceTest, ACaptureInALoopDoesNotEnd) {
    capture({0, 100});
    play({.loop = true});
    _queue.advance(10s);
    EXPECT_EQ(_source->state(), "");
}

TEST_F(PacedSourceTest, TellsOfADamagedCaptureOnceAndPlaysWhatIsWhole) {
    capture({0, 100, 200});
    std::filesystem::resize_file(_path, std::filesystem::file_size(_path) - 1);
    play({.loop = true});
    _queue.advance(1s);
    EXPECT_EQ(_sink.notes,
              (Notes{"0a", "100b", "200a", "300b", "400a", "500b", "600a", "700b", "800a", "900b", "1000a"}));
    ASSERT_EQ(_log.lines().size(), 1U);
    EXPECT_EQ(_log.lines()[0].second.find(_path.string() + " cannot be read at packet 3: "), 0U);
    EXPECT_EQ(_source->state(), _log.lines()[0].second);
}

TEST_F(PacedSourceTest, EndsWhenTheCaptureIsGoneBeforeTheNextPass) {
    capture({0});
    play({.loop = true});
    EXPECT_EQ(_sink.notes.size(), 1U);
    // The second pass was opened when the first one ended; the third finds no file.
    std::filesystem::remove(_path);
    _queue.advance(10s);
    EXPECT_EQ(_sink.notes.size(), 2U);
    EXPECT_EQ(_log.lines().size(), 1U);
}

TEST_F(PacedSourceTest, RefusesFilesThatAreNoCapturesOfAModem) {
    const auto reason = [&] {
        const auto opened = CaptureStream::open(_path, false);
        return opened ? "opened" : opened.error().reason;
    };
    EXPECT_NE(reason().find("No such file"), std::string::npos);
    std::ofstream(_path) << "no capture at all, but long enough for a header";
    EXPECT_NE(reason().find("test.pcap"), std::string::npos);
    capture({0});
    std::fstream file(_path, std::ios::in | std::ios::out | std::ios::binary);
    file.seekp(20);  // the link type: 1, Ethernet
    file.write("\1\0\0\0", 4);
    file.close();
    EXPECT_EQ(reason(), _path.string() + ": its link type is none of a modem's log (147 to 151)");
}

TEST_F(PacedSourceTest, LeavesNothingOnTheQueueThatOutlivesIt) {
    capture({0, 100});
    play();
    _source.reset();
    _queue.advance(1s);
    EXPECT_EQ(_sink.notes, Notes{"0a"});
}

namespace {

// Everything that a capture holds, as "time in milliseconds since its first packet, text".
Recording recordingAt(const std::filesystem::path& path) { return Recording(OutputFile::create(path).value()); }

Notes readCapture(const std::filesystem::path& path) {
    auto reader = CaptureReader::open(path);
    Notes notes;
    std::optional<CaptureTime> first;
    while (auto packet = *reader->next()) {
        if (!first) first = packet->time;
        notes.push_back(std::to_string((packet->time - *first) / 1ms) + std::string(textOf(packet->bytes)));
    }
    return notes;
}

}  // namespace

TEST_F(PacedSourceTest, RecordsWhatAClientTakesWithItsTimeInTheStream) {
    capture({0, 100, 400});
    const auto recorded = _temporary.path() / "recorded.pcap";
    open({.loop = true, .speed = 10.0});
    _source->recordTo(recordingAt(recorded));
    _source->start(_sink);
    _queue.advance(25ms);
    _sink.wanted = false;
    _queue.advance(20ms);  // "c", which nobody takes
    _sink.wanted = true;
    _queue.advance(40ms);
    EXPECT_EQ(readCapture(recorded), (Notes{"0a", "100b", "600a", "700b"}));
    EXPECT_EQ(CaptureReader::open(recorded)->technology(), Technology::LTE);
}

TEST_F(PacedSourceTest, StreamsOnWhenTheRecordingFails) {
    capture({0, 100, 200});
    const auto recorded = _temporary.path() / "recorded.pcap";
    open();
    _source->recordTo(recordingAt(recorded));
    {
        const test::FileSizeLimit full(24 + 16 + 1 + 10);  // the file's header and one packet, not two
        _source->start(_sink);
        _queue.advance(1s);
    }
    EXPECT_EQ(_sink.notes, (Notes{"0a", "100b", "200c"}));
    EXPECT_EQ(readCapture(recorded), Notes{"0a"});
    ASSERT_EQ(_log.lines().size(), 1U);
    EXPECT_EQ(_log.lines()[0].second,
              "The recording ends here: " + recorded.string() + " cannot be written: File too large");
}

TEST_F(PacedSourceTest, ARecordingAppearsWithItsFirstRecord) {
    capture({100, 200});
    const auto recorded = _temporary.path() / "recorded.pcap";
    open();
    _source->recordTo(recordingAt(recorded));
    _sink.wanted = false;
    _source->start(_sink);
    _queue.run();
    EXPECT_FALSE(std::filesystem::exists(recorded));
    _sink.wanted = true;
    _queue.advance(100ms);
    EXPECT_EQ(readCapture(recorded), Notes{"0b"});
}

TEST_F(PacedSourceTest, ARecordingLeavesAFileAloneThatCameMeanwhile) {
    capture({0, 100});
    const std::string recorded = _temporary.file("recorded.pcap");
    open();
    _source->recordTo(recordingAt(recorded));
    _temporary.write("recorded.pcap", bytesOf("somebody else's"));
    _source->start(_sink);
    _queue.advance(1s);
    EXPECT_EQ(_sink.notes, (Notes{"0a", "100b"}));
    EXPECT_EQ(test::contentsOf(recorded), "somebody else's");
    ASSERT_EQ(_log.lines().size(), 1U);
    EXPECT_EQ(_log.lines()[0].second, "The recording ends here: " + recorded + " exists already; --force replaces it");
}
