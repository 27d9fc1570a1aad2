#include "platform/host/HostSystemLog.h"

#include <gtest/gtest.h>
#include <spdlog/sinks/base_sink.h>

#include <condition_variable>
#include <mutex>
#include <string>
#include <vector>

using kelvo::HostSystemLog;
using kelvo::Level;

namespace {

using Lines = std::vector<std::string>;

// Keeps lines as "level: text"; stands still between hold() and release().
class KeepingSink final : public spdlog::sinks::base_sink<std::mutex> {
public:
    explicit KeepingSink(Lines& lines) : _lines(lines) {}

    void hold() { _held = true; }
    void release() {
        const std::lock_guard lock(_gate);
        _held = false;
        _changed.notify_all();
    }
    void awaitFirst() {
        std::unique_lock lock(_gate);
        _changed.wait(lock, [this] { return _busy; });
    }

private:
    void sink_it_(const spdlog::details::log_msg& line) override {
        std::unique_lock lock(_gate);
        _busy = true;
        _changed.notify_all();
        _changed.wait(lock, [this] { return !_held; });
        const auto name = spdlog::level::to_string_view(line.level);
        _lines.push_back(std::string(name.data(), name.size()) + ": " +
                         std::string(line.payload.data(), line.payload.size()));
    }
    void flush_() override {}

    Lines& _lines;
    std::mutex _gate;
    std::condition_variable _changed;
    bool _held = false;
    bool _busy = false;
};

}  // namespace

TEST(HostSystemLog, WritesEverythingInOrderBeforeItIsGone) {
    Lines lines;
    {
        HostSystemLog log(std::make_shared<KeepingSink>(lines));
        log.write(Level::Error, "three");
        log.write(Level::Warning, "four");
        log.write(Level::Notice, "five");
        log.write(Level::DlfWriter, "sixteen");
    }
    EXPECT_EQ(lines, (Lines{"error: three", "warning: four", "info: five", "error: sixteen"}));
}

TEST(HostSystemLog, DropsTrailingNewlines) {
    Lines lines;
    {
        HostSystemLog log(std::make_shared<KeepingSink>(lines));
        log.write(Level::Error, " a  b {} %s \n\n");
        log.write(Level::Error, "\n");
    }
    EXPECT_EQ(lines, (Lines{"error:  a  b {} %s ", "error: "}));
}

TEST(HostSystemLog, WritesOneLineWhateverATextHolds) {
    Lines lines;
    {
        HostSystemLog log(std::make_shared<KeepingSink>(lines));
        log.write(Level::Error, "Cell\n00:00:00 kelvo: all is well\r\x1b[2J\xc2\x9b\x7f – \xff");
    }
    EXPECT_EQ(lines, (Lines{"error: Cell\uFFFD00:00:00 kelvo: all is well\uFFFD\uFFFD[2J\uFFFD\uFFFD – \uFFFD"}));
}

TEST(HostSystemLog, PutsTheTimeAndTheProgramBeforeLinesOnStandardError) {
    testing::internal::CaptureStderr();
    HostSystemLog("kelvo", HostSystemLog::To::StandardError).write(Level::Warning, "Deallocing");
    const std::string line = testing::internal::GetCapturedStderr();
    ASSERT_GT(line.size(), 12U);
    EXPECT_EQ(line.substr(2, 1) + line.substr(5, 1) + line.substr(8, 1), "::.");  // 09:15:02.345
    EXPECT_EQ(line.substr(12), " kelvo: Deallocing\n");
}

TEST(HostSystemLog, WantsWhatItWrites) {
    Lines lines;
    const HostSystemLog log(std::make_shared<KeepingSink>(lines));
    for (const Level level : {Level::Error, Level::Warning, Level::Notice, Level::DlfWriter})
        EXPECT_TRUE(log.wants(level));
}

TEST(HostSystemLog, NeverWaitsLosesTheOldestLinesAndCountsThem) {
    Lines lines;
    {
        const auto sink = std::make_shared<KeepingSink>(lines);
        sink->hold();
        HostSystemLog log(sink, 4);
        log.write(Level::Error, "first");
        sink->awaitFirst();  // taken off the queue and stuck
        for (int i = 0; i < 10; ++i) log.write(Level::Error, "line " + std::to_string(i));
        sink->release();
    }
    EXPECT_EQ(lines, (Lines{"error: first", "error: line 6", "error: line 7", "error: line 8", "error: line 9",
                            "error: 6 log lines were lost"}));
}
