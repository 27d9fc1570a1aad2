#include "tools/export/LiveReadings.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "tests/support/FakePorts.h"
#include "tests/support/FakeTelephony.h"
#include "tests/support/ManualClock.h"
#include "tests/support/ManualQueue.h"
#include "tests/support/Record.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;

/// "seconds since 1970, record, path=text" of the RSRP.
struct NotedLevels final : ReadingRows {
    void write(const Moment& moment, std::span<const Written> readings) override {
        for (const auto& [series, value] : readings) {
            lines.push_back(std::to_string(moment.time.time_since_epoch() / 1s) + " #" + std::to_string(moment.record) +
                            " " + *value->string());
        }
    }
    void endInput(const ReadInput& input) override { ended = input; }
    void finish() override {}
    std::vector<std::string> lines;
    ReadInput ended;
};

struct LiveReadingsTest : testing::Test {
    static constexpr long long kNoon = 1795348800;  // 2026-11-22 12:00 UTC

    /// 0xB179: RSRP -140 + raw / 4 dBm; the modem's time in units of 1.25 ms since 1980.
    static Bytes level(std::uint32_t rsrp, std::uint64_t ticks = 0) {
        return test::Record(0xB179, 29)
            .u16(7, ticks & 0xFFFF)
            .u32(9, static_cast<std::uint32_t>(ticks >> 16))
            .u16(17, 5780)
            .u16(23, rsrp)
            .bytes();
    }
    void deliver(const Bytes& message) {
        ports.deliver("com.zorvik.BasebandStateReport.LogChannel.export." + std::to_string(getpid()), 0, message);
    }

    test::ManualQueue queue;
    test::FakePorts ports;
    test::FakeTelephony telephony;
    test::ManualClock clock{kNoon};
    DirectoryResources resources{KELVO_RESOURCE_DIR};
    Environment::Scope environment{{.log = nullptr, .clock = &clock, .resources = &resources}};
    ValueGlobs globs = *ValueGlobs::of({"*Filtered RSRP"});
    NotedLevels rows;
    std::vector<std::string> told;
    LiveReadings live{
        {queue, ports, telephony, [this](const std::string& why) { told.push_back(why); }}, {}, globs, rows};
};

TEST_F(LiveReadingsTest, ComeRecordByRecordWithTheModemsTimeOrElseThatOfTheirArrival) {
    ports.onRequest = test::speaking("kPLLogChannelTechnology_Oskra_LTE");
    queue.advance(0s);
    deliver(level(100));
    // 2023-12-06 04:04:26 is 1385870666 s after 1980-01-06.
    deliver(level(104, std::uint64_t{1385870666} * 800));
    clock.advance(5s);
    deliver(level(108));
    EXPECT_EQ(rows.lines, (std::vector<std::string>{"1795348800 #1 -115.00 dBm", "1701835466 #2 -114.00 dBm",
                                                    "1795348805 #3 -113.00 dBm"}));
    EXPECT_EQ(live.end().records, 3U);
    EXPECT_EQ(rows.ended.technology, Technology::LTE);
    EXPECT_EQ(rows.ended.last, CaptureTime(std::chrono::seconds(kNoon + 5)));
}

TEST_F(LiveReadingsTest, TellWhyNoneComeAndWaitForTheService) {
    telephony.reachable = false;
    queue.advance(0s);
    queue.advance(5s);
    EXPECT_EQ(told, std::vector<std::string>{"No telephony service is running"});
    telephony.reachable = true;
    ports.onRequest = test::speaking("kPLLogChannelTechnology_Oskra_LTE");
    queue.advance(5s);
    deliver(level(100));
    EXPECT_EQ(rows.lines.size(), 1U);
    told.clear();
    for (int i = 0; i < 30; ++i) queue.advance(1s);
    EXPECT_EQ(told.size(), 1U);  // once, however long it lasts
    EXPECT_EQ(told.front(), "No records for 10 s");
}

}  // namespace
}  // namespace kelvo
