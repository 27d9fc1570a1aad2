#include <fmt/format.h>
#include <signal.h>
#include <unistd.h>

#include <QCoreApplication>
#include <chrono>

#include "platform/encodings/PropertyList.h"
#include "platform/host/HostEventLoop.h"
#include "platform/host/HostMainQueue.h"
#include "platform/host/HostMessagePorts.h"
#include "platform/host/HostSystemLog.h"
#include "platform/host/UnixSignals.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyProtocol.h"
#include "telephony/CaptureStream.h"
#include "telephony/ServiceOptions.h"
#include "telephony/SimulationStream.h"
#include "telephony/StatusText.h"
#include "telephony/TelephonyService.h"

namespace {

using namespace kelvo;
using namespace std::chrono_literals;

int fail(const Failure& failure) {
    fmt::print(stderr, "kelvo-telephonyd: {}\n", failure.reason);
    return 1;
}

Result<std::unique_ptr<RecordStream>> openStream(const ServiceOptions& options) {
    if (options.replay.empty())
        return std::unique_ptr<RecordStream>(std::make_unique<SimulationStream>(options.simulate, options.seed));
    auto capture = CaptureStream::open(options.replay, options.loop);
    if (!capture) return capture.error();
    return std::unique_ptr<RecordStream>(std::move(capture).value());
}

int serve(const ServiceOptions& options) {
    HostMainQueue queue;
    HostMessagePorts ports;
    auto stream = openStream(options);
    if (!stream) return fail(stream.error());
    PacedSource source(std::move(stream).value(), options.speed, queue, steadyNow);
    if (!options.record.empty()) {
        auto file = OutputFile::create(options.record, {.replace = options.force, .beingRead = {options.replay}});
        if (!file) return fail(file.error());
        source.recordTo(Recording(std::move(file).value()));
    }
    const UnixSignals handler({SIGINT, SIGTERM, SIGHUP}, [](int) { QCoreApplication::quit(); });
    TelephonyService service(ports, source);
    if (const auto opened = service.open(); !opened) return fail(opened.error());
    logLine(Level::Notice, "Serving %s, the log of a modem that speaks %s", source.description(),
            namesOf(source.technology()).name);
    return HostEventLoop::run(QCoreApplication::exec);
}

int tellStatus() {
    HostMessagePorts ports;
    const auto port = ports.openRemote(kPLTelephonyServicePort);
    if (!port) return fail({"no telephony service is running"});
    const auto request = writeXmlPropertyList(Dictionary::make({{kPLGetStatus, kPLGetStatus}}));
    const auto answer = port->request(0, *request, 1s, 1s);
    if (!answer) return fail({"the telephony service does not answer"});
    const auto read = readPropertyList(*answer);
    if (!read) return fail(read.error());
    const auto text = statusText(*read);
    if (!text) return fail(text.error());
    fmt::print("{}", *text);
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    const auto parsed = parseServiceOptions(argc, argv);
    if (!parsed.options) return parsed.exitStatus;
    const QCoreApplication application(argc, argv);
    const bool inTerminal = ::isatty(STDERR_FILENO) != 0;
    HostSystemLog log("kelvo-telephonyd", inTerminal ? HostSystemLog::To::StandardError : HostSystemLog::To::System);
    const Environment::Scope environment(Environment{.log = &log});
    return parsed.options->status ? tellStatus() : serve(*parsed.options);
}
