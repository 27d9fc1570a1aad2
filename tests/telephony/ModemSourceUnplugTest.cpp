#include <gtest/gtest.h>

#include <filesystem>

#include "platform/system/Environment.h"
#include "telephony/ModemSource.h"
#include "telephony/SimulationStream.h"
#include "telephony/line/HostModemLines.h"
#include "telephony/wire/modem/ModemPlayer.h"
#include "telephony/wire/modem/PseudoTerminal.h"
#include "telephony/wire/modem/StreamRecords.h"
#include "tests/support/EventLoop.h"
#include "tests/support/ManualQueue.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemporaryDirectory.h"

namespace kelvo::test {
namespace {

using namespace std::chrono_literals;

std::size_t openDescriptors() {
    const std::filesystem::directory_iterator all("/proc/self/fd");
    return static_cast<std::size_t>(std::distance(begin(all), end(all)));
}

/// The service's source at a modem on a real pseudo-terminal; time is the test's.
class ModemSourceUnplugTest : public testing::Test, public RecordSink {
protected:
    void SetUp() override {
        const auto now = [this] { return _queue.now() + 1000s; };
        const std::string link = _temporary.file("modem");
        _player = std::make_unique<modem::ModemPlayer>(
            std::make_unique<modem::PlayedModem>(
                std::make_unique<modem::StreamRecords>(std::make_unique<SimulationStream>(Technology::LTE, 1)), nullptr,
                modem::Faults{}, 1),
            std::make_unique<modem::PseudoTerminal>(link, _queue), _queue, now, [](const std::string&) {});
        ASSERT_TRUE(_player->start());
        _source = std::make_unique<ModemSource>(
            std::make_unique<HostModemLines>(*PortAddress::parse(link, false), SerialLine::Options{}),
            wire::Session::Options{.technology = Technology::LTE, .subscription = {}}, _queue, now);
        _source->start(*this);
    }
    bool take(ByteView) override { return ++_taken > 0; }
    bool isHungry() const override { return true; }

    std::string portState() const { return *(*_source->portStatus())["State"].string(); }
    // Lets time pass until the source has opened the port, asked its modem for everything, and had a record.
    void comeToRecords() {
        const std::uint64_t before = _taken;
        while (portState() == "closed") {
            _queue.advance(50ms);
            settle();
        }
        _queue.advance(20ms);   // in which the modem sees its reader
        _queue.advance(200ms);  // of silence
        ASSERT_TRUE(runUntil([&] { return portState() == "running"; }));
        ASSERT_TRUE(runUntil([&] {
            _queue.advance(1ms);
            return _taken > before;
        }));
    }

    TemporaryDirectory _temporary;
    ManualQueue _queue;
    RecordingLog _log;
    Environment::Scope _scope{Environment{.log = &_log}};
    std::uint64_t _taken = 0;
    std::unique_ptr<modem::ModemPlayer> _player;
    std::unique_ptr<ModemSource> _source;
};

}  // namespace

TEST_F(ModemSourceUnplugTest, AHundredTimesLeaksNoDescriptor) {
    ClientsWishes wishes{.streaming = true, .ordinary = {}};
    for (const std::size_t code : {0xB0C1, 0xB0C2, 0xB179, 0xB17F, 0xB180, 0xB186}) wishes.ordinary.set(code);
    _source->clientsWant(wishes);
    comeToRecords();
    const std::size_t descriptors = openDescriptors();
    for (int i = 0; i < 100; ++i) {
        _player->togglePlug();
        ASSERT_TRUE(runUntil([&] { return _source->state() == "the modem has gone: it hung up"; }))
            << i << ' ' << _source->state();
        _player->togglePlug();
        comeToRecords();
        settle();
        ASSERT_EQ(openDescriptors(), descriptors) << i;
    }
    EXPECT_EQ((*_source->portStatus())["Openings"], Value(101));
    EXPECT_EQ(_log.lines().size(), 300U);  // the modem's own line, it has gone, it is back
}

}  // namespace kelvo::test
