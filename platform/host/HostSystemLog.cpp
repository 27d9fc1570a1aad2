#include "platform/host/HostSystemLog.h"

#include <spdlog/details/os.h>
#include <spdlog/sinks/base_sink.h>
#include <spdlog/sinks/stdout_sinks.h>
#include <syslog.h>
#include <unistd.h>

#include <algorithm>

#include "platform/encodings/Utf8.h"
#include "platform/host/SyslogSocket.h"

namespace kelvo {
namespace {

// The log's levels among spdlog's, which have no notice: information stands for it.
spdlog::level::level_enum levelFor(Level level) {
    switch (level) {
        case Level::Warning: return spdlog::level::warn;
        case Level::Notice: return spdlog::level::info;
        default: return spdlog::level::err;
    }
}

int severityFor(spdlog::level::level_enum level) {
    switch (level) {
        case spdlog::level::warn: return LOG_WARNING;
        case spdlog::level::info: return LOG_NOTICE;
        default: return LOG_ERR;
    }
}

using OneThread = spdlog::details::null_mutex;  // the log's own thread alone writes

class SyslogSink final : public spdlog::sinks::base_sink<OneThread> {
public:
    SyslogSink(const std::filesystem::path& socket, const std::string& program) : _socket(socket, program) {}

private:
    void sink_it_(const spdlog::details::log_msg& line) override {
        const std::tm time = spdlog::details::os::localtime(spdlog::log_clock::to_time_t(line.time));
        _socket.send(severityFor(line.level), time, std::string_view(line.payload.data(), line.payload.size()));
    }
    void flush_() override {}

    SyslogSocket _socket;
};

std::shared_ptr<spdlog::sinks::sink> sinkFor(HostSystemLog::To destination, const std::string& program,
                                             const std::filesystem::path& socket) {
    if (destination == HostSystemLog::To::System && ::access(socket.c_str(), W_OK) == 0)
        return std::make_shared<SyslogSink>(socket, program);
    auto sink = std::make_shared<spdlog::sinks::stderr_sink_st>();
    sink->set_pattern("%H:%M:%S.%e " + program + ": %v");
    return sink;
}

}  // namespace

HostSystemLog::HostSystemLog(const std::string& program, To destination, const std::filesystem::path& socket)
    : HostSystemLog(sinkFor(destination, program, socket)) {}

HostSystemLog::HostSystemLog(std::shared_ptr<spdlog::sinks::sink> destination, std::size_t queueLength)
    : _destination(std::move(destination)), _queue(queueLength), _writer([this] { writeOut(); }) {}

HostSystemLog::~HostSystemLog() {
    _queue.close();
    _writer.join();
}

void HostSystemLog::write(Level level, std::string_view text) {
    while (!text.empty() && (text.back() == '\n' || text.back() == '\r')) text.remove_suffix(1);
    _queue.add(level, text);
}

void HostSystemLog::writeOut() {
    const auto writeLine = [this](Level level, std::string_view text) {
        const bool plain = std::all_of(text.begin(), text.end(), [](char c) { return c >= 0x20 && c < 0x7f; });
        const std::string cleaned = plain ? std::string() : printable(text);
        if (!plain) text = cleaned;
        _destination->log(
            spdlog::details::log_msg("", levelFor(level), spdlog::string_view_t(text.data(), text.size())));
    };
    LineQueue::Batch batch;
    while (_queue.take(batch)) {
        batch.forEach(writeLine);
        if (batch.lost() > 0) writeLine(Level::Error, fmt::format("{} log lines were lost", batch.lost()));
    }
}

}  // namespace kelvo
