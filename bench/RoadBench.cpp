// The road from the service's source over real ports to clients in other processes, with the records of an LTE modem:
//     build/bench/bin/road_bench
// A client either counts what it receives, or is the application's model, which decodes each record and rebuilds the
// display tree every two seconds.

#include <fmt/format.h>
#include <stdlib.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <QCoreApplication>
#include <algorithm>
#include <chrono>
#include <cstdint>
#include <filesystem>
#include <optional>

#include "LogGenerator/Factory.h"
#include "bench/Families.h"
#include "model/KelvoModel.h"
#include "platform/encodings/PropertyList.h"
#include "platform/host/HostMainQueue.h"
#include "platform/host/HostMessagePorts.h"
#include "platform/host/HostTelephonyClient.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "platform/telephony/LogChannelProtocol.h"
#include "telephony/TelephonyService.h"

namespace {

using namespace kelvo;
using namespace std::chrono_literals;
using std::chrono::steady_clock;

struct Run {
    const char* name;
    int clients = 1;
    bool decodes = false;
    std::uint32_t records = 200'000;
    std::optional<double> perSecond{};  ///< none: as fast as the clients read
};

// Gives `run.records` records once all clients are there.
class LteSource final : public RecordSource {
public:
    LteSource(MainQueue& queue, const Run& run)
        : _queue(queue), _run(run), _messages(bench::lteFamily().traffic.front().messages) {}

    std::optional<Technology> technology() const override { return Technology::LTE; }
    std::string description() const override { return "the LTE mix of the benchmarks"; }
    void start(RecordSink& sink) override {
        _sink = &sink;
        clientStreams();
    }
    // A client is hungry, or has only just begun.
    void feed() override {
        if (_streaming < _run.clients) return clientStreams();
        if (_run.perSecond || _sink == nullptr) return;
        for (int i = 0; i < 256 && _given < _run.records && _sink->isHungry(); ++i) giveUpTo(_given + 1);
        if (_given < _run.records && _sink->isHungry()) _queue.post([this] { feed(); });
    }

private:
    void clientStreams() {
        if (++_streaming < _run.clients) return;
        _begin = steady_clock::now();
        if (_run.perSecond) _timer = _queue.repeat(1ms, [this] { giveUpTo(due()); });
        feed();
    }
    std::uint32_t due() const {
        const double seconds = std::chrono::duration<double>(steady_clock::now() - _begin).count();
        return static_cast<std::uint32_t>(std::min<double>(_run.records, seconds * *_run.perSecond));
    }
    void giveUpTo(std::uint32_t count) {
        for (; _given < count; ++_given) _sink->take(_messages[_given % _messages.size()]);
    }

    MainQueue& _queue;
    const Run _run;
    const std::vector<Bytes> _messages;
    RecordSink* _sink = nullptr;
    int _streaming = 0;
    steady_clock::time_point _begin;
    std::unique_ptr<RepeatingTimer> _timer;
    std::uint32_t _given = 0;
};

// Ports that count the messages on their way to a callback.
class CountingPorts final : public MessagePorts {
public:
    explicit CountingPorts(const std::filesystem::path& directory) : _ports(directory) {}

    Local createLocal(std::string_view name, MessageCallback callback) override {
        return _ports.createLocal(name, [this, callback = std::move(callback)](std::int32_t id, ByteView data) {
            if (_received++ % 64 == 0) {  // asked for every record, the time would cost as much as decoding a small one
                _last = steady_clock::now();
                if (_received == 1) _first = _last;
            }
            return callback(id, data);
        });
    }
    std::unique_ptr<RemotePort> openRemote(std::string_view name) override { return _ports.openRemote(name); }

    std::uint32_t received() const { return _received; }
    bool isQuiet() const { return _received > 0 && steady_clock::now() - _last > 500ms; }
    double seconds() const { return std::chrono::duration<double>(_last - _first).count(); }

private:
    HostMessagePorts _ports;
    std::uint32_t _received = 0;
    steady_clock::time_point _first;
    steady_clock::time_point _last;
};

// Of this process, for each of `records`.
double processorMicroseconds(std::uint32_t records) {
    rusage usage{};
    ::getrusage(RUSAGE_SELF, &usage);
    const auto microseconds = [](timeval time) {
        return static_cast<double>(time.tv_sec) * 1e6 + static_cast<double>(time.tv_usec);
    };
    return (microseconds(usage.ru_utime) + microseconds(usage.ru_stime)) / records;
}

// The client's side: until nothing has come for half a second.
int receive(const std::filesystem::path& directory, const Run& run, int number) {
    int argc = 0;
    const QCoreApplication application(argc, nullptr);
    const DirectoryResources resources(KELVO_RESOURCE_DIR);
    const Environment::Scope environment({.resources = &resources});
    HostMainQueue queue;
    CountingPorts ports(directory);
    HostTelephonyClient telephony(ports);
    while (!telephony.createServerConnection({})) ::usleep(1000);

    const std::string name = fmt::format("client{}", number);
    std::unique_ptr<LocalPort> local;
    std::unique_ptr<RemotePort> channel;
    std::unique_ptr<KelvoModel> model;
    NodeRef tree;
    if (run.decodes) {
        const auto rebuild = [&] { tree = model->topLevelNodes(); };
        model = std::make_unique<KelvoModel>(KelvoModel::Services{queue, ports, telephony, rebuild, name});
        model->startMonitor();
    } else {
        local = ports.createLocal(name, [](std::int32_t, ByteView) { return Bytes{}; }).port;
        local->schedule();
        const auto connection = telephony.createServerConnection({});
        channel = ports.openRemote(connection->networkMonitorCreateLogChannel(name).portName);
        const auto start =
            writeXmlPropertyList(generatorFromTechnology(namesOf(Technology::LTE).identifier)->getStartCommand());
        if (!channel || !channel->request(kPLLogChannelMessageId, *start, 1s, std::nullopt)) return 1;
    }
    const auto watch = queue.repeat(100ms, [&] {
        if (ports.isQuiet()) QCoreApplication::quit();
    });
    QCoreApplication::exec();
    fmt::print("{}: {:.0f} records/s, {} of {} lost; {:.2f} µs of the client's processor a record\n", run.name,
               ports.received() / ports.seconds(), run.records - ports.received(), run.records,
               processorMicroseconds(run.records));
    return 0;
}

int serve(const std::filesystem::path& directory, const Run& run) {
    int argc = 0;
    const QCoreApplication application(argc, nullptr);
    HostMainQueue queue;
    HostMessagePorts ports(directory);
    LteSource source(queue, run);
    TelephonyService service(ports, source);
    if (!service.open()) return 1;
    const auto untilClientsLeave = queue.repeat(100ms, [&, seen = false]() mutable {
        seen = seen || service.channelCount() > 0;
        if (seen && service.channelCount() == 0) QCoreApplication::quit();
    });
    const int status = QCoreApplication::exec();
    fmt::print("{}, service: {:.2f} µs of processor a record\n", run.name, processorMicroseconds(run.records));
    return status;
}

template <class Work>
pid_t inChild(Work work) {
    std::fflush(stdout);
    const pid_t child = ::fork();
    if (child == 0) {
        const int status = work();
        std::fflush(stdout);
        ::_exit(status);
    }
    return child;
}

int measure(const Run& run) {
    std::string pattern = (std::filesystem::temp_directory_path() / "kelvo-bench-XXXXXX").string();
    if (::mkdtemp(pattern.data()) == nullptr) return 1;
    const std::filesystem::path directory = pattern;
    inChild([&] { return serve(directory / "ports", run); });
    for (int i = 0; i < run.clients; ++i) inChild([&] { return receive(directory / "ports", run, i); });
    int failures = 0;
    for (int status = 0; ::wait(&status) > 0;) failures += status != 0 ? 1 : 0;
    std::filesystem::remove_all(directory);
    return failures;
}

}  // namespace

int main() {
    int failures = 0;
    for (const Run& run : {
             Run{.name = "source to display tree", .decodes = true, .records = 1'000'000},
             Run{.name = "source to one client that counts"},
             Run{.name = "source to four clients that count, each", .clients = 4},
             Run{.name = "20,000 a second for ten seconds", .decodes = true, .perSecond = 20'000.0},
         }) {
        failures += measure(run);
    }
    return failures != 0 ? 1 : 0;
}
