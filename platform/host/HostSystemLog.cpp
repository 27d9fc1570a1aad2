#include "platform/host/HostSystemLog.h"

#include <spdlog/sinks/base_sink.h>
#include <spdlog/sinks/stdout_sinks.h>
#include <syslog.h>
#include <unistd.h>

#include <algorithm>

#include "platform/encodings/Utf8.h"

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

int priorityFor(spdlog::level::level_enum level) {
    switch (level) {
        case spdlog::level::warn: return LOG_WARNING;
        case spdlog::level::info: return LOG_NOTICE;
        default: return LOG_ERR;
    }
}

using OneThread = spdlog::details::null_mutex;  // the worker alone writes

class SyslogSink final : public spdlog::sinks::base_sink<OneThread> {
public:
    explicit SyslogSink(std::string program) : _program(std::move(program)) {
        ::openlog(_program.c_str(), LOG_PID, LOG_USER);
    }
    ~SyslogSink() override { ::closelog(); }

private:
    void sink_it_(const spdlog::details::log_msg& line) override {
        ::syslog(priorityFor(line.level), "%.*s", static_cast<int>(line.payload.size()), line.payload.data());
    }
    void flush_() override {}

    const std::string _program;  // syslog keeps a pointer to it
};

std::shared_ptr<spdlog::sinks::sink> sinkFor(HostSystemLog::To destination, const std::string& program) {
    if (destination == HostSystemLog::To::System && ::access("/dev/log", W_OK) == 0)
        return std::make_shared<SyslogSink>(program);
    auto sink = std::make_shared<spdlog::sinks::stderr_sink_st>();
    sink->set_pattern("%H:%M:%S.%e " + program + ": %v");
    return sink;
}

}  // namespace

HostSystemLog::HostSystemLog(const std::string& program, To destination)
    : HostSystemLog(sinkFor(destination, program)) {}

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
