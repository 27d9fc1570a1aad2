#pragma once

#include <spdlog/fwd.h>

#include <cstddef>
#include <filesystem>
#include <memory>
#include <string>
#include <thread>

#include "platform/host/LineQueue.h"
#include "platform/system/SystemLog.h"

namespace kelvo {

/// The system log on a thread of its own: taking a line never waits for whoever writes it out. Lines wait in a queue,
/// a few milliseconds even when nothing is in their way; in an overflow the oldest go, and one line tells how many once
/// the queue is empty again. Destruction writes everything that still waits. Lines go to syslog where the system has
/// one, and to standard error elsewhere or when a terminal is there to read it. A line is one line: control characters
/// in its text become U+FFFD.
class HostSystemLog final : public SystemLog {
public:
    static constexpr std::size_t kQueueLength = 8192;  // lines

    enum class To { System, StandardError };

    /// `program` stands in front of every line. A system without syslog has its lines on standard error, too.
    /// `socket` is where its syslog listens.
    explicit HostSystemLog(const std::string& program, To destination = To::System,
                           const std::filesystem::path& socket = "/dev/log");
    /// For a destination of the caller's choice, which is used on the log's own thread only.
    explicit HostSystemLog(std::shared_ptr<spdlog::sinks::sink> destination, std::size_t queueLength = kQueueLength);
    ~HostSystemLog() override;

    bool wants(Level) const override { return true; }
    void write(Level level, std::string_view text) override;

private:
    void writeOut();

    const std::shared_ptr<spdlog::sinks::sink> _destination;
    LineQueue _queue;
    std::thread _writer;
};

}  // namespace kelvo
