#include <fmt/format.h>
#include <signal.h>
#include <unistd.h>

#include <QCoreApplication>
#include <QDBusConnection>
#include <chrono>
#include <utility>

#include "platform/encodings/PropertyList.h"
#include "platform/host/HostEventLoop.h"
#include "platform/host/HostMainQueue.h"
#include "platform/host/HostMessagePorts.h"
#include "platform/host/HostPaths.h"
#include "platform/host/HostSystemLog.h"
#include "platform/host/UnixSignals.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyProtocol.h"
#include "telephony/AdaptedStream.h"
#include "telephony/CaptureStream.h"
#include "telephony/CompletedSource.h"
#include "telephony/ModemSource.h"
#include "telephony/ServiceManager.h"
#include "telephony/ServiceOptions.h"
#include "telephony/SimulationStream.h"
#include "telephony/StatusText.h"
#include "telephony/TelephonyService.h"
#include "telephony/line/HostModemLines.h"
#include "telephony/modemmanager/ModemManager.h"

namespace {

using namespace kelvo;
using namespace std::chrono_literals;

int fail(const Failure& failure) {
    fmt::print(stderr, "kelvo-telephonyd: {}\n", failure.reason);
    return 1;
}

Result<std::unique_ptr<RecordStream>> openStream(const ServiceOptions& options) {
    if (options.replay.empty()) {
        std::unique_ptr<RecordStream> modem =
            std::make_unique<SimulationStream>(options.simulate, options.seed, options.generation);
        if (options.generation != simulation::Generation::Of2010)
            modem = std::make_unique<AdaptedStream>(std::move(modem));
        return modem;
    }
    auto capture = CaptureStream::open(options.replay, options.loop);
    if (!capture) return capture.error();
    return std::unique_ptr<RecordStream>(std::move(capture).value());
}

constexpr uid_t kRoot = 0;

std::unique_ptr<PhoneSource> openPhone(const std::string& modem, MainQueue& queue) {
    const auto systemBus = [] {
        return QDBusConnection::connectToBus(QDBusConnection::SystemBus, "kelvo-modemmanager");
    };
    auto manager = std::make_unique<modemmanager::ModemManager>(systemBus, kRoot, modem, queue);
    return std::make_unique<PhoneSource>(std::move(manager), queue, steadyNow);
}

Result<std::unique_ptr<ModemSource>> openPort(const ServiceOptions& options, MainQueue& queue) {
    auto lines = std::make_unique<HostModemLines>(*options.port, options.line);
    auto source = std::make_unique<ModemSource>(std::move(lines), options.session, queue, steadyNow);
    if (!options.recordFrames.empty()) {
        auto file = OutputFile::create(options.recordFrames, {.replace = options.force});
        if (!file) return file.error();
        source->recordFramesTo(std::move(file).value());
    }
    return source;
}

// The path of the port's node; empty: it is looked for; none: it has none.
std::optional<std::string> nodeOf(const PortAddress& port) {
    if (const auto* node = std::get_if<PortAddress::Node>(&port.place)) return node->path;
    return std::holds_alternative<PortAddress::Automatic>(port.place) ? std::optional<std::string>("") : std::nullopt;
}

std::unique_ptr<RecordSource> complete(std::unique_ptr<ModemSource> port, const ServiceOptions& options,
                                       MainQueue& queue) {
    const auto lastIdle = [&port = *port](std::uint32_t earfcn, std::uint16_t pci) {
        return port.lastIdle(earfcn, pci);
    };
    return std::make_unique<CompletedSource>(std::move(port), openPhone(*options.modemManager, queue),
                                             nodeOf(*options.port), lastIdle);
}

Result<std::unique_ptr<RecordSource>> openSource(const ServiceOptions& options, MainQueue& queue) {
    if (options.port) {
        auto port = openPort(options, queue);
        if (!port) return port.error();
        if (options.modemManager) return complete(std::move(port).value(), options, queue);
        return std::unique_ptr<RecordSource>(std::move(port).value());
    }
    if (options.modemManager) return std::unique_ptr<RecordSource>(openPhone(*options.modemManager, queue));
    auto stream = openStream(options);
    if (!stream) return stream.error();
    return std::unique_ptr<RecordSource>(
        std::make_unique<PacedSource>(std::move(stream).value(), options.speed, queue, steadyNow));
}

void tellSource(const RecordSource& source) {
    const auto technology = source.technology();
    logLine(Level::Notice, "Serving %s%s", source.description(),
            technology ? fmt::format(", the log of a modem that speaks {}", namesOf(*technology).name) : "");
}

int serve(const ServiceOptions& options) {
    HostMainQueue queue;
    HostMessagePorts ports;
    ServiceManager manager = ServiceManager::ofEnvironment();
    auto socket =
        ServiceManager::passedSocket(HostPaths::portDirectory() / (std::string(kPLTelephonyServicePort) + ".port"));
    if (!socket) return fail(socket.error());
    if (*socket) ports.usePassedSocket(std::string(kPLTelephonyServicePort), std::move(socket).value());
    const auto opened = openSource(options, queue);
    if (!opened) return fail(opened.error());
    RecordSource& source = **opened;
    if (!options.record.empty()) {
        auto file = OutputFile::create(options.record, {.replace = options.force, .beingRead = {options.replay}});
        if (!file) return fail(file.error());
        source.recordTo(Recording(std::move(file).value()));
    }
    bool ending = false;  // the second signal does not wait for the modem
    const UnixSignals handler({SIGINT, SIGTERM, SIGHUP}, [&](int) {
        if (std::exchange(ending, true)) return QCoreApplication::quit();
        manager.tellEnding();
        source.end([] { QCoreApplication::quit(); });
    });
    TelephonyService service(ports, source);
    if (const auto made = service.open(); !made) return fail(made.error());
    tellSource(source);
    manager.tellReady("Serving " + source.description(), queue);
    return HostEventLoop::run(QCoreApplication::exec);
}

int tellStatus(bool json) {
    HostMessagePorts ports;
    const auto port = ports.openRemote(kPLTelephonyServicePort);
    if (!port) return fail({"no telephony service is running"});
    const auto request = writeXmlPropertyList(Dictionary::make({{kPLGetStatus, kPLGetStatus}}));
    const auto answer = port->request(0, *request, 1s, 10s);  // it may have to start for it
    if (!answer) return fail({"the telephony service does not answer"});
    const auto read = readPropertyList(*answer);
    if (!read) return fail(read.error());
    const auto text = json ? statusJson(*read) : statusText(*read);
    if (!text) return fail(text.error());
    fmt::print("{}", *text);
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    const auto parsed = parseServiceOptions(argc, argv, ConfigPlaces::ofHost());
    if (!parsed.options) return parsed.exitStatus;
    const QCoreApplication application(argc, argv);
    const bool inTerminal = ::isatty(STDERR_FILENO) != 0;
    HostSystemLog log("kelvo-telephonyd", inTerminal ? HostSystemLog::To::StandardError : HostSystemLog::To::System);
    const Environment::Scope environment(Environment{.log = &log});
    return parsed.options->status ? tellStatus(parsed.options->json) : serve(*parsed.options);
}
