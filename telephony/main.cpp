#include <fmt/format.h>
#include <signal.h>
#include <unistd.h>

#include <QCoreApplication>
#include <chrono>

#include "platform/Environment.h"
#include "platform/host/HostMainQueue.h"
#include "platform/host/HostMessagePorts.h"
#include "platform/host/HostSystemLog.h"
#include "platform/host/UnixSignals.h"
#include "telephony/ServiceOptions.h"
#include "telephony/TelephonyService.h"

namespace {

using namespace kelvo;

int fail(const Failure& failure) {
    fmt::print(stderr, "kelvo-telephonyd: {}\n", failure.reason);
    return 1;
}

std::chrono::nanoseconds steadyNow() { return std::chrono::steady_clock::now().time_since_epoch(); }

int serve(const ServiceOptions& options) {
    HostMainQueue queue;
    HostMessagePorts ports;
    const auto source = ReplaySource::open(options.replay, options.replayOptions, queue, steadyNow);
    if (!source) return fail(source.error());
    const UnixSignals handler({SIGINT, SIGTERM, SIGHUP}, [](int) { QCoreApplication::quit(); });
    TelephonyService service(ports, **source);
    if (const auto failure = service.open()) return fail(*failure);
    logLine(Level::Notice, "Serving %s, the log of a modem that speaks %s", options.replay.string(),
            namesOf((*source)->technology()).name);
    return QCoreApplication::exec();
}

}  // namespace

int main(int argc, char** argv) {
    const auto parsed = parseServiceOptions(argc, argv);
    if (!parsed.options) return parsed.exitStatus;
    const QCoreApplication application(argc, argv);
    const bool inTerminal = ::isatty(STDERR_FILENO) != 0;
    HostSystemLog log("kelvo-telephonyd", inTerminal ? HostSystemLog::To::StandardError : HostSystemLog::To::System);
    const Environment::Scope environment(Environment{.log = &log});
    return serve(*parsed.options);
}
