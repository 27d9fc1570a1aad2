#include <fmt/format.h>
#include <signal.h>

#include <QCoreApplication>

#include "platform/host/HostEventLoop.h"
#include "platform/host/HostMainQueue.h"
#include "platform/host/HostSystemLog.h"
#include "platform/host/UnixSignals.h"
#include "platform/system/Environment.h"
#include "telephony/CaptureStream.h"
#include "telephony/SimulationStream.h"
#include "telephony/wire/modem/FramesRecords.h"
#include "telephony/wire/modem/ModemOptions.h"
#include "telephony/wire/modem/ModemPlayer.h"
#include "telephony/wire/modem/PseudoTerminal.h"
#include "telephony/wire/modem/SocketPort.h"
#include "telephony/wire/modem/StreamRecords.h"

namespace {

using namespace kelvo;
using namespace kelvo::modem;

int fail(const Failure& failure) {
    fmt::print(stderr, "kelvo-modem: {}\n", failure.reason);
    return 1;
}

// The records of a SIM: the second one of a simulation is on a drive of its own.
Result<std::unique_ptr<ModemRecords>> openRecords(const ModemOptions& options, std::uint64_t sim) {
    using Records = std::unique_ptr<ModemRecords>;
    if (options.replay.empty())
        return Records(std::make_unique<StreamRecords>(
            std::make_unique<SimulationStream>(options.simulate, options.seed + sim, options.generation)));
    if (options.replay.extension() == ".frames") {
        auto frames = FramesRecords::open(options.replay);
        if (!frames) return frames.error();
        return Records(std::move(frames).value());
    }
    auto capture = CaptureStream::open(options.replay, false);
    if (!capture) return capture.error();
    if ((*capture)->technology() == Technology::IFX)
        return Failure{options.replay.string() + ": cell-monitor trees do not come from a modem's port"};
    return Records(std::make_unique<StreamRecords>(std::move(capture).value()));
}

std::unique_ptr<ModemPort> makePort(const std::string& on, MainQueue& queue) {
    if (on.starts_with("tcp:")) return std::make_unique<TcpPort>(static_cast<std::uint16_t>(std::stoul(on.substr(4))));
    if (on.starts_with("unix:")) return std::make_unique<UnixPort>(on.substr(5));
    return std::make_unique<PseudoTerminal>(on, queue);
}

int play(const ModemOptions& options) {
    auto first = openRecords(options, 0);
    if (!first) return fail(first.error());
    std::unique_ptr<ModemRecords> second;
    if (options.faults.has(Fault::TwoSims)) {
        auto records = openRecords(options, 1);
        if (!records) return fail(records.error());
        second = std::move(records).value();
    }
    HostMainQueue queue;
    ModemPlayer player(
        std::make_unique<PlayedModem>(std::move(first).value(), std::move(second), options.faults, options.seed),
        makePort(options.on, queue), queue, steadyNow, [](const std::string& place) {
            fmt::print("{}\n", place);
            std::fflush(stdout);
        });
    const UnixSignals handler({SIGINT, SIGTERM, SIGHUP, SIGUSR1}, [&player](int signal) {
        if (signal == SIGUSR1) return player.togglePlug();
        QCoreApplication::quit();
    });
    if (const auto started = player.start(); !started) return fail(started.error());
    const int status = HostEventLoop::run(QCoreApplication::exec);
    fmt::print("{}", tallyText(player.tally()));
    return status;
}

}  // namespace

int main(int argc, char** argv) {
    const auto parsed = parseModemOptions(argc, argv);
    if (!parsed.options) return parsed.exitStatus;
    const QCoreApplication application(argc, argv);
    HostSystemLog log("kelvo-modem", HostSystemLog::To::StandardError);
    const Environment::Scope environment(Environment{.log = &log});
    return play(*parsed.options);
}
